"""A WBEM server (DSP0200) made of inventories: it answers from documents of CIM-XML, and misbehaves if a test wants it to.

    with MadeServer({"root/cimv2": inventory}) as server:
        server.misbehave("EnumerateInstances", "CIM_Fan", cim_error(1, "the provider crashed"))
        ... server.url ...

Instances come with subclasses and with names; a reference in a key is one in the name. Pull operations give as many as are asked for.
"""
import base64
import copy
import http.server
import ssl
import threading
import time
import xml.etree.ElementTree as etree
from xml.sax.saxutils import escape, quoteattr


def interop(namespaces, class_name="CIM_Namespace"):
    """A document with an instance for each namespace."""
    instances = "".join(f'<VALUE.OBJECT><INSTANCE CLASSNAME="{class_name}"><PROPERTY NAME="Name" TYPE="string"><VALUE>{name}</VALUE></PROPERTY>'
                        "</INSTANCE></VALUE.OBJECT>" for name in namespaces)
    return (f'<CIM><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME="{class_name}"><PROPERTY NAME="Name" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean">'
            f"<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS></VALUE.OBJECT>{instances}</DECLGROUP></DECLARATION></CIM>")


def to_text(element):
    """An XML reader would turn a plain carriage return into a line feed."""
    return etree.tostring(element, "unicode").replace("\r", "&#13;")


class Inventory:
    """What a document declares and holds."""

    def __init__(self, text):
        root = etree.fromstring(text)
        self.qualifiers = list(root.iter("QUALIFIER.DECLARATION"))
        self.classes = {cls.get("NAME"): cls for cls in root.iter("CLASS")}
        embedded = {id(inner) for instance in root.iter("INSTANCE") for inner in instance.iter("INSTANCE") if inner is not instance}
        self.instances = [instance for instance in root.iter("INSTANCE") if id(instance) not in embedded]

    def below(self, name):
        """The class and all below it."""
        names = {name}
        for cls in list(self.classes) * 2:
            names |= {other for other, element in self.classes.items() if element.get("SUPERCLASS") in names}
        return names

    def whole_class(self, name):
        """The class with what it inherits, as LocalOnly=FALSE asks for."""
        cls = copy.deepcopy(self.classes[name])
        seen = {(child.tag.split(".")[0], child.get("NAME")) for child in cls}
        above = self.classes.get(cls.get("SUPERCLASS"))
        while above is not None:
            for child in above:
                mark = (child.tag.split(".")[0], child.get("NAME"))
                if child.tag != "QUALIFIER" and mark not in seen:
                    seen.add(mark)
                    inherited = copy.deepcopy(child)
                    inherited.set("PROPAGATED", "true")
                    inherited.set("CLASSORIGIN", above.get("NAME"))
                    cls.append(inherited)
            above = self.classes.get(above.get("SUPERCLASS"))
        # A class has qualifiers, then properties, then methods.
        cls[:] = sorted(cls, key=lambda child: ("QUALIFIER", "PROPERTY", "METHOD").index(child.tag.split(".")[0]))
        return cls

    def keys(self, name):
        return [child.get("NAME") for child in self.whole_class(name) for qualifier in child.findall("QUALIFIER")
                if qualifier.get("NAME").lower() == "key" and "".join(qualifier.itertext()).strip().upper() == "TRUE"]

    def name_of(self, instance):
        cls = instance.get("CLASSNAME")
        bindings = ""
        for key in self.keys(cls):
            element = next(child for child in instance if child.get("NAME").lower() == key.lower())
            if element.tag == "PROPERTY.REFERENCE":
                value = to_text(element.find("VALUE.REFERENCE"))
            else:
                kind = {"string": "string", "datetime": "string", "char16": "string", "boolean": "boolean"}.get(element.get("TYPE"), "numeric")
                value = f'<KEYVALUE VALUETYPE="{kind}">{escape("".join(element.find("VALUE").itertext()))}</KEYVALUE>'
            bindings += f"<KEYBINDING NAME={quoteattr(key)}>{value}</KEYBINDING>"
        return f"<INSTANCENAME CLASSNAME={quoteattr(cls)}>{bindings}</INSTANCENAME>"


# What a server may do instead of answering. Each takes the handler and the right body.

def cim_error(code, description):
    def act(handler, unused):
        handler.answer(handler.message(f"<ERROR CODE=\"{code}\" DESCRIPTION={quoteattr(description)}/>"))
    return act


def http_status(status, body=b"<html><body>No.</body></html>", **headers):
    def act(handler, unused):
        handler.answer(body, status=status, content_type="text/html", headers=headers)
    return act


