"""The viewer and other applications: launching them, and what they left behind."""

import json
import os
import shutil
import sys

from lib import link
from lib.arguments import number, parse
from lib.files import carry
from lib.report import Failure, Usage
from lib.state import VIEWER

_LAUNCH = ("phone launch received --token T [--single] | sent --request N | files FILE... | "
           "raw OPERATION [KEY=VALUE...] [KEY[]=VALUE...]; each with [--as APPID]")
_PREFS = "phone prefs list | get KEY | set KEY VALUE | remove KEY; each with [--app APPID]"


def launch(state, args):
    if not args:
        raise Usage(f"what to launch is missing; {_LAUNCH}")
    kind, *rest = args
    makers = {"received": _received, "sent": _sent, "files": _files, "raw": _raw}
    if kind not in makers:
        raise Usage(f"cannot launch '{kind}'; {_LAUNCH}")
    options, request = makers[kind](state, rest)
    words = []
    for name in ("as", "app", "uri", "mime"):
        if options.get(name):
            words += ["--" + name, options.get(name)]
    return link.run(state, [state.tool("phone-launch")] + words + request)


def _received(state, args):
    options = parse(args, values=("token", "as", "app"), flags=("single",), usage=_LAUNCH)
    if options.get("token") is None:
        raise Usage(f"--token is missing; {_LAUNCH}")
    extras = ["view_type=received"]
    if options.get("token"):  # an empty text cannot stand in a request
        extras.append("contents_token=" + options.get("token"))
    if options.get("single"):
        extras.append("share_type=single_share")
    return options, ["launch_viewer"] + extras


def _sent(state, args):
    options = parse(args, values=("request", "as", "app"), flags=("single",), usage=_LAUNCH)
    if options.get("request") is None:
        raise Usage(f"--request is missing; {_LAUNCH}")
    request = number(options.get("request"), "--request")
    extras = ["view_type=sent", f"request_id={request}"]
    if options.get("single"):
        extras.append("share_type=single_share")
    return options, ["launch_viewer"] + extras


def _files(state, args):
    options = parse(args, values=("as", "app"), words=(1, None), usage=_LAUNCH)
    return options, ["launch_viewer"] + ["freemsg_send_data[]=" + carry(state, name)
                                         for name in options.words]


def _raw(state, args):
    options = parse(args, values=("as", "app", "uri", "mime"), words=(1, None), usage=_LAUNCH)
    operation, *extras = options.words
    for extra in extras:
        if extra.find("=") < 1:
            raise Usage(f"'{extra}' is not KEY=VALUE; {_LAUNCH}")
    return options, [operation] + extras


def prefs(state, args):
    options = parse(args, values=("app",), words=(1, 3), usage=_PREFS)
    what, *rest = options.words
    wanted = {"list": 0, "get": 1, "set": 2, "remove": 1}
    if wanted.get(what) != len(rest):
        raise Usage(f"'{' '.join(options.words)}' is not understood; {_PREFS}")
    return link.run(state, [state.tool("phone-prefs"), options.get("app", VIEWER), what] + rest)


def log(state, args):
    """Of the boot that is now, or that was last."""
    words = parse(args, words=(0, 1), usage="phone log [APPID]").words
    application = words[0] if words else VIEWER
    if "/" in application:
        raise Usage(f"'{application}' is not an application's id")
    _print(state.path("run", "log", application + ".log"))


def messages(state, args):
    """The status-bar messages of this boot, one per line."""
    parse(args, usage="phone messages")
    import html
    for line in _lines(state.path("run", "messages")):
        sys.stdout.write(html.unescape(line))


def launches(state, args):
    """Launch requests that left the viewer; with --all, those of every application."""
    everybody = parse(args, flags=("all",), usage="phone launches [--all]").get("all")
    for line in _lines(state.path("opt-usr", "dbspace", "launches.jsonl")):
        if everybody or _caller(line) == VIEWER:
            sys.stdout.write(line)


def _caller(line):
    try:
        return json.loads(line).get("caller")
    except (ValueError, AttributeError):
        return None


def usage(state, args):
    """The records of the usage log, oldest first."""
    parse(args, usage="phone usage")
    import sqlite3
    path = state.path("opt-usr", "dbspace", "usagelog.db")
    if not os.path.exists(path):
        return
    base = sqlite3.connect(path, timeout=3)
    base.row_factory = sqlite3.Row
    for row in base.execute("SELECT * FROM record ORDER BY id"):
        print(json.dumps(dict(row), ensure_ascii=False))
    base.close()


def _lines(path):
    try:
        with open(path, encoding="utf-8", errors="replace") as file:
            yield from file
    except FileNotFoundError:
        return


def _print(path):
    try:
        with open(path, "rb") as file:
            shutil.copyfileobj(file, sys.stdout.buffer)
            sys.stdout.buffer.flush()
    except FileNotFoundError:
        pass
    except OSError as error:
        raise Failure(f"{path}: {error.strerror}") from None
