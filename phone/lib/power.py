"""up, down, status, wait."""

import os
import sys

from lib import link
from lib.arguments import number, parse
from lib.report import Failure, Usage
from lib.state import find_build

_UP = ("phone up [--headless] [--screen WxH] [--lang LOCALE] [--number N] [--service URL] "
       "[--build DIR] [--while PID]")


def up(state, args):
    options = parse(args, values=("screen", "lang", "number", "service", "build", "while"),
                    flags=("headless",), usage=_UP)
    settings = {
        "screen": _screen(options.get("screen", "720x1280")),
        # The phone keeps its language over the night, as it does its theme.
        "language": locale(options.get("lang") or state.settings().get("language", "en_US.UTF-8")),
        "number": _subscriber(options.get("number", "+821012345678")),
        "service": options.get("service"),
        "while": number(options.get("while", "0"), "--while", 0),
        "build": find_build(options.get("build")),
        "display": None if options.get("headless") else os.environ.get("DISPLAY") or _no_display(),
    }
    from lib import boot
    for line in boot.boot(state, settings):
        print(line)


def _no_display():
    raise Failure("there is no display; use: phone up --headless")


def _screen(text):
    width, x, height = text.partition("x")
    if not x:
        raise Usage(f"--screen is like 720x1280, not '{text}'")
    return [number(width, "the width of --screen", 240, 4096),
            number(height, "the height of --screen", 240, 4096)]


def locale(text):
    """de_DE stands for de_DE.UTF-8; nothing but letters, digits and . _ - @ gets further."""
    if not text or not all(letter.isalnum() or letter in "._-@" for letter in text):
        raise Usage(f"'{text}' is not a locale; one is like de_DE.UTF-8")
    return text if "." in text or "@" in text or text in ("C", "POSIX") else text + ".UTF-8"


def _subscriber(text):
    if not text.lstrip("+").isdigit():
        raise Usage(f"'{text}' is not a phone number; one is like +821012345678")
    return text


def down(state, args):
    parse(args, usage="phone down")
    answer = link.request(state, {"do": "down"})
    if not state.lock(patience=10):
        raise Failure(f"the phone in {state.folder} does not go down")
    if answer is None:
        from lib import leftovers
        leftovers.end(state)
        print("phone: was down", file=sys.stderr)


def wait(state, args):
    """Returns when the phone has gone down, for whatever reason."""
    parse(args, usage="phone wait")
    link.request(state, {"do": "wait"})


def status(state, args):
    parse(args, usage="phone status")
    answer = link.request(state, {"do": "status"})
    if answer is None or "error" in answer:
        print(f"down ({state.folder})")
        return 3
    settings = state.settings()
    width, height = settings["screen"]
    print(f"up ({state.folder})")
    print(f"  sandbox: {settings['sandbox']}")
    print(f"  screen: {width}x{height} on display {answer['display']}")
    print(f"  number: {settings['number']}")
    print(f"  language: {answer['language']}")
    if answer.get("service"):
        print(f"  service: {answer['service']}")
    for program in answer["programs"]:
        print(f"  {program['name']}: {program['state']}")
    for application in answer["applications"]:
        print(f"  application {application}")
    return 0
