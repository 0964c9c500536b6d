"""One program of the phone: its process, its log file, how it says that it is ready."""

import os
import select
import subprocess
import time

from lib.report import Failure


class Program:
    def __init__(self, name, argv, log, env):
        self.name = name
        self._argv = argv
        self._log = log
        self._env = env
        self._process = None

    def start(self):
        self._start(())

    def start_and_read(self, patience=10.0, through="stdout"):
        """Starts it and waits for the first line that it writes: to its standard output, or, with
        through="fd", to the file whose number stands for {fd} in its arguments."""
        ours, theirs = os.pipe2(os.O_CLOEXEC)
        try:
            if through == "fd":
                self._argv = [word.replace("{fd}", str(theirs)) for word in self._argv]
                self._start((theirs,))
            else:
                self._start((), stdout=theirs)
        finally:
            os.close(theirs)
        return self._first_line(ours, patience)

    def _start(self, files, stdout=None):
        with open(self._log, "ab") as log:
            try:
                self._process = subprocess.Popen(
                    self._argv, env=self._env, pass_fds=files, stdin=subprocess.DEVNULL,
                    stdout=log if stdout is None else stdout, stderr=log)
            except OSError as error:
                raise Failure(f"{self.name} cannot be started: {error}") from None

    def _first_line(self, file, patience):
        end, text = time.monotonic() + patience, b""
        with os.fdopen(file, "rb", buffering=0) as source:
            while b"\n" not in text:
                wait = end - time.monotonic()
                if wait <= 0 or not select.select([source], [], [], wait)[0]:
                    raise Failure(f"{self.name} is not ready in time, see {self._log}")
                more = source.read(4096)
                if not more:
                    raise Failure(f"{self.name} did not start, see {self._log}")
                text += more
            if self._process.stdout is None:
                self._drain(os.dup(source.fileno()))
        return text.decode("utf-8", "replace").splitlines()[0]

    def _drain(self, file):
        """Later output goes to the log, so that the program never stands before a full pipe."""
        import threading

        def copy():
            with os.fdopen(file, "rb", buffering=0) as source, open(self._log, "ab") as log:
                while more := source.read(4096):
                    log.write(more)

        threading.Thread(target=copy, daemon=True).start()

    def running(self):
        return self._process is not None and self._process.poll() is None

    def state(self):
        if self._process is None:
            return "not started"
        status = self._process.poll()
        return f"runs, process {self._process.pid}" if status is None else f"ended ({status})"

    def wait(self):
        return self._process.wait()

    def ask_to_end(self):
        if self.running():
            self._process.terminate()

    def end(self, patience=1.0):
        """Asks it to end, and makes it end when it does not."""
        if self._process is None:
            return
        self.ask_to_end()
        try:
            self._process.wait(patience)
        except subprocess.TimeoutExpired:
            self._process.kill()
            self._process.wait()
