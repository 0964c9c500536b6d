"""The lines of `phone tree`, read back."""

import re

_LINE = re.compile(r'^( *)(.*?) "((?:\\.|[^"\\])*)" \[([^\]]*)\] (-?\d+),(-?\d+) (\d+)x(\d+)$')
_ESCAPED = re.compile(r'\\(.)')


class Widget:
    def __init__(self, match):
        self.depth = len(match[1]) // 2
        self.role = match[2]
        self.name = _ESCAPED.sub(lambda m: {"n": "\n", "t": "\t"}.get(m[1], m[1]), match[3])
        self.states = match[4].split(",")
        x, y, width, height = (int(number) for number in match.groups()[4:])
        self.area = (x, y, x + width, y + height)
        self.seen = self.area  # the part that its parents do not cut off


def read(tree, screen):
    """All widgets; what of them is on a screen of this size."""
    widgets, parents = [], []
    for line in tree.splitlines():
        match = _LINE.match(line)
        if not match:
            continue
        widget = Widget(match)
        del parents[widget.depth:]
        around = parents[-1].seen if parents else (0, 0, *screen)
        widget.seen = _common(widget.area, around)
        parents.append(widget)
        widgets.append(widget)
    return widgets


def _common(one, other):
    return (max(one[0], other[0]), max(one[1], other[1]),
            min(one[2], other[2]), min(one[3], other[3]))


def can_be_tapped(widget):
    left, top, right, bottom = widget.seen
    return "showing" in widget.states and right > left and bottom > top


def named(widgets, name):
    """The widget that a person means by the name: of that name, or else whose name begins with it,
    or else has it inside. Of several the last, which lies above the others."""
    shown = [widget for widget in widgets if can_be_tapped(widget)]
    for fits in (lambda text: text == name, lambda text: text.startswith(name),
                 lambda text: name in text):
        found = [widget for widget in shown if fits(widget.name)]
        if found:
            return found[-1]
    return None
