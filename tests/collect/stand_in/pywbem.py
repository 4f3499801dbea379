"""Stands in for pywbem: the two calls that data/collect/pywbem_inventory.py makes, with the parameters that it passes."""
import re
import types
import urllib.request


class WBEMConnection:
    def __init__(self, url, creds=None, default_namespace=None):
        self.url, self.creds, self.namespace = url, creds, default_namespace
        self.last_raw_reply = None

    def _call(self, method, name=None, **parameters):
        steps = "".join(f'<NAMESPACE NAME="{step}"/>' for step in self.namespace.split("/"))
        subject = f'<IPARAMVALUE NAME="ClassName"><CLASSNAME NAME="{name}"/></IPARAMVALUE>' if name else ""
        values = "".join(f'<IPARAMVALUE NAME="{key}"><VALUE>{str(value).upper()}</VALUE></IPARAMVALUE>' for key, value in parameters.items())
        call = f'<IMETHODCALL NAME="{method}"><LOCALNAMESPACEPATH>{steps}</LOCALNAMESPACEPATH>{subject}{values}</IMETHODCALL>'
        request = f'<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLEREQ>{call}</SIMPLEREQ></MESSAGE></CIM>'
        with urllib.request.urlopen(self.url + "/cimom", request.encode()) as answer:
            self.last_raw_reply = answer.read()
        return self.last_raw_reply.decode()

    def EnumerateClasses(self, **parameters):
        found = re.findall(r'<CLASS NAME="([^"]+)"( SUPERCLASS="[^"]+")?', self._call("EnumerateClasses", **parameters))
        return [types.SimpleNamespace(classname=name, superclass=superclass or None) for name, superclass in found]

    def EnumerateInstances(self, name, **parameters):
        self._call("EnumerateInstances", name, **parameters)
