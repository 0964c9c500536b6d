"""Command-line arguments, without the start-up cost of a full parser."""

from lib.report import Usage


class Arguments:
    """Options by name (without dashes) and the remaining words."""

    def __init__(self, options, words):
        self.options = options
        self.words = words

    def get(self, name, default=None):
        return self.options.get(name, default)


def parse(args, values=(), flags=(), words=(0, 0), usage="", leading=False):
    """values: options that take a text; flags: options that don't; words: least and most number of
    other words (None: no limit). With leading, options end at the first word."""
    options, rest, args = {}, [], list(args)
    while args:
        arg = args.pop(0)
        if arg == "--":
            rest += args
            break
        if not arg.startswith("--"):
            rest.append(arg)
            if leading:
                rest += args
                break
            continue
        name, equals, value = arg[2:].partition("=")
        if name in flags and not equals:
            options[name] = True
        elif name in values:
            if not equals and not args:
                raise Usage(f"--{name} needs a value; {usage}")
            options[name] = value if equals else args.pop(0)
        else:
            raise Usage(f"unknown option {arg}; {usage}")
    least, most = words
    if len(rest) < least:
        raise Usage(f"something is missing; {usage}")
    if most is not None and len(rest) > most:
        raise Usage(f"'{rest[most]}' is too much; {usage}")
    return Arguments(options, rest)


def number(text, what, least=None, most=None):
    """A whole number within limits."""
    try:
        value = int(text)
    except ValueError:
        raise Usage(f"{what} must be a whole number, not '{text}'") from None
    if (least is not None and value < least) or (most is not None and value > most):
        raise Usage(f"{what} must be between {least} and {most}, not {value}")
    return value
