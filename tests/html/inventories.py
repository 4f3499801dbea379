"""Makes inventories as small as a story needs, or as large as a page must bear."""
import pathlib
from xml.sax.saxutils import escape, quoteattr

HEAD = '''<CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP>
<QUALIFIER.DECLARATION NAME="Key" TYPE="boolean"/>
'''
TAIL = '</DECLGROUP></DECLARATION></CIM>\n'
SYSTEM = {'KALMO_OperatingSystem': {'Name': 'string*', 'OSType': 'uint16'}}


def declaration(name, properties):
    """`properties`: name -> type, with * behind it for a key and [] for an array."""
    made = ''
    for prop, kind in properties.items():
        qualifier = '<QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>' if kind.endswith('*') else ''
        kind = kind.rstrip('*')
        if kind.endswith('[]'):
            made += f'<PROPERTY.ARRAY NAME={quoteattr(prop)} TYPE="{kind[:-2]}">{qualifier}</PROPERTY.ARRAY>'
        else:
            made += f'<PROPERTY NAME={quoteattr(prop)} TYPE="{kind}">{qualifier}</PROPERTY>'
    return f'<VALUE.OBJECT><CLASS NAME={quoteattr(name)}>{made}</CLASS></VALUE.OBJECT>\n'


def instance(name, properties, values):
    made = ''
    for prop, value in values.items():
        kind = properties[prop].rstrip('*')
        if value is None:
            continue
        if kind.endswith('[]'):
            elements = ''.join(f'<VALUE>{escape(element)}</VALUE>' for element in value)
            made += f'<PROPERTY.ARRAY NAME={quoteattr(prop)} TYPE="{kind[:-2]}"><VALUE.ARRAY>{elements}</VALUE.ARRAY></PROPERTY.ARRAY>'
        else:
            made += f'<PROPERTY NAME={quoteattr(prop)} TYPE="{kind}"><VALUE>{escape(str(value))}</VALUE></PROPERTY>'
    return f'<VALUE.OBJECT><INSTANCE CLASSNAME={quoteattr(name)}>{made}</INSTANCE></VALUE.OBJECT>\n'


def write(path, classes, instances):
    """`classes`: name -> properties; `instances`: an iterable of (class, values)."""
    classes = {**SYSTEM, **classes}
    with open(path, 'w', encoding='utf-8') as file:
        file.write(HEAD)
        for name, properties in classes.items():
            file.write(declaration(name, properties))
        file.write(instance('KALMO_OperatingSystem', SYSTEM['KALMO_OperatingSystem'], {'Name': 'host', 'OSType': 36}))
        for name, values in instances:
            file.write(instance(name, classes[name], values))
        file.write(TAIL)
    return pathlib.Path(path)


PACKAGE = {'Name': 'string*', 'Version': 'string', 'Vendor': 'string'}
SERVICE = {'Name': 'string*', 'Started': 'boolean', 'StartMode': 'string'}
ADAPTER = {'Name': 'string*', 'MTU': 'uint32'}
FILE_SYSTEM = {'Mount': 'string*', 'Options': 'string[]'}
USER = {'Name': 'string*', 'UID': 'uint32', 'Groups': 'string[]'}
SERVER = {'INV_Package': PACKAGE, 'INV_Service': SERVICE, 'INV_NetworkAdapter': ADAPTER, 'INV_FileSystem': FILE_SYSTEM, 'INV_User': USER}


class Server:
    """What a server holds; a story changes some of it."""

    def __init__(self, packages=24):
        self.instances = {}
        for i in range(packages):
            self.put('INV_Package', f'package{i:02}', Version=f'1.{i}-1', Vendor='distribution')
        for name in ('cron', 'rsyslog', 'ssh'):
            self.put('INV_Service', name, Started='TRUE', StartMode='Automatic')
        for i in range(4):
            self.put('INV_NetworkAdapter', f'eth{i}', MTU=1500)
        self.put('INV_FileSystem', '/', Options=['rw', 'relatime'])
        self.put('INV_FileSystem', '/srv', Options=['rw', 'nosuid', 'noexec'])
        self.put('INV_User', 'root', UID=0, Groups=['root'])

    def put(self, cls, key, **values):
        name = next(iter(SERVER[cls]))
        self.instances[(cls, key)] = {**self.instances.get((cls, key), {name: key}), **values}
        return self

    def drop(self, cls, key):
        del self.instances[(cls, key)]
        return self

    def write(self, path):
        return write(path, SERVER, ((cls, values) for (cls, _), values in sorted(self.instances.items())))


