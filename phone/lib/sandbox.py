"""Where the phone's processes live: in a bubblewrap sandbox that has its own /opt/usr and its own
process ids, or, where the machine does not allow that, on the machine itself."""

import os
import subprocess

from lib.report import Failure
from lib.state import ROOT

MACHINE = "/opt/usr"


def why_not():
    """None when a sandbox can be made, else the reason in one line."""
    if os.environ.get("PHONE_SANDBOX") == "none":
        return "PHONE_SANDBOX=none"
    try:
        probe = subprocess.run(["bwrap", "--dev-bind", "/", "/", "--tmpfs", "/tmp", "--unshare-pid",
                                "--proc", "/proc", "true"],
                               stdin=subprocess.DEVNULL, capture_output=True, text=True)
    except FileNotFoundError:
        return "bubblewrap is not installed"
    if probe.returncode == 0:
        return None
    lines = probe.stderr.strip().splitlines()
    return lines[-1] if lines else "bwrap failed"


def command(state, build, display):
    """The bwrap call before the program and its arguments."""
    bwrap = ["bwrap", "--dev-bind", "/", "/", "--tmpfs", "/tmp", "--perms", "1777",
             "--dir", "/tmp/.X11-unix", "--tmpfs", "/opt", "--bind", state.path("opt-usr"), MACHINE]
    for name in sorted(os.listdir("/opt")) if os.path.isdir("/opt") else ():
        if name not in ("usr", "home", "run"):
            bwrap += ["--bind", os.path.join("/opt", name), os.path.join("/opt", name)]
    for folder in (ROOT, build, state.folder):
        if folder.startswith("/tmp/"):
            bwrap += ["--bind-try", folder, folder]
    if os.path.isdir("/run/systemd/journal"):  # the phone's log is its own
        bwrap += ["--tmpfs", "/run/systemd/journal"]
    for file in display:
        bwrap += ["--ro-bind-try", file, file]
    return bwrap + ["--bind", state.path("run"), "/opt/run", "--bind", state.path("home"),
                    "/opt/home", "--unshare-pid", "--proc", "/proc", "--die-with-parent", "--"]


class Machine:
    """/opt/usr of the machine itself, lent to one phone at a time."""

    @staticmethod
    def take(state):
        mine = state.path("opt-usr")
        if os.path.islink(MACHINE) and os.readlink(MACHINE) == mine:
            return
        try:
            if os.path.islink(MACHINE) and not Machine._in_use(os.readlink(MACHINE)):
                os.unlink(MACHINE)
            os.makedirs(os.path.dirname(MACHINE), exist_ok=True)
            os.symlink(mine, MACHINE)
        except FileExistsError:
            Machine._explain()
        except OSError as error:
            raise Failure(f"without a sandbox the phone needs {MACHINE} as a link to {mine}, and "
                          f"cannot make it: {error.strerror}") from None

    @staticmethod
    def give_back(state):
        if os.path.islink(MACHINE) and os.readlink(MACHINE) == state.path("opt-usr"):
            try:
                os.unlink(MACHINE)
            except OSError:
                pass

    @staticmethod
    def _in_use(target):
        from lib.state import State
        other = State(os.path.dirname(target))
        free = other.lock()
        other.unlock()
        return not free

    @staticmethod
    def _explain():
        if os.path.islink(MACHINE):
            raise Failure("without a sandbox there is one phone at a time, and one runs in "
                          + os.path.dirname(os.readlink(MACHINE)))
        raise Failure(f"without a sandbox the phone needs {MACHINE}, which belongs to this machine")
