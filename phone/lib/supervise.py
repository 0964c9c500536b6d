"""The inside of a phone: what runs on it, in which order it starts, and how it ends."""

import os
import signal
import subprocess
import sys
import threading

from lib import buses, environment, link, server
from lib.program import Program
from lib.report import Failure
from lib.sharing import Sharing
from lib.state import ROOT, State

_ADDRESS_BOOK = "/usr/libexec/evolution-addressbook-factory"
_RESTART = 0.5   # seconds, before a service that ended is started again


def together(*jobs):
    """Runs the jobs at the same time; the first failure counts."""
    failures = []

    def run(job):
        try:
            job()
        except Failure as failure:
            failures.append(failure)

    threads = [threading.Thread(target=run, args=(job,)) for job in jobs]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    if failures:
        raise failures[0]


class Phone:
    """Everything that runs on the phone. Its methods may be called from any thread."""

    def __init__(self):
        self.state = State(os.environ["PHONE_STATE"])
        self.settings = self.state.settings()
        self.run = os.environ["XDG_RUNTIME_DIR"]
        self.environment = dict(os.environ)
        for key in ("PHONE_DESKTOP_DISPLAY", "PHONE_DESKTOP_KEYS"):
            self.environment.pop(key, None)
        self.programs = []
        self.display = None
        self.sharing = Sharing(self)
        self.over = threading.Event()

    # --- starting ---

    def start(self):
        together(self._start_screen, self._start_session, self._start_system)
        together(self._start_notifications, self._warm_contacts, self.sharing.start,
                 self._sign_up)

    def program(self, name, argv, env=None):
        program = Program(name, argv, self.state.path("log", name + ".log"),
                          env or self.environment)
        open(self.state.path("log", name + ".log"), "wb").close()
        self.programs.append(program)
        return program

    def tool(self, name):
        """A program of the build, or None when it was not built."""
        path = os.path.join(self.settings["build"], "bin", name)
        return path if os.access(path, os.X_OK) else None

    def vital(self, program):
        """Without this program the phone is over."""

        def watch():
            program.wait()
            if not self.over.is_set():
                print(f"{program.name} ended; the phone goes down", flush=True)
                self.over.set()
                os.kill(os.getpid(), signal.SIGTERM)

        threading.Thread(target=watch, daemon=True).start()

    def _start_screen(self):
        width, height = self.settings["screen"]
        common = ["-displayfd", "{fd}", "-dpi", "160", "-noreset", "-nolisten", "tcp",
                  "-extension", "GLX"]
        desktop = os.environ.get("PHONE_DESKTOP_DISPLAY")
        if desktop:
            env = dict(self.environment, DISPLAY=desktop,
                       XAUTHORITY=os.environ["PHONE_DESKTOP_KEYS"])
            screen = self.program("screen", ["Xephyr", "-screen", f"{width}x{height}",
                                             "-title", "phone", "-no-host-grab"] + common, env)
        else:
            screen = self.program("screen", ["Xvfb", "-screen", "0", f"{width}x{height}x24",
                                             "-s", "0"] + common)
        self.display = ":" + screen.start_and_read(through="fd")
        self.environment["DISPLAY"] = self.display
        self.vital(screen)
        self._start_window_manager()

    def _start_window_manager(self):
        manager = self.program("window-manager", [
            "openbox", "--sm-disable", "--config-file", os.path.join(ROOT, "phone/etc/openbox.xml"),
            "--startup", "echo ready"])
        manager.start_and_read()

    def _start_session(self):
        self.vital(buses.start(self, "session"))
        self._wake_contacts()

    def _start_system(self):
        """A system bus that ends is started again, as on any machine, and what lives on it too."""
        begun = self._begin_system()

        def watch(programs):
            while True:
                programs[0].wait()
                if self.over.is_set():
                    return
                print("system-bus ended and is started again", flush=True)
                for program in programs:
                    program.end()
                    self.programs.remove(program)
                programs = self._begin_system()

        threading.Thread(target=watch, args=(begun,), daemon=True).start()

    def _begin_system(self):
        begun = [buses.start(self, "system")]
        for name, tool, arguments in (
                ("world", "phone-world", [self.settings["number"]]),
                ("signals", "phone-signal", ["--record", os.path.join(self.run, "signals")])):
            path = self.tool(tool)
            if path:
                begun.append(self.program(name, [path] + arguments))
                begun[-1].start_and_read()
        return begun

    def _wake_contacts(self):
        """Their start takes longest of all, so it goes on beside everything else. The machine's own
        way would end the address book when nobody uses it for a while."""
        self.program("address-book", [_ADDRESS_BOOK, "--keep-running"]).start()
        service = self.tool("phone-contacts")
        if service:
            contacts = self.program("contacts", [service])
            contacts.start()
            self._keep(contacts)

    def _warm_contacts(self):
        """The service answers before a slow address book is there; the phone is ready with both."""
        buses.wait(self, "org.gnome.evolution.dataserver.AddressBook10")
        if self.tool("phone-contacts"):
            buses.wait(self, "phone.Contacts")

    def _keep(self, program):
        """Starts it again when it ends, as long as the phone is up."""

        def watch():
            while not self.over.is_set():
                program.wait()
                if not self.over.wait(_RESTART):
                    print(f"{program.name} ended and is started again", flush=True)
                    program.start()

        threading.Thread(target=watch, daemon=True).start()

    def _start_notifications(self):
        buses.environment(self, {"DISPLAY": self.display})
        self.program("notifications", ["dunst", "-conf", os.path.join(self.run, "dunstrc")]).start()
        buses.wait(self, "org.freedesktop.Notifications")

    def _sign_up(self):
        """A new phone has an account with the sharing service on. Later its user decides."""
        account = self.tool("phone-account")
        if not account or os.path.exists(self.state.path("opt-usr", "dbspace", "account.db")):
            return
        done = subprocess.run([account, "on", self.settings["number"]], env=self.environment,
                              capture_output=True, stdin=subprocess.DEVNULL, text=True)
        if done.returncode != 0:
            raise Failure("the phone's account: " + done.stderr.strip())

    # --- what callers may ask for ---

    def set_language(self, language):
        """For everything that starts from now on."""
        self.settings["language"] = language
        self.state.save(self.settings)
        buses.environment(self, environment.language_of(language))
        self.environment.update(environment.language_of(language))

    def status(self):
        from lib.image import applications
        return {"display": self.display, "language": self.settings["language"],
                "service": self.sharing.url,
                "programs": [{"name": program.name, "state": program.state()}
                             for program in self.programs],
                "applications": applications(self.state)}

    # --- ending ---

    def end(self):
        self.over.set()
        for program in reversed(self.programs):
            program.ask_to_end()
        for program in reversed(self.programs):
            program.end()


def supervise(told):
    phone = Phone()

    def stop(*_):
        raise SystemExit(0)

    for number in (signal.SIGTERM, signal.SIGINT, signal.SIGHUP):
        signal.signal(number, stop)
    try:
        listener = link.listen(phone.run)
        phone.start()
        os.write(told, b"ready\n")
        os.close(told)
        server.serve(phone, listener)
    except Failure as failure:
        os.write(told, f"failed: {failure}\n".encode())
        return 1
    finally:
        phone.end()
        sys.stdout.flush()
    return 0
