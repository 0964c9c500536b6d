"""Installs what the build made (build/PRESET/image) into the phone's state folder."""

import os
import shutil

from lib.state import ROOT

_APPLICATIONS = "opt-usr/apps"
_OWNED = ("bin", "lib", "res", "shared/res")  # of an application; data/ and the like are the phone's


def install(state, build):
    """Files are shared with the image by hard links where the file systems allow it."""
    image = os.path.join(build, "image", "opt", "usr")
    if os.path.isdir(image):
        _mirror(image, state.path("opt-usr"), prune=False)
        _mirror(os.path.join(image, "share"), state.path("opt-usr/share"), prune=True)
    for application in _listed(state.path(_APPLICATIONS)):
        source = os.path.join(image, "apps", application.name)
        for owned in _OWNED:
            _mirror(os.path.join(source, owned), os.path.join(application.path, owned), prune=True)
        for folder in ("data", "shared/data"):
            os.makedirs(os.path.join(application.path, folder), exist_ok=True)
        os.chmod(os.path.join(application.path, "data"), 0o700)
    _announce(state)


def applications(state):
    """The ids of the applications that can be started."""
    return sorted(application.name for application in _listed(state.path(_APPLICATIONS))
                  if _listed(os.path.join(application.path, "bin")))


def _listed(folder):
    try:
        with os.scandir(folder) as entries:
            return list(entries)
    except (FileNotFoundError, NotADirectoryError):
        return []


def _mirror(source, target, prune):
    wanted = {entry.name: entry for entry in _listed(source)}
    if wanted:
        os.makedirs(target, exist_ok=True)
    present = {entry.name: entry for entry in _listed(target)}
    for name, entry in present.items():
        if prune and name not in wanted:
            _remove(entry)
    for name, entry in wanted.items():
        path = os.path.join(target, name)
        if entry.is_dir():
            _mirror(entry.path, path, prune)
        elif name not in present or not _same(entry, present[name]):
            _place(entry.path, path)


def _same(first, second):
    try:
        one, other = first.stat(), second.stat()
    except FileNotFoundError:
        return False
    if one.st_ino == other.st_ino and one.st_dev == other.st_dev:
        return True
    return one.st_size == other.st_size and one.st_mtime_ns == other.st_mtime_ns


def _remove(entry):
    if entry.is_dir(follow_symlinks=False):
        shutil.rmtree(entry.path)
    else:
        os.unlink(entry.path)


def _place(source, target):
    source, passing = os.path.realpath(source), target + ".new"
    try:
        os.link(source, passing)
    except OSError:
        shutil.copy2(source, passing)
    os.rename(passing, target)


def bus_name(application):
    """The name under which an application is reached on the session bus. A letter comes before
    every id, since an id may begin with a digit; what a bus name may not hold stands as _xx."""
    text, before = "phoneapp.i", ""
    for byte in application.encode():
        letter = chr(byte)
        plain = letter.isascii() and (letter.isalpha() or letter == "-" or
                                      ((letter.isdigit() or letter == ".") and before != "."))
        text += letter if plain else f"_{byte:02x}"
        before = letter if plain else ""
    return text[:-1] + "_2e" if before == "." else text


def _announce(state):
    """One D-Bus service file per application: a launch request starts it."""
    wanted = {}
    starter = os.path.join(ROOT, "phone", "lib", "phone-app")
    for application in applications(state):
        name = bus_name(application)
        wanted[name + ".service"] = (f"[D-BUS Service]\nName={name}\n"
                                     f'Exec="{starter}" "{application}"\n')
    for entry in _listed(state.path("services")):
        if entry.name not in wanted:
            os.unlink(entry.path)
    for name, text in wanted.items():
        with open(state.path("services", name), "w", encoding="utf-8") as file:
            file.write(text)
