"""The environment of everything that runs on the phone."""

import os

from lib.state import ROOT

# of the machine's session; nothing of it reaches the phone
_FOREIGN = ("DBUS_", "XDG_", "WAYLAND_", "LC_", "GTK_", "QT_", "ELM_", "SESSION_MANAGER",
            "DESKTOP_STARTUP_ID", "XAUTHORITY", "LANGUAGE", "INVOCATION_ID", "JOURNAL_STREAM",
            "NOTIFY_SOCKET", "AT_SPI_", "NO_AT_BRIDGE", "PYTHON")
_QUIET = ("ecore_x:1", "ecore_con:0", "eldbus:1", "efreet_cache:1", "ecore_system_systemd:0",
          "edje_pick:1", "ethumb_client:1")


def machine(environ):
    """What is left of the caller's environment."""
    return {key: value for key, value in environ.items() if not key.startswith(_FOREIGN)}


def phone(state, home, run, language):
    """What the phone sets for everything in it."""
    managed = {
        "HOME": home, "XDG_RUNTIME_DIR": run, "TMPDIR": "/tmp",
        "PHONE_STATE": state.folder, "PHONE_ID": state.folder,
        "DBUS_SESSION_BUS_ADDRESS": f"unix:path={run}/session.bus",
        "DBUS_SYSTEM_BUS_ADDRESS": f"unix:path={run}/system.bus",
        "GIO_USE_VFS": "local", "GIO_USE_VOLUME_MONITOR": "unix", "GSETTINGS_BACKEND": "keyfile",
        "ELM_PROFILE": "mobile", "ELM_ATSPI_MODE": "1",
        # a finger scrolls after a twentieth of an inch; a light flick turns a page
        "ELM_THUMBSCROLL_THRESHOLD": "16", "ELM_THUMBSCROLL_SENSITIVITY_FRICTION": "1.0",
        "EINA_LOG_BACKTRACE": "-1", "EINA_LOG_LEVELS": ",".join(_QUIET),
        "XDG_CURRENT_DESKTOP": "phone",
        "FONTCONFIG_FILE": os.path.join(ROOT, "phone", "etc", "fonts.conf"),
        # the phone's choice of programs for files stands before the machine's
        "XDG_DATA_DIRS": "/opt/usr/share:/usr/local/share:/usr/share",
    }
    managed.update(language_of(language))
    locales = os.path.join(ROOT, "build", "locale")
    if os.path.isdir(locales):
        managed["LOCPATH"] = locales
    return managed


def language_of(language):
    return {"LANG": language, "LC_ALL": language}
