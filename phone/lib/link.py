"""The line between the command outside and the supervisor inside: a socket in the state folder.

A request is one line of JSON; the three standard files of the caller may travel with it. The answer
is one line of JSON. When the caller goes away before the answer, what runs for it is ended.
"""

import json
import os
import socket

from lib.report import Failure

_SOCKET = "control"


def _bounded(folder):
    """A path to the folder that is short enough for a socket address, however deep the folder is.
    Valid while the returned file is open."""
    file = os.open(folder, os.O_PATH | os.O_CLOEXEC)
    return file, f"/proc/self/fd/{file}/{_SOCKET}"


def listen(folder):
    file, path = _bounded(folder)
    try:
        server = socket.socket(socket.AF_UNIX, socket.SOCK_STREAM)
        server.bind(path)
        server.listen(64)
        return server
    finally:
        os.close(file)


def _connect(state):
    try:
        file, path = _bounded(state.path("run"))
    except OSError:
        return None
    try:
        connection = socket.socket(socket.AF_UNIX, socket.SOCK_STREAM)
        connection.connect(path)
        return connection
    except OSError:
        connection.close()
        return None
    finally:
        os.close(file)


def send(connection, message, files=()):
    data = json.dumps(message).encode() + b"\n"
    sent = socket.send_fds(connection, [data], list(files)) if files else 0
    if sent < len(data):  # sending nothing fails when the answer came at once
        connection.sendall(data[sent:])


def receive(connection):
    """(message, files); message is None when the other side hung up."""
    data, files, _, _ = socket.recv_fds(connection, 65536, 8)
    while data and not data.endswith(b"\n"):
        more = connection.recv(65536)
        if not more:
            return None, files
        data += more
    return (json.loads(data) if data else None), files


def request(state, message, files=()):
    """The supervisor's answer, or None when no phone runs."""
    connection = _connect(state)
    if connection is None:
        return None
    with connection:
        try:
            send(connection, message, files)
            answer = receive(connection)[0]
        except (BrokenPipeError, ConnectionResetError):
            answer = None
    return {"error": "the phone went down"} if answer is None else answer


def ask(state, message, files=()):
    """As request, but a phone that is down or says no is a failure."""
    answer = request(state, message, files)
    if answer is None:
        raise Failure("the phone is down; start it with: phone up")
    if "error" in answer:
        raise Failure(answer["error"])
    return answer


def run(state, argv, stdin=0, stdout=1, stderr=2, env=None):
    """Runs a program inside the phone with these files; its exit status."""
    message = {"do": "run", "argv": argv, "cwd": os.getcwd(),
               "env": dict(os.environ if env is None else env)}
    return ask(state, message, (stdin, stdout, stderr))["status"]


def output(state, argv, errors=False):
    """Runs a program inside the phone; what it printed, or, with errors, what it complained of. A
    failing program is a failure."""
    with open(os.devnull, "rb") as nothing, _Capture() as out, _Capture() as err:
        status = run(state, argv, nothing.fileno(), out.fileno(), err.fileno())
        if status != 0:
            lines = err.text().strip().splitlines() or [f"{argv[0]} failed with status {status}"]
            raise Failure(lines[-1])
        return err.text() if errors else out.text()


class _Capture:
    """A file in memory that another process writes."""

    def __init__(self):
        self._file = os.memfd_create("phone", os.MFD_CLOEXEC)

    def __enter__(self):
        return self

    def __exit__(self, *_):
        os.close(self._file)

    def fileno(self):
        return self._file

    def text(self):
        size = os.fstat(self._file).st_size
        return os.pread(self._file, size, 0).decode("utf-8", "replace")
