"""Small inventories as texts of CIM-XML."""

KEY = '<QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>'


def declared(name, type_name="string", qualifiers=""):
    return f'<PROPERTY NAME="{name}" TYPE="{type_name}">{qualifiers}</PROPERTY>'


def key(name, type_name="string"):
    return declared(name, type_name, KEY)


def declared_array(name, type_name="string", order=""):
    qualifier = f'<QUALIFIER NAME="ArrayType" TYPE="string"><VALUE>{order}</VALUE></QUALIFIER>' if order else ""
    return f'<PROPERTY.ARRAY NAME="{name}" TYPE="{type_name}">{qualifier}</PROPERTY.ARRAY>'


def value(name, text, type_name="string", attributes=""):
    return f'<PROPERTY NAME="{name}" TYPE="{type_name}"{attributes}><VALUE>{text}</VALUE></PROPERTY>'


def array(name, texts, type_name="string", attributes=""):
    elements = "".join("<VALUE.NULL/>" if text is None else f"<VALUE>{text}</VALUE>" for text in texts)
    return f'<PROPERTY.ARRAY NAME="{name}" TYPE="{type_name}"{attributes}><VALUE.ARRAY>{elements}</VALUE.ARRAY></PROPERTY.ARRAY>'


def embedded(name, class_name, properties):
    inner = f'<INSTANCE CLASSNAME="{class_name}">{properties}</INSTANCE>'.replace("&", "&amp;").replace("<", "&lt;")
    return value(name, inner, attributes=' EmbeddedObject="instance"')


def path(class_name, keys, place=""):
    bindings = "".join(f'<KEYBINDING NAME="{name}"><KEYVALUE>{text}</KEYVALUE></KEYBINDING>' for name, text in keys)
    name = f'<INSTANCENAME CLASSNAME="{class_name}">{bindings}</INSTANCENAME>'
    spaces = "".join(f'<NAMESPACE NAME="{one}"/>' for one in place.split("/"))
    return f"<LOCALINSTANCEPATH><LOCALNAMESPACEPATH>{spaces}</LOCALNAMESPACEPATH>{name}</LOCALINSTANCEPATH>" if place else name


def reference(name, target):
    return f'<PROPERTY.REFERENCE NAME="{name}"><VALUE.REFERENCE>{target}</VALUE.REFERENCE></PROPERTY.REFERENCE>'


def cls(name, properties="", superclass=""):
    above = f' SUPERCLASS="{superclass}"' if superclass else ""
    return f'<VALUE.OBJECT><CLASS NAME="{name}"{above}>{properties}</CLASS></VALUE.OBJECT>'


def instance(class_name, properties):
    return f'<VALUE.OBJECT><INSTANCE CLASSNAME="{class_name}">{properties}</INSTANCE></VALUE.OBJECT>'


SYSTEM_CLASS = cls("KALMO_OperatingSystem", key("Name") + declared("OSType", "uint16"))
SYSTEM = SYSTEM_CLASS + instance("KALMO_OperatingSystem", value("Name", "host") + value("OSType", "36", "uint16"))


def document(*contents):
    return f'<CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP>{"".join(contents)}</DECLGROUP></DECLARATION></CIM>'


def rules(text):
    return f"<DifftoolSpec>{text}</DifftoolSpec>"
