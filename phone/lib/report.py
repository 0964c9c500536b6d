"""What the command says when it cannot do what it was asked."""


class Usage(Exception):
    """The command was called wrongly: one line, exit status 2."""


class Failure(Exception):
    """The command was right, but it did not work: one line, exit status 1."""
