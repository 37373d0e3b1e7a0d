"""The programs and files of the host: every change goes through here, so that it can be told, or told instead of made."""

import os
import pathlib
import shutil
import signal
import subprocess
import sys
import tempfile

from .steps import Failed

_FOLDERS = ("/usr/local/sbin", "/usr/local/bin", "/usr/sbin", "/usr/bin", "/sbin", "/bin", "/opt/tog-pegasus/sbin",
            "/opt/tog-pegasus/bin")
_TIME_LIMIT = 900  # s, of one program
_SIGNALS = (signal.SIGINT, signal.SIGTERM, signal.SIGHUP)


class Stopped(Exception):
    """A signal asked to stop. Nothing that takes a failure for an answer may swallow it."""

    def __init__(self, number):
        super().__init__(f"stopped by {signal.Signals(number).name}")
        self.number = number


class Tools:
    def __init__(self, dry_run=False, verbose=False):
        self.dry_run = dry_run
        self._verbose = verbose
        self._signal = None
        self._undoing = False

    def listen_to_signals(self):
        """From here on a signal stops before the next change: programs that run come to their end."""
        for number in _SIGNALS:
            signal.signal(number, self._remember)

    def _remember(self, number, _frame):
        self._signal = self._signal or number

    def begin_undoing(self):
        """From here on signals stop nothing any more."""
        self._undoing = True

    def say(self, text):
        """Whether or not somebody still listens: a reader who left must not stop what is being undone."""
        try:
            print(text, flush=True)
        except OSError:
            sys.stdout = open(os.devnull, "w", encoding="utf-8")

    def find(self, program):
        """Its path, or None."""
        return shutil.which(program, path=os.pathsep.join([*os.get_exec_path(), *_FOLDERS]))

    def ask(self, program, *words):
        """Runs a program that changes nothing: what it says on standard output."""
        return self._run(program, words)

    def change(self, program, *words):
        if self.dry_run or self._verbose:
            self.say(f"  {'would run' if self.dry_run else 'running'}: {' '.join([program, *map(str, words)])}")
        if not self.dry_run:
            self._run(program, words)

    def _run(self, program, words):
        self._check_signal()
        path = self.find(program)
        if not path:
            raise Failed(f"the program {program} is not there")
        # A session of its own: a key pressed in the terminal must not cut a program in its middle. Answers are read: no translations.
        try:
            result = subprocess.run([path, *map(str, words)], stdin=subprocess.DEVNULL, capture_output=True, text=True,
                                    errors="replace", timeout=_TIME_LIMIT, start_new_session=True, check=False,
                                    env={**os.environ, "LC_ALL": "C.UTF-8", "LANGUAGE": ""})
        except subprocess.TimeoutExpired as error:
            raise Failed(f"{program} {' '.join(map(str, words))}: no end after {_TIME_LIMIT} s") from error
        if result.returncode != 0:
            reason = (result.stderr.strip() or result.stdout.strip() or "no reason given").splitlines()
            raise Failed(f"{program} {' '.join(map(str, words))}: exit status {result.returncode}: {' '.join(reason[-3:])}")
        self._check_signal()
        return result.stdout

    def _check_signal(self):
        if self._signal and not self._undoing:
            raise Stopped(self._signal)

    def with_files(self, texts, use):
        """Calls use(folder) with a folder of files of these names and texts, which is gone afterwards."""
        with tempfile.TemporaryDirectory(prefix="zmlr-register-") as folder:
            for name, text in texts.items():
                pathlib.Path(folder, name).write_text(text, encoding="utf-8")
            use(pathlib.Path(folder))

    def change_file(self, words, change):
        """A change of the file system: `words` tell it, change() makes it."""
        self._check_signal()
        if self.dry_run or self._verbose:
            self.say(f"  {'would ' if self.dry_run else ''}{words}")
        if not self.dry_run:
            change()

    def warn(self, text):
        print(f"zmlr-register: {text}", file=sys.stderr, flush=True)


class Store:
    """What was registered, kept for the next run: named texts in a folder of our own."""

    def __init__(self, tools, folder):
        self._tools = tools
        self.folder = pathlib.Path(folder)

    def read(self, name):
        """The text, or None."""
        try:
            return (self.folder / name).read_text(encoding="utf-8")
        except FileNotFoundError:
            return None

    def write(self, name, text):
        path = self.folder / name
        self._tools.change_file(f"write {path}", lambda: self._replace(path, text))

    def _replace(self, path, text):
        self.folder.mkdir(mode=0o755, parents=True, exist_ok=True)
        part = path.with_name(path.name + ".part")
        part.write_text(text, encoding="utf-8")
        os.replace(part, path)

    def remove(self, name):
        path = self.folder / name
        if path.exists():
            self._tools.change_file(f"remove {path}", path.unlink)
