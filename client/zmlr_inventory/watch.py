"""Alerts of several hosts as they come, until the program is interrupted."""

import signal
import threading

import pywbem

from . import hosts, parallel
from .exits import NOTHING, PARTLY, WELL
from .output import give_up_output, say
from .subscription import Subscription
from .values import PERCEIVED_SEVERITY, visible

ENDING = (signal.SIGINT, signal.SIGTERM, signal.SIGHUP)
SEVERITY_WIDTH = max(map(len, PERCEIVED_SEVERITY.values()))


def watch(urls, connect, options):
    """Subscribes at every host and prints what comes; the subscriptions go before it returns the exit code.

    A host that takes no subscription, or keeps it, costs its own part."""
    ended, failed, taken = threading.Event(), [], {}
    ending = [number for number in ENDING if signal.getsignal(number) is not signal.SIG_IGN]  # as nohup leaves them
    for number in ending:
        signal.signal(number, lambda *_: ended.set())

    def fail(url, what, error):
        if not isinstance(error, (pywbem.Error, OSError)):
            raise error
        failed.append(url)
        say(f"{url}: {what}: {error}")

    def subscribe(url):
        host = f"{hosts.label_of(url)}  " if len(urls) > 1 else ""
        port = options.listen_port + urls.index(url) if options.listen_port else 0
        show = _printer(host, ended)
        return Subscription(connect(url), show, options.query, options.listen, port).__enter__()

    for url, subscription, error in parallel.each(subscribe, urls, options.parallel):
        if error:
            fail(url, "takes no subscription", error)
        else:
            taken[url] = subscription
            say(f"{url} sends its alerts to {subscription.url}")
    if taken:
        say("Ctrl-C ends")
        ended.wait()

    for number in ending:
        signal.signal(number, signal.SIG_DFL)  # who does not want to wait for a dead host may end it at once
    for url, _, error in parallel.each(lambda url: taken[url].__exit__(), list(taken), options.parallel):
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
    """What there is of an alert, in one line; the action only where there is something to do."""
    when, severity = alert.get("EventTime"), alert.get("PerceivedSeverity")
    fields = [
        when.datetime.strftime("%Y-%m-%d %H:%M:%S") if when else "",
        "" if severity is None else PERCEIVED_SEVERITY.get(severity, str(severity)).ljust(SEVERITY_WIDTH),
        (alert.get("MessageID") or alert.get("EventID") or "").ljust(10),
        alert.get("Message") or "",
        *(action for action in alert.get("RecommendedActions") or [] if action != "No action required."),
    ]
    return "  ".join(field for field in fields if field.strip())
