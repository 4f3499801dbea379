# Writes what Windows knows of itself as CIM-XML, which cimdelta loads as an inventory:
#
#     powershell -ExecutionPolicy Bypass -File windows_inventory.ps1 -Path web07.xml
#
# Instances and the declarations of their classes are in the system's own text form (CimSerializer, MI_XML). A class that cannot be
# read is named in the inventory. The file appears whole or not at all.
param(
    [Parameter(Mandatory = $true)] [string] $Path,
    [string] $Namespace = 'root/cimv2',
    [string[]] $Class = @('Win32_ComputerSystem', 'Win32_OperatingSystem', 'Win32_BIOS', 'Win32_Processor', 'Win32_PhysicalMemory',
        'Win32_DiskDrive', 'Win32_DiskPartition', 'Win32_LogicalDisk', 'Win32_NetworkAdapterConfiguration', 'Win32_Service',
        'Win32_SystemDriver', 'Win32_QuickFixEngineering', 'Win32_UserAccount', 'Win32_Group', 'Win32_Share', 'Win32_StartupCommand')
)
$ErrorActionPreference = 'Stop'
$serialization = 'Microsoft.Management.Infrastructure.Serialization'
$serializer = ("$serialization.CimSerializer" -as [type])::Create()
$instanceOnly = ("$serialization.InstanceSerializationOptions" -as [type])::None
$classOnly = ("$serialization.ClassSerializationOptions" -as [type])::None
$declared = @{}
$classes = New-Object System.Text.StringBuilder
$instances = New-Object System.Text.StringBuilder

function Add-Object($to, $bytes) {
    $xml = [System.Text.Encoding]::Unicode.GetString($bytes).Trim([char]0xFEFF, [char]0) -replace '^\s*<\?xml.*?\?>', ''
    [void]$to.AppendLine("<VALUE.OBJECT>$xml</VALUE.OBJECT>")
}

function Add-Class($name) {
    while ($name -and -not $declared[$name]) {
        $cim = Get-CimClass -Namespace $Namespace -ClassName $name
        Add-Object $classes ($serializer.Serialize($cim, $classOnly))
        $declared[$name] = $true
        $name = $cim.CimSuperClassName
    }
}

function Add-Missing($name, $reason) {
    $text = @($name, $reason) | ForEach-Object { [System.Security.SecurityElement]::Escape($_) }
    [void]$instances.AppendLine('<VALUE.OBJECT><INSTANCE CLASSNAME="KALMO_NotCollected">' +
        '<PROPERTY NAME="Kind" TYPE="string"><VALUE>instances</VALUE></PROPERTY>' +
        "<PROPERTY NAME=`"Reason`" TYPE=`"string`"><VALUE>$($text[0]): $($text[1])</VALUE></PROPERTY>" +
        '<PROPERTY NAME="Count" TYPE="uint32"><VALUE>1</VALUE></PROPERTY>' +
        "<PROPERTY.ARRAY NAME=`"Subjects`" TYPE=`"string`"><VALUE.ARRAY><VALUE>$($text[0])</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>" +
        '</INSTANCE></VALUE.OBJECT>')
    Write-Warning "not collected: ${name}: $reason"
}

foreach ($name in $Class -split ',') {  # -File passes a list as one text
    try {
        foreach ($instance in @(Get-CimInstance -Namespace $Namespace -ClassName $name)) {
            Add-Class $instance.CimClass.CimClassName
            Add-Object $instances ($serializer.Serialize($instance, $instanceOnly))
        }
    } catch {
        Add-Missing $name $_.Exception.Message.Trim()
    }
}

$key = '<QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>'
$parts = ($Namespace.Trim('/') -split '[/\\]' | ForEach-Object { "<NAMESPACE NAME=`"$_`"/>" }) -join ''
$text = '<?xml version="1.0" encoding="utf-8"?>' + "`n<CIM CIMVERSION=`"2.0`" DTDVERSION=`"2.0`"><DECLARATION><DECLGROUP>" +
    "<LOCALNAMESPACEPATH>$parts</LOCALNAMESPACEPATH>`n" + '<VALUE.OBJECT><CLASS NAME="KALMO_NotCollected">' +
    "<PROPERTY NAME=`"Kind`" TYPE=`"string`">$key</PROPERTY><PROPERTY NAME=`"Reason`" TYPE=`"string`">$key</PROPERTY>" +
    '<PROPERTY NAME="Count" TYPE="uint32"></PROPERTY><PROPERTY.ARRAY NAME="Subjects" TYPE="string"></PROPERTY.ARRAY>' +
    "</CLASS></VALUE.OBJECT>`n$classes$instances</DECLGROUP></DECLARATION></CIM>`n"
$whole = $ExecutionContext.SessionState.Path.GetUnresolvedProviderPathFromPSPath($Path)
[System.IO.File]::WriteAllText("$whole.new", $text, (New-Object System.Text.UTF8Encoding $false))
Move-Item -Force "$whole.new" $whole
