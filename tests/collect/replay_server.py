"""A WBEM server that gives recorded answers.

It knows the folder of recordings: NNN-client-Operation.request and .response, each the raw bytes of one exchange. A request is
answered like the recorded one with the same operation, namespace and class; with 501 if there is none.
"""
import http.server
import lzma
import os
import re
import threading


def subject_of(request):
    """What a request asks for: the operation, the namespace and, if it names one, the class."""
    operation = re.search(rb'IMETHODCALL NAME="([^"]+)"', request)
    namespace = b"/".join(re.findall(rb'<NAMESPACE NAME="([^"]+)"', request))
    name = re.search(rb'<CLASSNAME NAME="([^"]+)"', request)
    return operation and (operation.group(1), namespace, name.group(1) if name else None)


def recorded(folder, name):
    """The bytes of a recording, which may be compressed."""
    path = os.path.join(folder, name)
    with open(path, "rb") if os.path.exists(path) else lzma.open(path + ".xz") as file:
        return file.read()


class ReplayServer(http.server.ThreadingHTTPServer):
    """Serves on a free port of the loopback interface while it is entered."""

    def __init__(self, folder, recordings):
        super().__init__(("127.0.0.1", 0), _Handler)
        self.answers = {}
        self.requests = []
        for recording in recordings:
            self.answers[subject_of(recorded(folder, recording + ".request"))] = recorded(folder, recording + ".response")

    @property
    def url(self):
        return "http://127.0.0.1:%d/cimom" % self.server_port

    def __enter__(self):
        threading.Thread(target=self.serve_forever, daemon=True).start()
        return self

    def __exit__(self, *unused):
        self.shutdown()
        self.server_close()


class _Handler(http.server.BaseHTTPRequestHandler):
    def do_POST(self):
        body = self.rfile.read(int(self.headers["Content-Length"]))
        self.server.requests.append(body)
        answer = self.server.answers.get(subject_of(body))
        if answer is None:
            self.send_error(501)
            return
        self.wfile.write(answer)
        self.close_connection = True

    def log_message(self, *unused):
        """Keeps quiet: the test says what went wrong."""
