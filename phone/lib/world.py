"""The world around the phone: network, orientation, battery, signals, settings, account, contacts."""

import shutil
import sys

from lib import link
from lib.arguments import number, parse
from lib.files import carry
from lib.power import locale
from lib.report import Failure, Usage


def _tell_world(state, method, value):
    link.output(state, ["gdbus", "call", "--system", "--dest", "phone.World", "--object-path",
                        "/phone/World", "--method", "phone.World1." + method, value])


def _choice(args, choices, usage):
    word = parse(args, words=(1, 1), usage=usage).words[0]
    if word not in choices:
        raise Usage(f"'{word}' is not one of {', '.join(choices)}")
    return word


def network(state, args):
    kinds = ("wifi", "cellular", "ethernet", "none")
    _tell_world(state, "SetNetwork", _choice(args, kinds, "phone network " + "|".join(kinds)))


def rotate(state, args):
    turns = ("0", "90", "180", "270")
    _tell_world(state, "SetRotation", _choice(args, turns, "phone rotate " + "|".join(turns)))


def battery(state, args):
    word = parse(args, words=(1, 1), usage="phone battery PERCENT").words[0]
    _tell_world(state, "SetCharge", str(number(word, "the charge", 0, 100)))


def signal(state, args):
    words = parse(args, words=(2, 2), usage="phone signal MEMBER TEXT").words
    return link.run(state, [state.tool("phone-signal")] + words)


def signals(state, args):
    """What was seen on the system bus since the phone is up, one JSON object per line."""
    parse(args, usage="phone signals")
    try:
        with open(state.path("run", "signals"), "rb") as file:
            shutil.copyfileobj(file, sys.stdout.buffer)
            sys.stdout.buffer.flush()
    except FileNotFoundError:
        raise Failure("the phone was never up, or it keeps no record of signals") from None


def clock(state, args):
    hours = _choice(args, ("12", "24"), "phone clock 12|24")
    return link.run(state, [state.tool("phone-vconf"), "set-int",
                            "db/menu_widget/regionformat_time1224", "1" if hours == "12" else "2"])


def language(state, args):
    name = locale(parse(args, words=(1, 1), usage="phone language LOCALE").words[0])
    link.ask(state, {"do": "language", "language": name})
    return link.run(state, [state.tool("phone-vconf"), "set", "db/menu_widget/regionformat", name,
                            "db/menu_widget/language", name])


def theme(state, args):
    return link.run(state, [state.tool("phone-vconf"), "set", "db/setting/theme",
                            _choice(args, ("light", "dark"), "phone theme light|dark")])


def textsize(state, args):
    word = parse(args, words=(1, 1), usage="phone textsize PERCENT").words[0]
    return link.run(state, [state.tool("phone-vconf"), "set-int",
                            "db/setting/accessibility/font_size",
                            str(number(word, "the size of texts", 80, 200))])


def account(state, args):
    what = _choice(args, ("none", "off", "on"), "phone account none|off|on")
    return link.run(state, [state.tool("phone-account"), what, state.settings()["number"]])


_SERVICE = "phone service ok|down|slow MS|refuse"


def service(state, args):
    words = parse(args, words=(1, 2), usage=_SERVICE).words
    message = {"do": "service", "mode": words[0]}
    if words[0] not in ("ok", "down", "slow", "refuse"):
        raise Usage(f"'{words[0]}' is not understood; {_SERVICE}")
    if (words[0] == "slow") != (len(words) == 2):
        raise Usage(f"only 'slow' has a number of milliseconds, and needs one; {_SERVICE}")
    if len(words) == 2:
        message["delay"] = number(words[1], "the delay", 0, 3600000)
    link.ask(state, message)


_CONTACT = ("phone contact add NAME NUMBER [PHOTO] | import FILE | rename OLD NEW | remove NAME | "
            "list")
_CONTACT_WORDS = {"add": (2, 3), "import": (1, 1), "rename": (2, 2), "remove": (1, 1),
                  "list": (0, 0)}


def contact(state, args):
    words = parse(args, words=(1, 4), usage=_CONTACT).words
    what, *rest = words
    least, most = _CONTACT_WORDS.get(what, (9, 9))
    if not least <= len(rest) <= most:
        raise Usage(f"'{' '.join(words)}' is not understood; {_CONTACT}")
    if what == "import" or len(rest) == 3:
        rest[-1] = carry(state, rest[-1])
    return link.run(state, [state.tool("phone-contact"), what] + rest)
