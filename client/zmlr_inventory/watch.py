"""Alerts of several hosts as they come, until the program is interrupted."""

import signal
import sys
import threading
import time

import pywbem

from . import hosts, parallel
from .exits import NOTHING, PARTLY, WELL
from .output import give_up_output, reason, say
from .subscription import Subscription
from .values import PERCEIVED_SEVERITY, visible

ENDING = (signal.SIGINT, signal.SIGTERM, signal.SIGHUP)
SEVERITY_WIDTH = max(map(len, PERCEIVED_SEVERITY.values()))
PATIENCE = 3  # seconds for hosts that are still being subscribed at, after an interruption


def watch(urls, connect, options):
    """Subscribes at every host and prints what comes; the subscriptions go before it returns the exit code.

    A host that takes no subscription, or keeps it, costs its own part. The second signal ends the program at once: who interrupts
    does not want to wait for a dead host."""
    ended, ended_at, failed = threading.Event(), [], []
    made, taken = {}, {}  # subscriptions: all, and those that the servers have

    def end(number, _):
        ended_at.append(time.monotonic())
        ended.set()
        signal.signal(number, signal.SIG_DFL)

    for number in ENDING:
        if signal.getsignal(number) is not signal.SIG_IGN:  # as nohup leaves them
            signal.signal(number, end)

    def fail(url, what, error):
        failed.append(url)
        say(f"{url}: {what}: {reason(error)}")

    def each(function, what, done, some, is_late=lambda url: False):
        """What comes of doing something at some hosts."""
        progress = parallel.Progress(sys.stderr, len(some), done)
        for url in some:
            progress.step(hosts.label_of(url), what)
        for url, result, error in parallel.each(function, some, options.parallel, progress.show, is_late):
            progress.finish(hosts.label_of(url))
            progress.clear()
            yield url, result, error

    def subscribe(url):
        host = f"{hosts.label_of(url)}  " if len(urls) > 1 else ""
        port = options.listen_port + urls.index(url) if options.listen_port else 0
        show = _printer(host, ended)
        made[url] = Subscription(connect(url), show, options.query, options.listen, port)
        return made[url].__enter__()

    def is_late(_):
        return bool(ended_at) and time.monotonic() > ended_at[0] + PATIENCE

    for url, subscription, error in each(subscribe, "subscribing", "subscribed at", urls, is_late):
        if error:
            fail(url, "takes no subscription", error)
            if isinstance(error, TimeoutError) and url in made:
                made[url].stop()  # its threads would outlive this one
        else:
            taken[url] = subscription
            say(f"{url} sends its alerts to {subscription.url}")
    if taken and not ended.is_set():
        say("Ctrl-C ends")
        ended.wait()

    for url, _, error in each(lambda url: taken[url].__exit__(), "removing the subscription", "left", list(taken)):
        if error:
            fail(url, "its subscription may be left there", error)
    return NOTHING if not taken else PARTLY if failed else WELL


def _printer(host, ended):
    def show(alert):
        try:
            print(visible(host + line_of(alert)), flush=True)
        except OSError:  # nobody reads it any more
            give_up_output()
            ended.set()

    return show


def line_of(alert):
    """What there is of an alert, in one line; the action only where there is something to do. Anybody may send anything."""

    def text(name):
        value = alert.get(name)
        return value if isinstance(value, str) else ""

    when, severity, actions = (alert.get(name) for name in ("EventTime", "PerceivedSeverity", "RecommendedActions"))
    when = when.datetime if isinstance(when, pywbem.CIMDateTime) else None
    fields = [
        when.strftime("%Y-%m-%d %H:%M:%S") if when else "",
        PERCEIVED_SEVERITY.get(severity, str(severity)).ljust(SEVERITY_WIDTH) if isinstance(severity, int) else "",
        (text("MessageID") or text("EventID")).ljust(10),
        text("Message"),
        *(str(action) for action in (actions if isinstance(actions, list) else []) if action != "No action required."),
    ]
    return "  ".join(field for field in fields if field.strip())
