"""How long an event takes from the driver to a listener, and what a subscription costs while nothing happens.

    ZMLR_BUILD_DIR=build/release python bench/alerts.py [SAMPLES]

An alert waits for the delivery cycle of 20 ms: 0 to 20 ms of the time, by chance.
"""

import argparse
import json
import random
import re
import socket
import statistics
import sys
import threading
import time
from http.server import BaseHTTPRequestHandler, ThreadingHTTPServer
from pathlib import Path

import pywbem

sys.path.insert(0, str(Path(__file__).resolve().parents[1]))

from tools.simulated_server import SimulatedServer  # noqa: E402

IDLE_SECONDS = 10
EVENT = b'{"request": "event", "category": "port", "event": "online"}\n'
TAKEN = (
    b'<?xml version="1.0" encoding="utf-8" ?><CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0">'
    b'<SIMPLEEXPRSP><EXPMETHODRESPONSE NAME="ExportIndication"/></SIMPLEEXPRSP></MESSAGE></CIM>'
)


class Listener(ThreadingHTTPServer):
    """Tells when an alert was there."""

    def __init__(self):
        self.received = threading.Event()
        self.when = 0.0
        listener = self

        class Handler(BaseHTTPRequestHandler):
            protocol_version = "HTTP/1.1"
            wbufsize = -1  # the answer leaves in one piece

            def do_POST(self):
                self.rfile.read(int(self.headers["Content-Length"]))
                listener.when = time.perf_counter()
                self.send_response(200)
                self.send_header("Content-Length", str(len(TAKEN)))
                self.end_headers()
                self.wfile.write(TAKEN)
                listener.received.set()

            def log_message(self, *_):
                pass

        super().__init__(("127.0.0.1", 0), Handler)
        threading.Thread(target=self.serve_forever, daemon=True).start()


def subscribe(server, listener):
    interop = pywbem.WBEMConnection(server.url, default_namespace="root/PG_InterOp")

    def make(class_name, **properties):
        return interop.CreateInstance(pywbem.CIMInstance(class_name, {"Name": "bench", **properties}))

    query = {"Query": "SELECT * FROM ZEMLAR_AlertIndication", "QueryLanguage": "WQL"}
    alert_filter = make("CIM_IndicationFilter", **query)
    destination = make("CIM_ListenerDestinationCIMXML", Destination=f"http://127.0.0.1:{listener.server_port}")
    ends = {"Filter": alert_filter, "Handler": destination}
    interop.CreateInstance(pywbem.CIMInstance("CIM_IndicationSubscription", ends))


def milliseconds_to_the_listener(server, listener, samples):
    told = re.search(r"HXASIM_CONTROL=(.+) \S+ status", "\n".join(server.lines))
    times = []
    with socket.socket(socket.AF_UNIX) as control, control.makefile("rb") as answers:
        control.connect(told[1])
        for _ in range(samples):
            time.sleep(random.uniform(0.03, 0.06))
            listener.received.clear()
            begin = time.perf_counter()
            control.sendall(EVENT)
            if not json.loads(answers.readline())["ok"] or not listener.received.wait(10):
                raise SystemExit("alerts: an event did not arrive")
            times.append((listener.when - begin) * 1000)
    return sorted(times)


def cost(pid):
    """Processor time in ms and how often its threads went to sleep, since the process began."""
    nanoseconds = switches = 0
    for task in Path(f"/proc/{pid}/task").iterdir():
        nanoseconds += int((task / "schedstat").read_text(encoding="ascii").split()[0])
        switches += int(re.search(r"^voluntary_ctxt_switches:\s*(\d+)", (task / "status").read_text(encoding="ascii"), re.M)[1])
    return nanoseconds / 1e6, switches


def cost_per_second(pid):
    before = cost(pid)
    time.sleep(IDLE_SECONDS)
    return [(now - then) / IDLE_SECONDS for now, then in zip(cost(pid), before)]


def main():
    parser = argparse.ArgumentParser(description="Measures how long an event takes from the driver to a listener.")
    parser.add_argument("samples", metavar="SAMPLES", nargs="?", type=int, default=300, help="how many events [300]")
    samples = parser.parse_args().samples
    with SimulatedServer("fc-hba", {"HXASIM_JOURNAL": "0"}) as server, Listener() as listener:
        without = cost_per_second(server.pid)
        subscribe(server, listener)
        times = milliseconds_to_the_listener(server, listener, samples)
        subscribed = cost_per_second(server.pid)
        listener.shutdown()
    print(f"alerts: {samples} events, one at a time, from the driver to the listener:")
    print(f"  median {statistics.median(times):.1f} ms, 99 % within {times[samples * 99 // 100]:.1f} ms, at most {times[-1]:.1f} ms")
    print("alerts: a second in which nothing happens costs")
    for what, (time_used, switches) in (("without", without), ("with", subscribed)):
        print(f"  {what} a subscription {time_used:.2f} ms of a processor and {switches:.0f} wake-ups")


if __name__ == "__main__":
    main()
