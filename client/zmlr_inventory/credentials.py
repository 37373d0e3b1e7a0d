"""Who asks: users and passwords from a file that only its owner can read, or from the terminal."""

import contextlib
import getpass
import netrc
import os
import stat
import sys

from .hosts import UsageError


class Credentials:
    """The login for each host; of the file's entries the host's own, else its default, else what was asked for."""

    def __init__(self, file=None, asked=None):
        self._file = read(file) if file else None
        self._asked = asked

    def of(self, host):
        """(user, password), or None to ask without a login."""
        found = self._file.authenticators(host) if self._file else None
        return (found[0], found[2]) if found else self._asked


def ask(user):
    """The password of a user, from the terminal."""
    if not sys.stdin.isatty():
        raise UsageError(f"the password of {user!r} can only be typed on a terminal; use --credentials FILE")
    try:
        return user, getpass.getpass(f"Password of {user}: ")
    except EOFError:
        raise UsageError("no password was typed") from None


def read(path):
    """The entries of a file in the form of netrc. Refuses a file that others could have read or written."""
    try:
        with contextlib.closing(_Opened(path)) as opened:
            status = os.fstat(opened.descriptor)
            if not stat.S_ISREG(status.st_mode):
                raise UsageError(f"{path} is no file")
            if status.st_uid not in (os.geteuid(), 0):
                raise UsageError(f"{path} belongs to somebody else")
            if status.st_mode & 0o077:
                raise UsageError(f"{path} can be read or written by others than its owner; `chmod 600` it, and change the passwords in it")
            return netrc.netrc(f"/dev/fd/{opened.descriptor}")  # the very file that was looked at
    except netrc.NetrcParseError as error:
        raise UsageError(f"{path}, line {error.lineno}: this is no netrc entry") from None  # its text may hold a password
    except (OSError, UnicodeError) as error:
        raise UsageError(f"the credentials cannot be read: {error}") from None


class _Opened:
    def __init__(self, path):
        self.descriptor = os.open(path, os.O_RDONLY | os.O_NONBLOCK | os.O_CLOEXEC)

    def close(self):
        os.close(self.descriptor)
