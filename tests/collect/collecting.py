"""What the tests of `cimdelta collect --from` share: documents, servers, and the program run in a folder of its own.

The arguments of each test are ROOT CIMDELTA.
"""
import os
import pathlib
import pty
import re
import select
import subprocess
import sys
import tempfile
import termios
import time
import unittest

import made_server
import recorded_server

ROOT, CIMDELTA = pathlib.Path(sys.argv[1]).resolve(), str(pathlib.Path(sys.argv[2]).resolve())
DATA = ROOT / "tests/data"

RECORDINGS = ("025-pywbem-EnumerateClasses", "027-pywbem-EnumerateQualifiers", "030-pywbem-EnumerateInstances", "007-wbemcli-ei-assoc")


def document(*classes, instances=()):
    """A document with classes ("Fan", "Fan:Top"; "*Top" is abstract) and instances ("Fan", "1")."""
    text = ""
    for name in classes:
        is_abstract, name = name.startswith("*"), name.lstrip("*")
        name, _, above = name.partition(":")
        text += (f'<VALUE.OBJECT><CLASS NAME="{name}"' + (f' SUPERCLASS="{above}"' if above else "") + ">"
                 + ('<QUALIFIER NAME="Abstract" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>' if is_abstract else "")
                 + ("" if above else '<PROPERTY NAME="Id" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>')
                 + "</CLASS></VALUE.OBJECT>")
    for name, key in instances:
        text += f'<VALUE.OBJECT><INSTANCE CLASSNAME="{name}"><PROPERTY NAME="Id" TYPE="string"><VALUE>{key}</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>'
    return f"<CIM><DECLARATION><DECLGROUP>{text}</DECLGROUP></DECLARATION></CIM>"


SMALL = document("*Top", "Disk:Top", "Fan:Top", "Volume:Top", instances=[("Disk", "sda"), ("Disk", "sdb"), ("Fan", "1"), ("Volume", "v")])


class TCollect(unittest.TestCase):
    """Verbs."""

    maxDiff = None

    def setUp(self):
        scratch = tempfile.TemporaryDirectory()
        self.addCleanup(scratch.cleanup)
        self.folder = pathlib.Path(scratch.name)
        self.environment = {name: value for name, value in os.environ.items() if not name.lower().endswith("_proxy")}
        self.environment.update(CIMDELTA_ROOT=str(ROOT), HOME=str(self.folder))

    def serve(self, namespaces=None, **how):
        server = made_server.MadeServer(namespaces or {"root/cimv2": SMALL}, **how)
        server.__enter__()
        self.addCleanup(server.__exit__)
        return server

    def serve_recordings(self, recordings=RECORDINGS, **how):
        server = recorded_server.RecordedServer(DATA / "wire", recordings, **how)
        server.__enter__()
        self.addCleanup(server.__exit__)
        return server

    def run_program(self, *arguments, **environment):
        return subprocess.run([CIMDELTA, *map(str, arguments)], cwd=self.folder, env=dict(self.environment, **environment), stdin=subprocess.DEVNULL,
                              stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True, check=False, timeout=60, start_new_session=True)

    def collect(self, server, *arguments, **environment):
        """Collects into out.xml. Returns the messages."""
        self.result = self.run_program("collect", "--from", server.url, "-o", "out.xml", *arguments, **environment)
        self.assertEqual("", self.result.stdout)
        return self.result.stderr.replace(server.url, "SERVER")

    def assert_collected(self, server, *arguments, **environment):
        self.assertEqual("", self.collect(server, *arguments, **environment))
        self.assertEqual(0, self.result.returncode)
        self.assertEqual(["out.xml"], self.files())

    def assert_refused(self, message, server, *arguments, **environment):
        """Ends with trouble, that message and no file."""
        self.assertEqual(message + "\n", self.collect(server, *arguments, **environment))
        self.assertEqual(2, self.result.returncode)
        self.assertEqual([], self.files())

    def files(self):
        return sorted(path.name for path in self.folder.iterdir() if path.suffix != ".pem" and path.name != "netrc")

    def shown(self, path="out.xml"):
        return self.run_program("show", path).stdout

    def certificate(self, name="localhost", alternative="IP:127.0.0.1", is_expired=False):
        """A self-signed certificate; returns the files of it and its key."""
        files = self.folder / "cert.pem", self.folder / "key.pem"
        subprocess.run(["openssl", "req", "-x509", "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:prime256v1", "-nodes", "-days", "1", "-subj", f"/CN={name}",
                        "-addext", f"subjectAltName={alternative}", "-keyout", files[1], "-out", files[0]], check=True, stderr=subprocess.DEVNULL)
        if is_expired:
            subprocess.run(["openssl", "x509", "-in", files[0], "-signkey", files[1], "-days", "-1", "-out", files[0]], check=True, stderr=subprocess.DEVNULL)
        return [str(file) for file in files]

    def talk(self, server, *lines, **environment):
        """Runs on a terminal and types each line when a question has come. Returns what the terminal showed."""
        pid, terminal = pty.fork()
        if pid == 0:
            os.chdir(self.folder)
            os.execve(CIMDELTA, [CIMDELTA, "collect", "--from", server.url, "-o", "out.xml"], dict(self.environment, **environment))
        shown, left = "", list(lines)
        end = time.monotonic() + 60
        while time.monotonic() < end:
            if select.select([terminal], [], [], 0.1)[0]:
                try:
                    piece = os.read(terminal, 4096).decode()
                except OSError:
                    break
                shown += piece
            if left and shown.endswith(": ") and not select.select([terminal], [], [], 0.2)[0]:
                line = left.pop(0)
                os.write(terminal, line if isinstance(line, bytes) else (line + "\n").encode())
        self.status = os.waitstatus_to_exitcode(os.waitpid(pid, 0)[1])
        self.shows_typing = bool(termios.tcgetattr(terminal)[3] & termios.ECHO)
        os.close(terminal)
        return re.sub(r"\x1b\[K|\r", "", shown).replace(server.url, "SERVER")
