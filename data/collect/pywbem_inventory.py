#!/usr/bin/env python3
"""Saves what a WBEM server knows of a system: a folder of its answers, which cimdelta loads as one inventory.

    pywbem_inventory.py https://array1:5989 root/cimv2 array1

Takes all classes and instances of the namespace. Needs pywbem 1.0 or later. User and password come from ~/.netrc. If it
does not name the server, or is not there, the server is asked without them.
"""
import netrc
import os
import sys
from urllib.parse import urlsplit

import pywbem

if len(sys.argv) != 4:
    sys.exit(__doc__)
url, namespace, folder = sys.argv[1:]
try:
    user, _, password = netrc.netrc().authenticators(urlsplit(url).hostname) or (None, None, None)
except FileNotFoundError:
    user = password = None
server = pywbem.WBEMConnection(url, (user, password) if user else None, default_namespace=namespace)
os.mkdir(folder)


def save(name):
    """Saves the last answer as it came."""
    with open(os.path.join(folder, name + ".xml"), "wb") as file:
        file.write(server.last_raw_reply)


classes = server.EnumerateClasses(DeepInheritance=True, LocalOnly=False, IncludeQualifiers=True)
save("classes")
for top in (cls.classname for cls in classes if cls.superclass is None):
    server.EnumerateInstances(top, DeepInheritance=True, LocalOnly=False)
    save(top)
