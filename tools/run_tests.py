#!/usr/bin/python3
"""Runs the test programs of a build: unit tests inside one phone, phone tests outside, each with a
phone of its own. Ends with "N passed, N failed"."""

import argparse
import concurrent.futures
import contextlib
import json
import os
import re
import signal
import subprocess
import sys
import threading
import time

ROOT = os.path.dirname(os.path.dirname(os.path.abspath(__file__)))
sys.path.insert(0, os.path.join(ROOT, "phone"))
from lib import sandbox  # noqa: E402

import fuzzing  # noqa: E402

PHONE = os.path.join(ROOT, "phone", "phone")
PATIENCE = 300        # seconds for one program
LAST_LINES = 40
SANITIZER_FACTOR = 4  # how much slower programs may be under the sanitizers
AT_A_TIME = 2         # phones outside the one of the unit tests
FUZZ_SECONDS = 60     # for each fuzzer, unless the environment says otherwise; 0 for none


def arguments():
    parser = argparse.ArgumentParser(prog="./test")
    parser.add_argument("--sanitize", action="store_true", help="under ASan and UBSan")
    parser.add_argument("--only", metavar="REGEX", type=re.compile, default=re.compile(""),
                        help="tests or programs whose name matches")
    return parser.parse_args()


class Program:
    """A test program of the build."""

    def __init__(self, entry):
        properties = {one["name"]: one["value"] for one in entry.get("properties", [])}
        self.name = entry["name"]
        self.path, *self.arguments = entry["command"]
        self.outside = "phone" in properties.get("LABELS", [])
        self.patience = properties.get("TIMEOUT", PATIENCE)


def end(output, status):
    """The last lines of a program that did not come to its end."""
    how = "it took too long" if status is None else f"it ended with status {status}"
    return "\n".join(output.splitlines()[-LAST_LINES:] + [how])


class Result:
    def __init__(self, passed=0, failed=0, skipped=0, output="", names=()):
        self.passed, self.failed, self.skipped, self.output = passed, failed, skipped, output
        self.names = list(names)  # of the failed tests, when it is known which

    def __str__(self):
        parts = [f"{self.passed} passed"]
        if self.failed:
            parts.append(f"{self.failed} FAILED")
        if self.skipped:
            parts.append(f"{self.skipped} skipped")
        return ", ".join(parts)


def programs(build):
    listed = json.loads(subprocess.run(["ctest", "--show-only=json-v1"], cwd=build, check=True,
                                       stdout=subprocess.PIPE).stdout)
    return [Program(entry) for entry in listed["tests"] if entry.get("command")]


