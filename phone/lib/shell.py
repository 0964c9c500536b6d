"""Commands inside the phone."""

from lib import link
from lib.arguments import parse


def shell(state, args):
    words = parse(args, values=("state",), words=(0, None), leading=True,
                  usage="phone shell [COMMAND...]").words
    return link.run(state, words or ["/bin/sh"])
