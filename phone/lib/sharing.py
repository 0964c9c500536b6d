"""The sharing service that the phone uses, and the agent that receives its pushes."""

import os
import subprocess
import threading

from lib.report import Failure


class Sharing:
    """Starts the phone's own service, unless the phone was told to use another one's."""

    def __init__(self, phone):
        self._phone = phone
        self._service = None
        self._changing = threading.Lock()
        self.url = phone.settings["service"]

    def start(self):
        if not self.url:
            self._start_service([])
        self._configure()
        agent = self._phone.tool("zelqo-agent")
        if agent and self.url:
            self._phone.program("agent", [agent]).start()

    def change(self, mode, delay):
        """ok, down, slow (every answer delay milliseconds late), refuse (every request refused).
        The service keeps its address and what it stores."""
        if self._phone.settings["service"]:
            raise Failure("this phone uses another phone's service")
        if not self.url:
            raise Failure("the sharing service was not built")
        with self._changing:
            self._restart(mode, delay)

    def _restart(self, mode, delay):
        if self._service:
            self._service.end()
            self._phone.programs.remove(self._service)
            self._service = None
        if mode != "down":
            self._start_service({"ok": [], "slow": ["--delay", str(delay)],
                                 "refuse": ["--refuse"]}[mode])

    def _start_service(self, extra):
        program = self._phone.tool("zelqo-service")
        if not program:
            return
        data = self._phone.state.path("service")
        os.makedirs(data, exist_ok=True)
        for port in (self._remembered_port(), "0"):
            self._service = self._phone.program(
                "service", [program, "--data", data, "--port", port, "--lenient"] + extra)
            try:
                line = self._service.start_and_read()
                break
            except Failure:
                self._phone.programs.remove(self._service)
                self._service = None
                if port == "0":
                    raise
        self.url = line.partition("ready: ")[2].strip()
        with open(self._phone.state.path("service-port"), "w", encoding="utf-8") as file:
            file.write(self.url.rpartition(":")[2])

    def _remembered_port(self):
        """Addresses that were stored on an earlier day stay good."""
        try:
            with open(self._phone.state.path("service-port"), encoding="utf-8") as file:
                return str(int(file.read()))
        except (OSError, ValueError):
            return "0"

    def _configure(self):
        vconf = self._phone.tool("phone-vconf")
        if not vconf:
            return
        language = self._phone.settings["language"]
        words = ["set", "db/zelqo/msisdn", self._phone.settings["number"],
                 "db/menu_widget/language", language, "db/menu_widget/regionformat", language]
        if self.url:
            words += ["db/zelqo/service_url", self.url]
        done = subprocess.run([vconf] + words, env=self._phone.environment, capture_output=True,
                              stdin=subprocess.DEVNULL, text=True)
        if done.returncode != 0:
            raise Failure("the phone's settings: " + done.stderr.strip())
