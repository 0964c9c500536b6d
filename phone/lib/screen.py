"""What the screen shows, and input as a person gives it."""

import os
import time

from lib import link
from lib.arguments import number, parse
from lib.report import Failure, Usage

_SWIPE = "phone swipe X,Y X,Y [MILLISECONDS]"
_PATIENCE = 5.0  # seconds, for a widget to appear
_PAINTING = 60.0  # seconds, for a whole page
_STILL = 7         # equal pictures in a row: longer than pages wait to paint what came late
_STEP = 0.016    # seconds between two movements of the finger


def tree(state, args):
    parse(args, usage="phone tree")
    return link.run(state, [state.tool("phone-tree")])


def screenshot(state, args):
    name = parse(args, words=(1, 1), usage="phone screenshot FILE").words[0]
    passing = name + ".part"
    try:
        file = os.open(passing, os.O_WRONLY | os.O_CREAT | os.O_TRUNC | os.O_CLOEXEC, 0o644)
    except OSError as error:
        raise Failure(f"cannot write {name}: {error.strerror}") from None
    status = 1
    try:
        status = link.run(state, [state.tool("phone-screen")], stdout=file)
    finally:
        os.close(file)
        if status == 0:
            os.rename(passing, name)
        else:
            os.unlink(passing)
    return status


def painted(state, args):
    """Waits until that many items with names are to be seen and nothing moves any more."""
    words = parse(args, words=(0, 1), usage="phone painted [ITEMS]").words
    wanted = number(words[0], "the number of items", 0, 10000) if words else 1
    end, before, still = time.monotonic() + _PAINTING, None, 0
    while time.monotonic() < end:
        now = link.output(state, ["sh", "-c", '"$0" | cksum', state.tool("phone-screen")])
        still = still + 1 if now == before else 0
        # the tree of a page with many cells takes longer to read than a picture of the screen
        if still >= _STILL and _named_items(state) >= wanted:
            return
        before = now
        time.sleep(0.2)
    raise Failure(f"there are not {wanted} items on the screen, or it does not come to rest")


def _named_items(state):
    from lib import widgets
    seen = widgets.read(link.output(state, [state.tool("phone-tree")]), state.settings()["screen"])
    return sum(1 for widget in seen
               if widgets.can_be_tapped(widget) and widget.name and "item" in widget.role)


def tap(state, args):
    words = parse(args, words=(1, 1), usage="phone tap NAME|X,Y").words
    point = _point(state, words[0]) or _middle(state, words[0])
    _input(state, ["mousemove", point[0], point[1], "click", "1"])


def swipe(state, args):
    words = parse(args, words=(2, 3), usage=_SWIPE).words
    start, end = (_point(state, word) for word in words[:2])
    if not start or not end:
        raise Usage(f"a place is like 360,640; {_SWIPE}")
    duration = number(words[2], "the time", 0, 60000) / 1000 if len(words) == 3 else 0.3
    steps = max(2, int(duration / _STEP))
    way = []
    for step in range(1, steps + 1):
        x, y = (a + (b - a) * step // steps for a, b in zip(start, end))
        way += ["mousemove", x, y, "sleep", duration / steps]
    _input(state, ["mousemove", *start, "mousedown", "1"] + way + ["mouseup", "1"])


def key(state, args):
    """A key by its name in X: Escape, XF86Back, Tab, Return, a, ctrl+c."""
    name = parse(args, words=(1, 1), usage="phone key NAME").words[0]
    if not all(letter.isalnum() or letter in "_+" for letter in name):
        raise Usage(f"'{name}' is not the name of a key; one is like Escape")
    _input(state, ["key", "--delay", "0", name])


def _input(state, words):
    # xdotool only warns of a key that does not exist
    complaint = link.output(state, ["xdotool"] + [str(word) for word in words], errors=True)
    if complaint.strip():
        raise Failure(complaint.strip().splitlines()[0])


def _point(state, text):
    x, comma, y = text.partition(",")
    if not comma or not x.strip().lstrip("-").isdigit() or not y.strip().lstrip("-").isdigit():
        return None
    point, screen = (int(x), int(y)), state.settings().get("screen", [0, 0])
    if not all(0 <= value < limit for value, limit in zip(point, screen)):
        raise Usage(f"{text} is not on the screen of {screen[0]}x{screen[1]}")
    return point


def _middle(state, name):
    from lib import widgets
    screen, end = state.settings().get("screen", [0, 0]), time.monotonic() + _PATIENCE
    while True:
        seen = widgets.read(link.output(state, [state.tool("phone-tree")]), screen)
        widget = widgets.named(seen, name)
        if widget:
            left, top, right, bottom = widget.seen
            return (left + right) // 2, (top + bottom) // 2
        if time.monotonic() > end:
            raise Failure(f"nothing on the screen is called '{name}'")
        time.sleep(0.05)
