"""Programs that a test starts, talks to and ends: one that fails meanwhile is not kept waiting for them."""

import contextlib
import subprocess


@contextlib.contextmanager
def running(command, **options):
    """The started program (`options` are those of Popen), waited for at the end; killed when the caller fails."""
    with subprocess.Popen(command, **options) as program:
        try:
            yield program
        except BaseException:
            program.kill()
            raise
