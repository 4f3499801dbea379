#!/bin/sh
# Saves what a WBEM server (DSP0200) knows of a system: a folder of its answers, which cimdelta loads as one inventory.
#
#     curl_inventory.sh URL NAMESPACE FOLDER CLASS...
#     curl_inventory.sh https://array1:5989/cimom root/cimv2 array1 CIM_StorageVolume CIM_DiskDrive
#
# Instances of the classes and of their subclasses are saved, with the declarations of all classes of the namespace.
# User and password come from ~/.netrc. CURL may be set to curl with further options: CURL='curl --cacert ca.pem'.
set -eu
[ $# -ge 4 ] || { sed -n '4,5p' "$0" >&2; exit 2; }
url=$1 namespace=$2 folder=$3
shift 3
mkdir "$folder"

# ask FILE METHOD PARAMETERS
ask() {
    names=$(printf '%s' "$namespace" | sed 's,[^/]*,<NAMESPACE NAME="&"/>,g; s,>/<,><,g')
    printf '<?xml version="1.0" encoding="utf-8"?>\n<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLEREQ><IMETHODCALL NAME="%s"><LOCALNAMESPACEPATH>%s</LOCALNAMESPACEPATH>%s</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>\n' \
        "$2" "$names" "$3<IPARAMVALUE NAME=\"DeepInheritance\"><VALUE>TRUE</VALUE></IPARAMVALUE><IPARAMVALUE NAME=\"LocalOnly\"><VALUE>FALSE</VALUE></IPARAMVALUE>" |
        ${CURL:-curl} --silent --show-error --fail --netrc-optional --header 'Content-Type: application/xml; charset=utf-8' \
            --header 'CIMOperation: MethodCall' --header "CIMMethod: $2" \
            --header "CIMObject: $(printf '%s' "$namespace" | sed 's,/,%2F,g')" \
            --data-binary @- --output "$folder/$1" "$url"
}

ask classes.xml EnumerateClasses '<IPARAMVALUE NAME="IncludeQualifiers"><VALUE>TRUE</VALUE></IPARAMVALUE>'
for class in "$@"; do
    ask "$class.xml" EnumerateInstances "<IPARAMVALUE NAME=\"ClassName\"><CLASSNAME NAME=\"$class\"/></IPARAMVALUE>"
done
