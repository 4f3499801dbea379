"""Pieces of CIM-XML and rules."""
HEAD = ('<?xml version="1.0" encoding="utf-8"?>\n<CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP>\n'
        '<QUALIFIER.DECLARATION NAME="Key" TYPE="boolean"><SCOPE PROPERTY="true" REFERENCE="true"/><VALUE>false</VALUE>'
        '</QUALIFIER.DECLARATION>\n')
TAIL = '</DECLGROUP></DECLARATION></CIM>\n'
KEY = '<QUALIFIER NAME="Key" TYPE="boolean"><VALUE>true</VALUE></QUALIFIER>'


def qualifier(name):
    return f'<QUALIFIER NAME="{name}" TYPE="string"><VALUE>some text</VALUE></QUALIFIER>'


def declared(name, qualifiers='', kind='string'):
    return f'<PROPERTY NAME="{name}" TYPE="{kind}">{qualifiers}</PROPERTY>\n'


def cls(name, properties, above='', qualifiers='', key='Id'):
    """A class. A top-level one declares the key."""
    extends = f' SUPERCLASS="{above}"' if above else ''
    own_key = '' if above else declared(key, KEY)
    return f'<VALUE.OBJECT><CLASS NAME="{name}"{extends}>{qualifiers}{own_key}{properties}</CLASS></VALUE.OBJECT>\n'


def value(name, text):
    return f'<PROPERTY NAME="{name}" TYPE="string"><VALUE>{text}</VALUE></PROPERTY>'


def array(name, texts):
    values = ''.join(f'<VALUE>{text}</VALUE>' for text in texts)
    return f'<PROPERTY.ARRAY NAME="{name}" TYPE="string"><VALUE.ARRAY>{values}</VALUE.ARRAY></PROPERTY.ARRAY>'


def path(class_name, key):
    return (f'<INSTANCENAME CLASSNAME="{class_name}"><KEYBINDING NAME="Id"><KEYVALUE VALUETYPE="string">{key}</KEYVALUE>'
            '</KEYBINDING></INSTANCENAME>')


def reference(name, class_name, key):
    return (f'<PROPERTY.REFERENCE NAME="{name}" REFERENCECLASS="{class_name}"><VALUE.REFERENCE>{path(class_name, key)}'
            '</VALUE.REFERENCE></PROPERTY.REFERENCE>')


def instance(class_name, key, values='', key_name='Id'):
    return f'<VALUE.OBJECT><INSTANCE CLASSNAME="{class_name}">{value(key_name, key)}{values}</INSTANCE></VALUE.OBJECT>\n'


def inventory(*parts):
    return HEAD + ''.join(parts) + TAIL


def rules(elements):
    return '<?xml version="1.0"?>\n<DifftoolSpec version="1.0">\n' + ''.join(elements) + '</DifftoolSpec>\n'


def element(class_name, more='default="include"', lists=''):
    return f'<class name="{class_name}" {more}>{lists}</class>\n'
