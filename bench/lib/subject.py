"""The phone on which everything is measured, and what is asked of it."""

import contextlib
import json
import os
import shutil
import sqlite3
import subprocess
import tempfile
import time

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
BUILD = os.path.join(ROOT, "build", "bench")
ME = "+821012345678"
VIEWER = "com.orlant.zelqo"
SHARED = f"opt-usr/apps/{VIEWER}/shared/data"
PROGRAM = "/opt/usr/apps/com.orlant.zelqo/bin/zelqo-viewer"


def tool(name):
    return os.path.join(BUILD, "bin", name)


def address_of(share, number):
    """Where a file of an announced share would be, if there were one."""
    return f"http://b.invalid/{share}/{number}"


class Subject:
    """A phone with a state folder of its own, which a run begins anew."""

    def __init__(self):
        self.folder = os.path.join(BUILD, "subject")
        self.work = os.path.join(BUILD, "work")
        os.makedirs(self.work, exist_ok=True)
        os.environ["PHONE_BUILD"] = BUILD

    def forget(self):
        shutil.rmtree(self.folder, ignore_errors=True)

    def path(self, *parts):
        return os.path.join(self.folder, *parts)

    def call(self, *words, check=True):
        done = subprocess.run([os.path.join(ROOT, "phone", "phone"), "--state", self.folder,
                               *map(str, words)], text=True, stdout=subprocess.PIPE, check=False)
        if check and done.returncode != 0:
            raise SystemExit(f"bench: phone {' '.join(map(str, words[:6]))}: failed")
        return done.stdout

    def shell(self, script):
        return self.call("shell", "sh", "-c", script)

    def up(self):
        """Seconds until it was ready."""
        begin = time.monotonic()
        self.call("up", "--headless", "--while", os.getpid())
        spent = time.monotonic() - begin
        self._take_precedence()
        return spent

    def _take_precedence(self):
        """Other work on the machine disturbs less so; without the right to it, nothing changes."""
        self.shell("for group in /proc/[0-9]*/autogroup; do echo -15 >$group; done 2>/dev/null;"
                   "true")

    def down(self):
        self.call("down", check=False)

    def service(self):
        return next(line.split()[1] for line in self.call("status").splitlines()
                    if line.strip().startswith("service: http"))

    def stopwatch(self, *words, check=True):
        """What the stopwatch printed, by name; nothing when what it waited for did not come."""
        line = self.call("shell", tool("stopwatch"), *words, check=check).split()
        return {name: float(value) for name, value in zip(line[::2], line[1::2])}

    # --- programs ---

    def pid(self, program):
        """Of the process that runs that program or, of several, of the one started last."""
        found = self.shell(f"pidof {program} || true").split()
        return found[0] if found else None

    def end(self, program):
        self.shell(f"for p in $(pidof {program}); do kill -9 $p; done;"
                   f"while pidof {program} >/dev/null; do sleep 0.02; done; sleep 0.1")

    def memory(self, program, what="VmRSS"):
        """Megabytes; VmHWM is the most that there was."""
        status = self.shell(f"cat /proc/{self.pid(program)}/status")
        return next(int(line.split()[1]) for line in status.splitlines()
                    if line.startswith(what + ":")) / 1024

    def forget_peak(self, program):
        """From here on, VmHWM is the most that there was since."""
        self.shell(f"echo 5 >/proc/{self.pid(program)}/clear_refs")

    # --- shares ---

    def share(self, files):
        return self._token("share", "--from", "+821011112222", "--to", ME, *files)

    def announce(self, name, pictures):
        """A share of so many files whose thumbnails are all on the phone already."""
        # Short, for the service takes announcements of 2 MiB.
        files = [{"name": f"{number:05}.png", "size": 150000, "type": "image/png",
                  "url": address_of(name, number), "thumb": address_of(name, number) + "/t",
                  "mid": address_of(name, number) + "/m"} for number in range(len(pictures))]
        manifest = os.path.join(self.work, name + ".json")
        with open(manifest, "w", encoding="utf-8") as file:
            json.dump(files, file, separators=(",", ":"))
        self._remember(files, pictures)
        return self._token("share", "--from", "+821011112222", "--to", ME,
                           "--raw-manifest", manifest)

    def _token(self, *words):
        return next(line.split()[1] for line in self.call(*words).splitlines()
                    if line.startswith("token:"))

    def _remember(self, files, pictures):
        """What the viewer writes down when a thumbnail has arrived."""
        with contextlib.closing(self._preferences()) as base, base:
            base.executemany("INSERT OR REPLACE INTO pref VALUES(?, ?)",
                             [(file[kind], picture) for file, picture in zip(files, pictures)
                              for kind in ("thumb", "mid")])

    def put_away(self, folder):
        """Instead of deleting it, after which a file system may be slow to make files for minutes."""
        away = tempfile.mkdtemp(dir=self.path("opt-usr"))
        with contextlib.suppress(FileNotFoundError):
            os.rename(folder, os.path.join(away, "was"))

    def forget_thumbnails(self, keys):
        """Nothing of them is on the phone any more."""
        for name in ("thumbnail", "fullview_thumbnail"):
            self.put_away(self.path(SHARED, name))
        with contextlib.closing(self._preferences()) as base, base:
            base.executemany("DELETE FROM pref WHERE k = ?", [(key,) for key in keys])

    def _preferences(self):
        base = sqlite3.connect(self.path(f"opt-usr/apps/{VIEWER}/data/.pref.db"), timeout=3)
        base.execute("CREATE TABLE IF NOT EXISTS pref(k TEXT PRIMARY KEY, v) WITHOUT ROWID")
        return base
