"""Processes that a phone without a sandbox may leave behind when it is killed."""

import os
import signal
import time


def _of(state):
    mark = b"PHONE_ID=" + os.fsencode(state.folder)
    found = []
    for name in os.listdir("/proc"):
        if not name.isdigit() or int(name) == os.getpid():
            continue
        try:
            with open(f"/proc/{name}/environ", "rb") as file:
                if mark in file.read().split(b"\0"):
                    found.append(int(name))
        except OSError:
            continue
    return found


def end(state, patience=2.0):
    """Ends every process of the phone; politely first."""
    last = time.monotonic() + patience
    number = signal.SIGTERM
    while pids := _of(state):
        for pid in pids:
            try:
                os.kill(pid, number)
            except OSError:
                pass
        if time.monotonic() > last:
            number = signal.SIGKILL
        if time.monotonic() > last + patience:
            return
        time.sleep(0.02)
