"""How the program ends, as its manual page tells."""

WELL = 0
PARTLY = 1  # some hosts, or parts of one, failed
USAGE = 2
NOTHING = 3  # no host answered
NO_PYWBEM = 4
NOT_WRITTEN = 5  # a file, or nobody read the output
INTERRUPTED = 130