def body(text):
    def act(handler, unused):
        handler.answer(text.encode())
    return act


def changed(old, new):
    """The right body with something else in it."""
    def act(handler, right):
        assert old.encode() in right, (old, right)
        handler.answer(right.replace(old.encode(), new.encode()))
    return act


def cut(handler, right):
    """Ends the connection after half of the body."""
    handler.send_response(200)
    handler.send_header("Content-Length", str(len(right)))
    handler.end_headers()
    handler.wfile.write(right[:len(right) // 2])
    handler.close_connection = True


def cut_chunk(handler, right):
    handler.send_response(200)
    handler.send_header("Transfer-Encoding", "chunked")
    handler.end_headers()
    handler.wfile.write(b"%x\r\n" % len(right) + right[:len(right) // 2])
    handler.close_connection = True


def cut_xml(handler, right):
    """A whole answer of HTTP whose document ends early."""
    handler.answer(right[:len(right) // 2])


def chunked(handler, right):
    handler.send_response(200)
    handler.send_header("Transfer-Encoding", "chunked")
    handler.end_headers()
    for at in range(0, len(right), 100):
        piece = right[at:at + 100]
        handler.wfile.write(b"%x\r\n%s\r\n" % (len(piece), piece))
    handler.wfile.write(b"0\r\n\r\n")


def silent(handler, unused):
    """Takes the request, and then nothing happens until the client goes away."""
    handler.server.over.wait(30)
    handler.close_connection = True


def late(handler, right):
    """Answers after a while in which a person gets impatient."""
    handler.server.over.wait(1.5)
    handler.answer(right)


def trickle(handler, unused):
    """An answer that never ends, a byte now and then."""
    handler.send_response(200)
    handler.end_headers()
    handler.close_connection = True
    while not handler.server.over.is_set():
        handler.wfile.write(b" ")
        time.sleep(0.05)


def endless(handler, right):
    """An answer that never ends, as fast as it can."""
    handler.send_response(200)
    handler.end_headers()
    handler.close_connection = True
    start, end = right.split(b"<IRETURNVALUE>")
    member = end[:end.index(b"</VALUE.NAMEDINSTANCE>")] + b"</VALUE.NAMEDINSTANCE>"
    handler.wfile.write(start + b"<IRETURNVALUE>")
    while not handler.server.over.is_set():
        handler.wfile.write(member * 100)


class MadeServer(http.server.ThreadingHTTPServer):
    """Serves on a free port of the loopback interface while it is entered."""

    daemon_threads = True
    request_queue_size = 50

    def __init__(self, namespaces, has_pull=True, user=None, certificate=None, host="made"):
        super().__init__(("127.0.0.1", 0), _Handler)
        self.namespaces = {name: Inventory(text) for name, text in namespaces.items()}
        self.has_pull = has_pull
        self.authorization = user and "Basic " + base64.b64encode(":".join(user).encode()).decode()
        self.host = host
        self.scheme = "http"
        self.calls = []  # what was asked: "OpenEnumerateInstances CIM_Fan"
        self.headers = []
        self.over = threading.Event()
        self.contexts = {}
        self.rules = []
        if certificate:
            context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
            context.load_cert_chain(*certificate)
            self.socket = context.wrap_socket(self.socket, server_side=True, do_handshake_on_connect=False)
            self.scheme = "https"

    @property
    def url(self):
        return f"{self.scheme}://127.0.0.1:{self.server_port}"

    def misbehave(self, operation, subject, act, times=None):
        """Acts instead of answering that operation about that class ("" for none), a number of times or always."""
        self.rules.append([operation, subject, act, times])

    def right_answer(self, handler, unused, names):
        """The body; None for what is not offered."""
        return handler.message(handler.result(names))

    def act_for(self, operation, subject):
        for rule in self.rules:
            if rule[0] == operation and rule[1] in ("*", subject) and rule[3] != 0:
                rule[3] = rule[3] and rule[3] - 1
                return rule[2]
        return None

    def handle_error(self, *unused):
        """A client that goes away is no news."""

    def __enter__(self):
        threading.Thread(target=self.serve_forever, kwargs={"poll_interval": 0.05}, daemon=True).start()
        return self

    def __exit__(self, *unused):
        self.over.set()
        self.shutdown()
        self.server_close()


class _Handler(http.server.BaseHTTPRequestHandler):
    protocol_version = "HTTP/1.1"

    def do_POST(self):
        request = self.rfile.read(int(self.headers["Content-Length"]))
        call = etree.fromstring(request).find(".//IMETHODCALL")
        self.operation = call.get("NAME")
        names = {name.get("NAME"): "".join(name.itertext()) or name[0].get("NAME") for name in call.findall("IPARAMVALUE")}
        self.namespace = "/".join(part.get("NAME") for part in call.find("LOCALNAMESPACEPATH"))
        subject = names.get("ClassName", "")
        if names.get("EnumerationContext") in self.server.contexts:
            subject = self.server.contexts[names["EnumerationContext"]][0]
        self.server.calls.append(f"{self.operation} {subject}".strip())
        self.server.headers.append(self.headers)
        if self.server.authorization not in (None, self.headers["Authorization"]):
            self.answer(b"<html>Who?</html>", status=401, headers={"WWW-Authenticate": 'Basic realm="cim"'})
            return
        right = self.server.right_answer(self, request, names)
        act = self.server.act_for(self.operation, subject)
        if act:
            act(self, right)
        elif right is None:
            self.answer(b"", status=501)
        else:
            self.answer(right)

    def message(self, inner):
        return ('<?xml version="1.0" encoding="utf-8"?>\n<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLERSP>'
                f'<IMETHODRESPONSE NAME="{self.operation}">{inner}</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>').encode()

    def answer(self, right, status=200, content_type='application/xml; charset="utf-8"', headers=None):
        self.send_response(status)
        for name, value in (headers or {}).items():
            self.send_header(name.replace("_", "-"), value)
        self.send_header("Content-Type", content_type)
        self.send_header("Content-Length", str(len(right)))
        self.end_headers()
        self.wfile.write(right)

    def result(self, names):
        inventory = self.server.namespaces.get(self.namespace)
        if inventory is None:
            return f'<ERROR CODE="3" DESCRIPTION="{self.namespace}"/>'
        if "Pull" in self.operation or self.operation == "CloseEnumeration":
            return self.next_part(names)
        if self.operation == "EnumerateQualifiers":
            return self.returned(to_text(element) for element in inventory.qualifiers)
        if self.operation == "EnumerateClasses":
            return self.returned(to_text(inventory.whole_class(name)) for name in inventory.classes)
        if names["ClassName"] not in inventory.classes:
            return f'<ERROR CODE="5" DESCRIPTION="{names["ClassName"]}"/>'
        below = inventory.below(names["ClassName"])
        found = [instance for instance in inventory.instances if instance.get("CLASSNAME") in below]
        if self.operation == "EnumerateInstanceNames":
            return self.returned(inventory.name_of(instance) for instance in found)
        if self.operation == "EnumerateInstances":
            return self.returned(f'<VALUE.NAMEDINSTANCE>{inventory.name_of(instance)}{to_text(instance)}</VALUE.NAMEDINSTANCE>'
                                 for instance in found)
        if self.operation == "OpenEnumerateInstances" and self.server.has_pull:
            path = "".join(f'<NAMESPACE NAME="{part}"/>' for part in self.namespace.split("/"))
            context = str(len(self.server.contexts))
            self.server.contexts[context] = (names["ClassName"], [
                f"<VALUE.INSTANCEWITHPATH><INSTANCEPATH><NAMESPACEPATH><HOST>{self.server.host}</HOST><LOCALNAMESPACEPATH>{path}</LOCALNAMESPACEPATH></NAMESPACEPATH>"
                f'{inventory.name_of(instance)}</INSTANCEPATH>{to_text(instance)}</VALUE.INSTANCEWITHPATH>' for instance in found])
            return self.next_part(dict(names, EnumerationContext=context))
        return '<ERROR CODE="7" DESCRIPTION="no such operation here"/>'

    def next_part(self, names):
        context = names["EnumerationContext"]
        if context not in self.server.contexts:
            return '<ERROR CODE="21" DESCRIPTION="no such enumeration"/>'
        if self.operation == "CloseEnumeration":
            del self.server.contexts[context]
            return ""
        subject, left = self.server.contexts[context]
        most = int(names["MaxObjectCount"])
        self.server.contexts[context] = (subject, left[most:])
        is_end = len(left) <= most
        return self.returned(left[:most]) + (
            f'<PARAMVALUE NAME="EnumerationContext" PARAMTYPE="string"><VALUE>{"" if is_end else context}</VALUE></PARAMVALUE>'
            f'<PARAMVALUE NAME="EndOfSequence" PARAMTYPE="boolean"><VALUE>{str(is_end).upper()}</VALUE></PARAMVALUE>')

    @staticmethod
    def returned(members):
        return f"<IRETURNVALUE>{''.join(members)}</IRETURNVALUE>"

    def log_message(self, *unused):
        """Keeps quiet: the test says what went wrong."""