class Runner:
    def __init__(self, options):
        self.only = options.only
        self.factor = SANITIZER_FACTOR if options.sanitize else 1
        self.build = os.path.join(ROOT, "build", "asan" if options.sanitize else "dev")
        self.phone = os.path.join(self.build, "phones", "unit")
        self.results = os.path.join(self.build, "test-results")
        os.makedirs(self.results, exist_ok=True)
        self.first = []  # what each program gave at the first try
        self.telling = threading.Lock()
        self.running = set()
        self.stopping = False
        os.environ["PHONE_BUILD"] = self.build
        suppressions = os.path.join(ROOT, "tests", "leaks.supp")
        os.environ.setdefault("LSAN_OPTIONS", f"suppressions={suppressions}:print_suppressions=0")
        # Whole stacks, or the suppressions do not see which library it was.
        # The leak checker can crash over the thread-local memory of libraries loaded late.
        os.environ.setdefault("ASAN_OPTIONS", "fast_unwind_on_malloc=0:intercept_tls_get_addr=0")
        os.environ.setdefault("UBSAN_OPTIONS", "print_stacktrace=1:halt_on_error=1")

    def command(self, program, extra):
        words = [program.path] + program.arguments + extra
        return words if program.outside else [PHONE, "--state", self.phone, "shell"] + words

    def filter(self, program, only):
        """The arguments that choose the wanted tests; None when there are none."""
        if only.search(program.name):
            return []
        listed = subprocess.run(self.command(program, ["--gtest_list_tests"]), text=True,
                                stdout=subprocess.PIPE, stderr=subprocess.DEVNULL).stdout
        suite, wanted = "", []
        for line in listed.splitlines():
            name = line.split("#")[0].strip()
            if not line.startswith(" "):
                suite = name
            elif only.search(suite + name):
                wanted.append(suite + name)
        return ["--gtest_filter=" + ":".join(wanted)] if wanted else None

    def run(self, program, only):
        chosen = self.filter(program, only)
        if chosen is None:
            return None
        report = os.path.join(self.results, program.name + ".json")
        if os.path.exists(report):
            os.unlink(report)
        words = self.command(program, chosen + ["--gtest_output=json:" + report])
        status, output = self.watch(words, float(program.patience) * self.factor)
        return self.judge(report, status, output)

    def run_again(self, program, first):
        """A phone on a busy machine may miss a moment: what failed is tried once more, alone."""
        if not first.names:
            return self.run(program, self.only)
        names = re.compile("|".join(f"^{re.escape(name)}$" for name in first.names))
        second = self.run(program, names)
        if second is None or second.passed + second.failed < len(first.names):
            return first
        return Result(first.passed + second.passed, second.failed, first.skipped, second.output,
                      second.names)

    def watch(self, words, patience):
        process = subprocess.Popen(words, stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
                                   stderr=subprocess.STDOUT, text=True, errors="replace",
                                   start_new_session=True)
        self.running.add(process)
        try:
            output, _ = process.communicate(timeout=patience)
            return process.returncode, output
        except subprocess.TimeoutExpired:
            os.killpg(process.pid, signal.SIGTERM)
            try:
                output, _ = process.communicate(timeout=10)
            except subprocess.TimeoutExpired:
                os.killpg(process.pid, signal.SIGKILL)
                output, _ = process.communicate()
            return None, output
        finally:
            self.running.discard(process)

    @staticmethod
    def judge(report, status, output):
        try:
            with open(report, encoding="utf-8") as file:
                summary = json.load(file)
        except (OSError, ValueError):
            if status == 0 and "[==========]" not in output:
                return Result(passed=1)  # a program that is one test
            return Result(failed=1, output=end(output, status))
        cases = [case for suite in summary["testsuites"] for case in suite["testsuite"]]
        told = [f"{case['classname']}.{case['name']}:\n{failure['failure']}"
                for case in cases for failure in case.get("failures", [])]
        failed = sum("failures" in case for case in cases)
        skipped = sum(case["result"] == "SKIPPED" for case in cases)
        ran = sum(case["status"] == "RUN" for case in cases)
        if status != 0 and failed == 0:  # it broke on its way out
            return Result(ran - skipped, 1, skipped, end(output, status))
        names = [f"{case['classname']}.{case['name']}" for case in cases if "failures" in case]
        return Result(ran - failed - skipped, failed, skipped, "\n".join(told), names)

    def phone_command(self, *words):
        return subprocess.run([PHONE, "--state", self.phone, *words]).returncode

    def run_all(self):
        """Phones wait more than they work, so several are up at a time."""
        wanted = programs(self.build)
        inside = [program for program in wanted if not program.outside]
        outside = [program for program in wanted if program.outside]
        if sandbox.why_not():  # there can be only one phone
            self.run_inside(inside)
            for program in outside:
                self.run_first(program)
        else:
            with concurrent.futures.ThreadPoolExecutor(AT_A_TIME) as pool:
                waiting = [pool.submit(self.run_first, program) for program in outside]
                self.run_inside(inside)
                for one in waiting:
                    one.result()
        return self.total()

    def run_inside(self, some):
        if not some:
            return
        with self.unit_phone():
            for program in some:
                self.run_first(program)

    @contextlib.contextmanager
    def unit_phone(self):
        if self.phone_command("up", "--headless") != 0:
            print("There is no phone for the unit tests")
        try:
            yield
        finally:
            self.phone_command("down")

    def run_first(self, program):
        if self.stopping:
            return
        begin = time.monotonic()
        result = self.run(program, self.only)
        if result is not None:
            self.first.append((program, result))
            self.tell(program, result, begin)

    def second_try(self, program, first):
        print(f"{program.name}: once more, {' '.join(first.names) or 'all'}", flush=True)
        begin = time.monotonic()
        with contextlib.nullcontext() if program.outside else self.unit_phone():
            result = self.run_again(program, first) or first
        self.tell(program, result, begin)
        return result

    def tell(self, program, result, begin):
        with self.telling:
            print(f"{program.name}: {result} ({time.monotonic() - begin:.1f} s)", flush=True)
            if result.failed:
                print(result.output.rstrip(), flush=True)

    def total(self):
        total = Result()
        for program, result in self.first:
            if result.failed and not self.stopping:
                result = self.second_try(program, result)
            total.passed += result.passed
            total.failed += result.failed
        return total

    def stop(self, *_):
        """Interrupted: nothing is left running."""
        self.stopping = True
        for process in list(self.running):
            os.killpg(process.pid, signal.SIGTERM)


def start_fuzzing(options, runner):
    """The fuzzers have sanitizers of their own, so they run with the plain tests only."""
    seconds = int(os.environ.get("FUZZ_SECONDS", FUZZ_SECONDS))
    names = [] if options.sanitize or seconds < 1 else fuzzing.targets(options.only)
    if not names:
        return None
    started = fuzzing.Fuzzing(names, seconds)
    runner.running.add(started.process)
    return started


def main():
    options = arguments()
    runner = Runner(options)
    signal.signal(signal.SIGTERM, runner.stop)
    signal.signal(signal.SIGINT, runner.stop)
    background = start_fuzzing(options, runner)
    total = runner.run_all()
    if background:
        passed, failed, output = background.wait()
        print(output.rstrip(), flush=True)
        total.passed += passed
        total.failed += failed
    print(f"{total.passed} passed, {total.failed} failed")
    return 1 if total.failed or not total.passed or runner.stopping else 0


if __name__ == "__main__":
    sys.exit(main())
