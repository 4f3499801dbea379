"""A WBEM server that gives recorded answers, and misbehaves as a made one does (see made_server).

It knows the recordings by what they ask for: the operation, the namespace and the class. An exchange that was recorded several times is given in that
order. What was not recorded is not offered: HTTP 501.
"""
import re

import made_server
import replay_server


def bodies(recording):
    """The bodies of a file of messages of HTTP, one behind the other, each with its Content-Length."""
    while recording:
        head, rest = recording.split(b"\r\n\r\n", 1)
        length = int(re.search(rb"(?i)content-length: *(\d+)", head).group(1))
        yield rest[:length]
        recording = rest[length:]


class RecordedServer(made_server.MadeServer):
    """The recordings NNN-client-Operation of a folder, over HTTP or, with a certificate, TLS."""

    def __init__(self, folder, recordings, **how):
        super().__init__({}, **how)
        self.answers = {}
        for recording in recordings:
            requests, answers = (list(bodies(replay_server.recorded(folder, recording + end))) for end in (".request", ".response"))
            assert len(requests) == len(answers), recording
            for request, answer in zip(requests, answers):
                self.answers.setdefault(replay_server.subject_of(request), []).append(answer)

    def right_answer(self, handler, request, names):
        answers = self.answers.get(replay_server.subject_of(request))
        if not answers:
            return None
        return answers.pop(0) if len(answers) > 1 else answers[0]
