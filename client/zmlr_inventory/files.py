"""Files that are there whole or not at all."""

import os
import tempfile
from pathlib import Path


def write_atomically(path, content, mode=None):
    """Replaces a file by `content` (bytes); whoever reads it meanwhile sees the old or the new one. Raises OSError.

    Without a mode others may read it as they may a file that is simply created."""
    if os.path.exists(path) and not os.path.isfile(path):
        Path(path).write_bytes(content)  # a pipe or a terminal: nothing that could be replaced
        return
    path = Path(os.path.realpath(path))
    descriptor, temporary = tempfile.mkstemp(prefix=f".{path.name}.", dir=path.parent)
    try:
        with os.fdopen(descriptor, "wb") as file:
            file.write(content)
            os.fchmod(file.fileno(), 0o666 & ~_umask() if mode is None else mode)
            file.flush()
            os.fsync(file.fileno())
        os.replace(temporary, path)
    except BaseException:
        os.unlink(temporary)
        raise


def _umask():
    mask = os.umask(0o077)
    os.umask(mask)
    return mask
