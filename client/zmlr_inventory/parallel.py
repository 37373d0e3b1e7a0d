"""The same for many hosts at once, and how it gets on."""

import queue
import shutil
import threading
import time

PATIENCE = 1  # seconds until somebody wants to know
LINE_EVERY = 10  # seconds, where lines stay
TICK = 0.1  # seconds


def each(function, items, at_once, on_wait=lambda: None, is_late=lambda item: False):
    """Yields (item, result, exception) in the order in which they come; `on_wait` is called now and then meanwhile.

    An item that is late fails with TimeoutError, and its thread is left to itself. The threads are daemons: a person who interrupts
    does not wait for a host that does not answer."""
    todo, done = queue.SimpleQueue(), queue.SimpleQueue()
    open_items = dict.fromkeys(items)
    for item in items:
        todo.put(item)

    def work():
        while True:
            try:
                item = todo.get_nowait()
            except queue.Empty:
                return
            try:
                done.put((item, function(item), None))
            except Exception as error:  # pylint: disable=broad-except
                done.put((item, None, error))

    def start():
        threading.Thread(target=work, daemon=True).start()

    for _ in range(min(at_once, len(items))):
        start()
    while open_items:
        try:
            finished = done.get(timeout=TICK)
            if finished[0] in open_items:
                del open_items[finished[0]]
                yield finished
        except queue.Empty:
            on_wait()
        for item in [item for item in open_items if is_late(item)]:
            del open_items[item]
            start()  # its thread takes no other item for now
            yield item, None, TimeoutError("its answer takes too long")


class Progress:
    """Tells on a stream what has taken longer than a second: a line that changes on a terminal, a line now and then elsewhere."""

    def __init__(self, stream, count, done="read"):
        self._stream, self._count, self._done_word = stream, count, done
        self._live = stream.isatty()
        self._next = time.monotonic() + PATIENCE
        self._steps, self._done = {}, 0
        self._shown = False

    def step(self, host, what):
        """What a host is at; called from any thread."""
        self._steps[host] = what

    def finish(self, host):
        self._steps.pop(host, None)
        self._done += 1

    def show(self):
        now = time.monotonic()
        if now < self._next:
            return
        self._next = now + (TICK if self._live else LINE_EVERY)
        steps = [f"{host}: {what}" for host, what in list(self._steps.items())]
        text = "; ".join([f"{self._done} of {self._count} hosts {self._done_word}", *steps] if self._count > 1 else steps)
        if self._live:
            print(f"\r\x1b[K{text[: shutil.get_terminal_size().columns - 1]}", end="", file=self._stream, flush=True)
        else:
            print(f"zmlr-inventory: {text[:200]}", file=self._stream, flush=True)
        self._shown = True

    def clear(self):
        """Takes the changing line away before something else is printed."""
        if self._live and self._shown:
            print("\r\x1b[K", end="", file=self._stream, flush=True)
            self._shown = False
