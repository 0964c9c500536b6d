"""Files of the caller, as the phone sees them."""

import os
import shutil

from lib.report import Failure

_HIDDEN = ("/tmp/", "/opt/")


def carry(state, name):
    """A path under which programs on the phone find the caller's file. What lies where the phone
    has folders of its own is handed in as a copy, under the same name."""
    path = os.path.abspath(name)
    if path.startswith("/opt/usr/"):
        return path  # meant is the phone's own file
    if not os.path.exists(path):
        raise Failure(f"there is no file {name}")
    real = os.path.realpath(path)
    if not (path.startswith(_HIDDEN) or real.startswith(_HIDDEN)):
        return path
    if path.startswith(state.folder + "/"):
        return path
    number = 0
    while True:
        folder = state.path("inbox", str(number))
        try:
            os.mkdir(folder)
            break
        except FileExistsError:
            number += 1
    target = os.path.join(folder, os.path.basename(path))
    try:
        os.link(real, target)
    except OSError:
        shutil.copyfile(real, target)
    return target
