"""Short runs of the fuzzers behind the tests, with what these leave of the processors."""

import os
import re
import subprocess

ROOT = os.path.dirname(os.path.dirname(os.path.abspath(__file__)))
LINE = re.compile(r"^fuzz \w+: ", re.MULTILINE)
PASSED = re.compile(r"^fuzz \w+: \d+ runs, no finding$", re.MULTILINE)


def targets(only):
    """The targets whose names match, as fuzz_NAME."""
    sources = sorted(os.listdir(os.path.join(ROOT, "fuzz")))
    names = [name[:-4] for name in sources if name.endswith(".cpp") and name[0].islower()]
    return [name for name in names if only.search("fuzz_" + name)]


def _give_way():
    os.nice(19)
    os.sched_setscheduler(0, os.SCHED_IDLE, os.sched_param(0))


class Fuzzing:
    """Builds and runs the targets for some seconds each, from now on."""

    def __init__(self, names, seconds):
        environment = dict(os.environ, CMAKE_BUILD_PARALLEL_LEVEL="2")
        for variable in ("ASAN_OPTIONS", "LSAN_OPTIONS", "UBSAN_OPTIONS"):
            environment.pop(variable, None)
        self.process = subprocess.Popen(
            [os.path.join(ROOT, "fuzz", "run"), str(seconds), *names], text=True,
            errors="replace", stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
            stderr=subprocess.STDOUT, env=environment, preexec_fn=_give_way,
            start_new_session=True)

    def wait(self):
        """How many targets had no finding, how many did not come through, and what was said."""
        output, _ = self.process.communicate()
        output = re.sub(r"^build: step .*\n", "", output, flags=re.MULTILINE)
        passed = len(PASSED.findall(output))
        failed = len(LINE.findall(output)) - passed
        if self.process.returncode != 0 and not failed:
            failed = 1  # it was not even built
        return passed, failed, output