def pair(folder):
    """Two servers: four differences, one of each kind and a service that stands still."""
    other = Server().put('INV_Service', 'rsyslog', Started='FALSE').put('INV_Package', 'cryptominer', Version='1.0-1', Vendor='unknown')
    other.put('INV_User', 'mallory', UID=1004, Groups=['mallory', 'sudo']).drop('INV_Package', 'package03')
    return [Server().write(folder / 'web01.xml'), other.write(folder / 'web07.xml')]


def lacking(folder):
    """A service that runs in one inventory, stands still in another and is missing in the third."""
    servers = {'a': Server(), 'b': Server().put('INV_Service', 'ssh', Started='FALSE'), 'c': Server().drop('INV_Service', 'ssh')}
    return [server.write(folder / f'{name}.xml') for name, server in servers.items()]


def fleet(folder, size=40):
    """Servers that are alike, except for what is planted in eleven of them."""
    servers = [Server() for _ in range(size)]
    for i in range(4):
        servers[18].put('INV_NetworkAdapter', f'eth{i}', MTU=9000)
    servers[30].put('INV_FileSystem', '/srv', Options=['rw', 'nosuid'])
    for i in (20, 21, 22):
        for package in range(20):
            servers[i].put('INV_Package', f'package{package:02}', Version=f'1.{package}-1+security{i % 2}')
    servers[22].drop('INV_Package', 'package23').drop('INV_Package', 'package22')
    servers[6].put('INV_Package', 'cryptominer', Version='1.0-1', Vendor='unknown')
    servers[11].put('INV_Service', 'rsyslog', Started='FALSE')
    servers[12].put('INV_User', 'mallory', UID=1004, Groups=['mallory', 'sudo'])
    servers[13].put('INV_User', 'mallory', UID=0, Groups=['mallory'])
    servers[33].drop('INV_Service', 'cron')
    servers[35].put('INV_Service', 'ssh', StartMode='Manual')
    return [server.write(folder / f'web{i + 1:02}.xml') for i, server in enumerate(servers)]


# What could end a script, an attribute or a line, or is not to be seen.
HOSTILE = ['<script>document.title = "taken"</script>', '</script><img src=x onerror="document.title = 1">', '"quoted" and \'quoted\'',
           'a\u2028b\u2029c', '&lt;b&gt; &amp; <!-- --> ]]>', '\\u0000 \u2400 \ufffd', '{{script}} ${1} `x`', '\u202etxt.exe', 'Ünï 😀 \U0001F680']


def hostile(folder):
    """Two inventories whose keys and values are texts that a careless page would run or lose."""
    classes = {'INV_Text': {'Name': 'string*', 'Value': 'string'}}
    paths = []
    for label, suffix in (('a', ''), ('b', ' changed')):
        instances = [('INV_Text', {'Name': text, 'Value': text + suffix}) for text in HOSTILE]
        if suffix:
            instances.append(('INV_Text', {'Name': HOSTILE[0] + ' new', 'Value': HOSTILE[1]}))
        paths.append(write(folder / f'{label}.xml', classes, instances))
    return paths


def large(folder, instances=50_000, changed=6):
    """Two inventories with instances * changed changed values."""
    properties = {'Name': 'string*', **{f'P{i}': 'string' for i in range(changed)}}
    classes = {f'INV_Part{i}': properties for i in range(2)}

    def contents(side):
        for i in range(instances):
            yield f'INV_Part{i % 2}', {'Name': f'part-{i:06}', **{f'P{p}': f'value {i * 7 % 9973} of {p} in {side}' for p in range(changed)}}
    return [write(folder / f'{name}.xml', classes, contents(name)) for name in ('before', 'after')]
