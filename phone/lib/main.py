"""Finds the command and loads only what it needs."""

import importlib
import os
import sys

from lib.arguments import parse
from lib.report import Failure, Usage
from lib.state import State

# command: module that has a function of that name, called with (state, arguments)
COMMANDS = {
    "up": "power", "down": "power", "status": "power", "wait": "power",
    "share": "share",
    "launch": "application", "log": "application", "launches": "application",
    "messages": "application",
    "usage": "application", "prefs": "application",
    "tree": "screen", "tap": "screen", "swipe": "screen", "key": "screen", "screenshot": "screen",
    "painted": "screen",
    "network": "world", "rotate": "world", "battery": "world",
    "signal": "world", "signals": "world",
    "clock": "world", "language": "world", "theme": "world", "textsize": "world",
    "account": "world", "service": "world", "contact": "world",
    "shell": "shell",
}
USAGE = "phone [--state DIR] COMMAND; commands: " + ", ".join(COMMANDS)


def _state_anywhere(args):
    """Every command takes --state, in any place. The command's own words are left in order."""
    folder, rest, args = None, [], list(args)
    while args:
        arg = args.pop(0)
        if arg == "--state" and args:
            folder = args.pop(0)
        elif arg.startswith("--state="):
            folder = arg[len("--state="):]
        elif arg == "--":
            return folder, rest + [arg] + args
        else:
            rest.append(arg)
    return folder, rest


def _call(args):
    before = parse(args, values=("state",), flags=("help",), words=(0, None), usage=USAGE,
                   leading=True)
    if before.get("help"):
        print(USAGE)
        return 0
    if not before.words:
        raise Usage(f"a command is missing; {USAGE}")
    command, *rest = before.words
    if command not in COMMANDS:
        raise Usage(f"unknown command '{command}'; {USAGE}")
    folder = before.get("state")
    if command != "shell":  # what follows is somebody else's command line
        inner, rest = _state_anywhere(rest)
        folder = inner or folder
    module = importlib.import_module("lib." + COMMANDS[command])
    return getattr(module, command)(State(folder), rest) or 0


def main(args):
    try:
        return _call(args)
    except Usage as error:
        print(f"phone: {error}", file=sys.stderr)
        return 2
    except Failure as error:
        print(f"phone: {error}", file=sys.stderr)
        return 1
    except PermissionError as error:
        print(f"phone: {error.filename}: {error.strerror}", file=sys.stderr)
        return 1
    except BrokenPipeError:
        os.dup2(os.open(os.devnull, os.O_WRONLY), 1)
        return 141
    except KeyboardInterrupt:
        return 130
