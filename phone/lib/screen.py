"""What the screen shows, and input as a person gives it."""

import os

from lib import link
from lib.arguments import parse
from lib.report import Failure


def screenshot(state, args):
    name = parse(args, words=(1, 1), usage="phone screenshot FILE").words[0]
    try:
        file = os.open(name, os.O_WRONLY | os.O_CREAT | os.O_TRUNC | os.O_CLOEXEC, 0o644)
    except OSError as error:
        raise Failure(f"cannot write {name}: {error.strerror}") from None
    try:
        return link.run(state, [state.tool("phone-screen")], stdout=file)
    finally:
        os.close(file)
