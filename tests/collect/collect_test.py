#!/usr/bin/env python3
"""Runs the scripts of data/collect against recorded answers of a CIM server, and loads what they save.

Arguments: ROOT CIMDELTA. Needs curl. pywbem is no package of Debian, so the module in stand_in/ takes its place: it makes the two calls of the script.
"""
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest

import replay_server

ROOT, CIMDELTA = pathlib.Path(sys.argv[1]).resolve(), str(pathlib.Path(sys.argv[2]).resolve())
RECORDINGS = ("025-pywbem-EnumerateClasses", "030-pywbem-EnumerateInstances", "007-wbemcli-ei-assoc")
ALL = "DEB_PackageDependency: 73 instances\nDEB_Package: 94 instances\n"


class CollectTest(unittest.TestCase):
    def setUp(self):
        scratch = tempfile.TemporaryDirectory()
        self.addCleanup(scratch.cleanup)
        self.folder = pathlib.Path(scratch.name)
        self.server = replay_server.ReplayServer(ROOT / "tests/data/wire", RECORDINGS)
        self.server.__enter__()
        self.addCleanup(self.server.__exit__)

    def run_in_folder(self, *command, **environment):
        return subprocess.run(command, cwd=self.folder, env=dict(os.environ, CIMDELTA_ROOT=str(ROOT), **environment),
                              stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True, check=False)

    def shown(self, *arguments):
        result = self.run_in_folder(CIMDELTA, "show", *arguments)
        self.assertEqual(0, result.returncode, result.stderr)
        return result.stdout

    def collect_with_curl(self, *classes):
        return self.run_in_folder(str(ROOT / "data/collect/curl_inventory.sh"), self.server.url, "root/deb", "array1", *classes)

    def test_what_curl_saves_is_an_inventory(self):
        result = self.collect_with_curl("DEB_Package", "DEB_PackageDependency")
        self.assertEqual((0, ""), (result.returncode, result.stderr))
        self.assertEqual(ALL, self.shown("array1"))

    def test_curl_asks_for_the_keys_and_for_all_properties(self):
        self.collect_with_curl("DEB_Package")
        for name, value, requests in (("IncludeQualifiers", "TRUE", self.server.requests[:1]), ("LocalOnly", "FALSE", self.server.requests)):
            for request in requests:
                self.assertIn(f'<IPARAMVALUE NAME="{name}"><VALUE>{value}</VALUE></IPARAMVALUE>', request.decode())

    def test_curl_ends_with_an_error_if_the_server_does(self):
        result = self.collect_with_curl("DEB_Nothing")
        self.assertNotEqual(0, result.returncode)
        self.assertIn("501", result.stderr)

    def test_curl_overwrites_nothing(self):
        (self.folder / "array1").mkdir()
        self.assertNotEqual(0, self.collect_with_curl("DEB_Package").returncode)
        self.assertEqual([], self.server.requests)

    def collect_with_pywbem(self):
        script = ROOT / "data/collect/pywbem_inventory.py"
        return self.run_in_folder(sys.executable, str(script), self.server.url.removesuffix("/cimom"), "root/deb", "array1",
                                  HOME=str(self.folder), PYTHONPATH=str(ROOT / "tests/collect/stand_in"))

    def test_what_pywbem_saves_is_an_inventory(self):
        (self.folder / ".netrc").write_text("machine 127.0.0.1 login someone password secret\n")
        (self.folder / ".netrc").chmod(0o600)
        result = self.collect_with_pywbem()
        self.assertEqual((0, ""), (result.returncode, result.stderr))
        self.assertEqual(["DEB_Package.xml", "DEB_PackageDependency.xml", "classes.xml"], sorted(os.listdir(self.folder / "array1")))
        self.assertEqual(ALL, self.shown("array1"))

    def test_pywbem_needs_no_password(self):
        result = self.collect_with_pywbem()
        self.assertEqual((0, ""), (result.returncode, result.stderr))
        self.assertEqual(["DEB_Package.xml", "DEB_PackageDependency.xml", "classes.xml"], sorted(os.listdir(self.folder / "array1")))

    def test_what_wbemcli_prints_becomes_an_inventory(self):
        """The recipe of the manual, over what wbemcli -dx prints of a recorded answer."""
        recipe = re.search(r"wbemcli -dx .*\|\s*(sed .*?) >", (ROOT / "docs/inventories.md").read_text()).group(1)
        headers, body = self.server.answers[(b"EnumerateInstances", b"root/deb", b"DEB_Package")].decode().split("\r\n\r\n", 1)
        lines = headers.split("\r\n")[1:]
        (self.folder / "printed").write_text("".join(f"From server: {line}\n" for line in lines) + "From server: " + body)
        result = self.run_in_folder("sh", "-c", recipe + " < printed > packages.xml")
        self.assertEqual(0, result.returncode, result.stderr)
        self.assertEqual("DEB_Package: 94 instances\n", self.shown("packages.xml", "--infer-classes"))


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
