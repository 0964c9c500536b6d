"""A phone's state folder: where everything is that belongs to one phone."""

import fcntl
import json
import os
import time

from lib.report import Failure

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
VIEWER = "com.orlant.zelqo"
_FOLDERS = ("opt-usr/apps", "opt-usr/dbspace", "opt-usr/media/Downloads", "opt-usr/media/Images",
            "opt-usr/media/Videos", "opt-usr/media/Music", "opt-usr/media/Documents",
            "opt-usr/share", "home", "services", "system-services", "log", "inbox")


class State:
    """Paths and settings. The settings are those of the last `phone up`, with the language of today."""

    def __init__(self, folder=None):
        folder = folder or os.environ.get("PHONE_STATE") or os.path.join(ROOT, "build", "phone")
        self.folder = os.path.realpath(folder)
        self._lock = None

    def path(self, *parts):
        return os.path.join(self.folder, *parts)

    def make(self):
        try:
            for folder in _FOLDERS:
                os.makedirs(self.path(folder), exist_ok=True)
            os.chmod(self.path("opt-usr/dbspace"), 0o700)
        except OSError as error:
            raise Failure(f"cannot use {self.folder}: {error.strerror}") from None

    def settings(self):
        try:
            with open(self.path("phone.json"), encoding="utf-8") as file:
                return json.load(file)
        except (OSError, ValueError):
            return {}

    def save(self, settings):
        with open(self.path("phone.json.new"), "w", encoding="utf-8") as file:
            json.dump(settings, file, indent=1)
        os.rename(self.path("phone.json.new"), self.path("phone.json"))

    def tool(self, name):
        """The path of a program of the build that the phone was started with."""
        return os.path.join(self.settings().get("build", ""), "bin", name)

    def lock(self, patience=0.0):
        """True when no phone runs here; nobody else can start one until this process (and those
        that it forked) have ended."""
        if not os.path.isdir(self.folder):
            return True
        file = os.open(self.path("lock"), os.O_RDWR | os.O_CREAT | os.O_CLOEXEC, 0o600)
        end = time.monotonic() + patience
        while True:
            try:
                fcntl.flock(file, fcntl.LOCK_EX | fcntl.LOCK_NB)
                self._lock = file
                return True
            except BlockingIOError:
                if time.monotonic() >= end:
                    os.close(file)
                    return False
                time.sleep(0.01)

    def lock_file(self):
        return self._lock

    def unlock(self):
        if self._lock is not None:
            os.close(self._lock)
            self._lock = None


def find_build(wanted=None):
    """The build folder whose programs and image the phone uses."""
    wanted = wanted or os.environ.get("PHONE_BUILD")
    if wanted:
        if not os.path.isdir(wanted):
            raise Failure(f"there is no build in {wanted}")
        return os.path.realpath(wanted)
    presets = [os.path.join(ROOT, "build", name) for name in ("dev", "release", "asan")]
    return next((folder for folder in presets if os.path.isdir(folder)), presets[0])
