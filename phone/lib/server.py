"""Answers the commands that come from outside, each in its own thread."""

import os
import selectors
import signal
import subprocess
import threading

from lib import link
from lib.report import Failure


def serve(phone, listener):
    """Until a signal ends it."""
    while True:
        connection, _ = listener.accept()
        threading.Thread(target=_answer, args=(phone, connection), daemon=True).start()


def _answer(phone, connection):
    with connection:
        files = []
        try:
            message, files = link.receive(connection)
            if message is not None:
                link.send(connection, _try(phone, message, files, connection))
        except (OSError, ValueError) as error:
            print(f"a caller was not served: {error!r}", flush=True)
        finally:
            for file in files:
                os.close(file)


def _try(phone, message, files, connection):
    try:
        return _do(phone, message, files, connection)
    except Failure as failure:
        return {"error": str(failure)}
    except (OSError, ValueError, KeyError, TypeError) as error:
        print(f"{message} failed: {error!r}", flush=True)
        return {"error": f"the phone failed: {error!r}"}


def _do(phone, message, files, connection):
    what = message["do"]
    if what == "run":
        return {"status": _run(phone, message, files, connection)}
    if what == "status":
        return phone.status()
    if what == "language":
        phone.set_language(message["language"])
        return {}
    if what == "service":
        phone.sharing.change(message["mode"], message.get("delay", 0))
        return {}
    if what == "wait":
        phone.over.wait()
        return {}
    if what == "down":
        os.kill(os.getpid(), signal.SIGTERM)
        return {}
    raise Failure(f"the phone cannot {what}")


def _run(phone, message, files, connection):
    """Runs a program for a caller, in a process group of its own that ends when the caller goes."""
    folder = message["cwd"] if os.path.isdir(message["cwd"]) else phone.environment["HOME"]
    env = {key: value for key, value in message["env"].items() if "=" not in key}
    env.update(phone.environment)
    try:
        process = subprocess.Popen(message["argv"], cwd=folder, env=env, stdin=files[0],
                                   stdout=files[1], stderr=files[2], start_new_session=True)
    except OSError as error:
        raise Failure(f"{message['argv'][0]}: {error.strerror}") from None
    while files:
        os.close(files.pop())
    ended = os.pidfd_open(process.pid)
    with selectors.DefaultSelector() as selector:
        selector.register(ended, selectors.EVENT_READ)
        selector.register(connection, selectors.EVENT_READ)
        gone = all(key.fd != ended for key, _ in selector.select())
    os.close(ended)
    if gone:
        os.killpg(process.pid, signal.SIGHUP)
        os.killpg(process.pid, signal.SIGTERM)
    status = process.wait()
    return status if status >= 0 else 128 - status
