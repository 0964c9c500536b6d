"""Starts a phone: prepares its folder, makes the sandbox, leaves a keeper behind.

The keeper holds the phone's lock and is the parent of the sandbox. When the keeper goes, however it
goes, the sandbox goes; when the sandbox goes, the keeper cleans up and ends.
"""

import ctypes
import os
import shutil
import signal
import subprocess
import sys

from lib import environment, image, leftovers, sandbox
from lib.report import Failure
from lib.state import ROOT

_LONGEST_RUN = 85  # a socket's path has 107 bytes at most
_PR_SET_PDEATHSIG, _PR_SET_CHILD_SUBREAPER = 1, 36


def boot(state, settings):
    """Returns when the phone is ready; yields what its user should know."""
    state.make()
    if not state.lock():
        raise Failure(f"a phone is already up in {state.folder}")
    leftovers.end(state)
    reason = sandbox.why_not()
    if reason and len(state.path("run")) > _LONGEST_RUN:
        raise Failure(f"without a sandbox the path {state.path('run')} is too long for sockets")
    settings["sandbox"] = "no (" + reason + ")" if reason else "yes"
    _prepare(state, settings)
    if reason:
        sandbox.Machine.take(state)
        yield f"running without a sandbox ({reason}): one phone at a time, in {state.folder}"
    ready, told = os.pipe2(os.O_CLOEXEC)
    if os.fork() == 0:
        os.close(ready)
        _keep(state, settings, reason, told)
    os.close(told)
    state.unlock()  # the keeper has it now
    with os.fdopen(ready, encoding="utf-8") as lines:
        for line in lines:
            if line.strip() == "ready":
                return
            if line.startswith("failed: "):
                raise Failure(line[len("failed: "):].strip())
            yield line.rstrip()
    raise Failure("the phone did not start, see " + state.path("log", "supervisor.log"))


def _prepare(state, settings):
    shutil.rmtree(state.path("run"), ignore_errors=True)
    shutil.rmtree(state.path("inbox"), ignore_errors=True)
    os.makedirs(state.path("inbox"), exist_ok=True)
    os.mkdir(state.path("run"), 0o700)
    os.mkdir(state.path("run", "log"))
    _configure_notifications(state, settings["screen"][0])
    state.save(settings)
    image.install(state, settings["build"])


def _configure_notifications(state, width):
    with open(os.path.join(ROOT, "phone", "etc", "dunstrc"), encoding="utf-8") as file:
        text = file.read().replace("width = 688", f"width = {width - 32}", 1)
    text = text.replace("RECORDER", os.path.join(ROOT, "phone", "lib", "phone-message"))
    with open(state.path("run", "dunstrc"), "w", encoding="utf-8") as file:
        file.write(text)


def _display_files(settings):
    """The socket and the key of the desktop's display, for the phone's window on it."""
    display = settings["display"] or ""
    if not display.startswith(":"):
        return []
    number = display[1:].partition(".")[0]
    return [f"/tmp/.X11-unix/X{number}", _key_file()]


def _key_file():
    return os.environ.get("XAUTHORITY") or os.path.expanduser("~/.Xauthority")


def _keep(state, settings, unboxed, told):
    """The keeper. Never returns."""
    status = 1
    try:
        os.setsid()
        _become_daemon(state, told)
        supervisor = _supervisor(state, settings, unboxed, told)
        os.close(told)
        for number in (signal.SIGTERM, signal.SIGINT, signal.SIGHUP):
            signal.signal(number, lambda *_: supervisor.terminate())
        _end_with(settings["while"], supervisor)
        status = supervisor.wait()
    except OSError as error:
        try:
            os.write(told, f"failed: cannot start the phone: {error}\n".encode())
        except OSError:
            pass
    finally:
        if unboxed:
            leftovers.end(state)
            _reap()
            sandbox.Machine.give_back(state)
        os._exit(status & 0xFF)


def _end_with(pid, supervisor):
    """The phone goes down when the process that it is for has gone."""
    if not pid:
        return
    import select
    import threading
    try:
        process = os.pidfd_open(pid)
    except OSError:
        supervisor.terminate()
        return

    def watch():
        select.select([process], [], [])
        supervisor.terminate()

    threading.Thread(target=watch, daemon=True).start()


def _reap():
    """Without a sandbox the keeper inherits what its children leave behind."""
    try:
        while os.waitpid(-1, os.WNOHANG) != (0, 0):
            pass
    except ChildProcessError:
        pass


def _become_daemon(state, told):
    """Keeps nothing of its caller: a pipe held open would make the caller's reader wait."""
    log = os.open(state.path("log", "supervisor.log"), os.O_WRONLY | os.O_CREAT | os.O_TRUNC, 0o644)
    null = os.open(os.devnull, os.O_RDONLY)
    os.dup2(null, 0)
    os.dup2(log, 1)
    os.dup2(log, 2)
    keep = {0, 1, 2, told, state.lock_file()}
    for name in os.listdir("/proc/self/fd"):
        if int(name) not in keep:
            try:
                os.close(int(name))
            except OSError:
                pass
    os.chdir(state.folder)
    sys.stdout = sys.stderr = open(2, "w", buffering=1, encoding="utf-8", closefd=False)


def _supervisor(state, settings, unboxed, told):
    before = ["/usr/bin/env"] if unboxed else sandbox.command(state, settings["build"],
                                                              _display_files(settings))
    home, run = (state.path("home"), state.path("run")) if unboxed else ("/opt/home", "/opt/run")
    variables = environment.machine(os.environ)
    if settings["display"]:
        variables["PHONE_DESKTOP_DISPLAY"] = settings["display"]
        variables["PHONE_DESKTOP_KEYS"] = _key_file()
    variables.pop("DISPLAY", None)
    variables.update(environment.phone(state, home, run, settings["language"]))
    libc = ctypes.CDLL(None)

    def tie():
        libc.prctl(_PR_SET_PDEATHSIG, signal.SIGTERM if unboxed else signal.SIGKILL)

    if unboxed:
        libc.prctl(_PR_SET_CHILD_SUBREAPER, 1)
    return subprocess.Popen(before + [os.path.join(ROOT, "phone", "lib", "supervisor"), str(told)],
                            env=variables, pass_fds=(told,), preexec_fn=tie)
