"""The phone's own session bus and system bus."""

import os
import subprocess

from lib.report import Failure

_CONFIGURATION = """<busconfig>
<type>{kind}</type><listen>unix:path={run}/{kind}.bus</listen><auth>EXTERNAL</auth>
{services}
<policy context="default">
<allow user="*"/><allow own="*"/>
<allow send_destination="*" eavesdrop="true"/><allow eavesdrop="true"/>
</policy>
<limit name="service_start_timeout">10000</limit>
</busconfig>
"""


def start(phone, kind):
    """Starts a bus; it is ready when this returns."""
    folder = phone.state.path("services" if kind == "session" else "system-services")
    services = f"<servicedir>{_escaped(folder)}</servicedir>"
    if kind == "session":
        services += "<standard_session_servicedirs/>"
    file = os.path.join(phone.run, kind + ".conf")
    with open(file, "w", encoding="utf-8") as configuration:
        configuration.write(_CONFIGURATION.format(kind=kind, run=_escaped(phone.run),
                                                  services=services))
    bus = phone.program(kind + "-bus", ["dbus-daemon", "--config-file=" + file, "--nofork",
                                        "--nopidfile", "--nosyslog", "--print-address={fd}"])
    bus.start_and_read(through="fd")
    return bus


def _escaped(text):
    return text.replace("&", "&amp;").replace("<", "&lt;")


def environment(phone, variables):
    """What programs that the session bus starts from now on find in their environment."""
    pairs = ", ".join(f"'{key}': '{value}'" for key, value in variables.items())
    _gdbus(phone, ["call", "--session", "--dest", "org.freedesktop.DBus", "--object-path",
                   "/org/freedesktop/DBus", "--method",
                   "org.freedesktop.DBus.UpdateActivationEnvironment", "{" + pairs + "}"])


def wait(phone, name):
    _gdbus(phone, ["wait", "--session", "--timeout", "5", name])


def _gdbus(phone, words):
    done = subprocess.run(["gdbus"] + words, env=phone.environment, stdin=subprocess.DEVNULL,
                          stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, text=True)
    if done.returncode != 0:
        raise Failure(f"gdbus {words[0]} {words[-1]}: {done.stderr.strip()}")
