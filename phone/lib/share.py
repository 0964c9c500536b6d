"""Shares files as a subscriber of the service."""

from lib import link
from lib.arguments import number, parse
from lib.files import carry
from lib.report import Usage

_SHARE = ("phone share --from N --to N[,N...] [--single] [--expires-in SECONDS] FILE... "
          "(or --raw-manifest FILE, to announce what is not there)")


def share(state, args):
    options = parse(args, values=("from", "to", "expires-in", "raw-manifest"),
                    flags=("single",), words=(0, None), usage=_SHARE)
    for name in ("from", "to"):
        if not options.get(name):
            raise Usage(f"--{name} is missing; {_SHARE}")
    words = ["--from", options.get("from"), "--to", options.get("to")]
    if options.get("single"):
        words.append("--single")
    if options.get("expires-in") is not None:
        number(options.get("expires-in"), "--expires-in", 0)
        words += ["--expires-in", options.get("expires-in")]
    if options.get("raw-manifest"):
        words += ["--raw-manifest", carry(state, options.get("raw-manifest"))]
    elif not options.words:
        raise Usage(f"a file is missing; {_SHARE}")
    files = [carry(state, name) for name in options.words]
    return link.run(state, [state.tool("zelqo-share")] + words + ["--"] + files)
