"""Alerts as a listener gets them: every event that makes one, bursts, listeners that die, ends in the middle; script/alerts."""

import datetime
import json
import re
import signal
import socket
import time
from pathlib import Path

import pytest
import pywbem
from conftest import TIMEOUT, code_of, wait_until

from tools.running import running
from tools.simulated_server import ROOT
from zmlr_inventory.subscription import Subscription

HERE = Path(__file__).parent
EVENTS = [line.split("\t") for line in (HERE / "alerts.txt").read_text(encoding="utf-8").splitlines() if line[0] != "#"]
WWN, MAC = "100000051E2A0000", "00051E2A0010"
KINDS = {
    "port": ("Port", "ZEMLAR_FCPort", WWN),
    "audit": ("Audit", "ZEMLAR_FCPort", WWN),
    "ethport": ("EthPort", "ZEMLAR_EthernetPort", MAC),
}
# The big numbers are those that lead to another event's row when they are taken for signed or cut.
NO_ALERTS = [
    *["adapter add", "adapter remove", "lport online", "rport online", "itnim online", "ioc hbfail", "tin 1", "99 1"],
    *["port rlir", "port 0", "port 16", "port 65537", "port 393217", "port 4294901761", "port 4294967295"],
    *["audit 0", "audit 3", "audit 4294967295", "ethport 0", "ethport 5", "ethport 65537", "ethport 4294443010"],
]


@pytest.fixture
def served(start):
    """served(scenario, environment, options): a server in which the 20 ms between two alerts are short."""

    def serve(scenario="cna", environment=None, options=("--no-auth", "--delivery-pause", "0.2")):
        return start(scenario, {"HXASIM_TIME_SCALE": "0.02", **(environment or {})}, options=list(options))

    return serve


def subscribed(host, received, query="SELECT * FROM ZEMLAR_AlertIndication"):
    return Subscription(host.pywbem, received.append, query)


def expected(row, system):
    """The properties of an alert that are not null, but for its times."""
    event, event_id, severity, message_id, cause, action, message, arguments = row
    kind, class_name, device = KINDS[event.split()[0]]
    path = f"//{system}/root/zemlar:"
    values = {
        "wwn": WWN,
        "mac": MAC,
        "fabric": "100000051EF00000",
        "system": f'{path}ZEMLAR_ComputerSystem.Name="{system}",CreationClassName="ZEMLAR_ComputerSystem"',
    }
    switched = message_id.startswith("PLAT")
    return {
        "AlertingManagedElement": f'{path}{class_name}.SystemCreationClassName="ZEMLAR_ComputerSystem",SystemName="{system}"'
        f',CreationClassName="{class_name}",DeviceID="{device}"',
        "AlertingElementFormat": 2,
        "SystemCreationClassName": "ZEMLAR_ComputerSystem",
        "SystemName": system,
        "ProviderName": "zmlrprovider",
        "OwningEntity": "DMTF" if switched else "ZEMLAR",
        "AlertType": 2 if switched else 1,
        "OtherAlertType": "" if switched else kind,
        "Category": kind,
        "ProbableCause": 1,
        "IndicationIdentifier": event_id,
        "EventID": event_id,
        "PerceivedSeverity": int(severity),
        "Description": cause,
        "ProbableCauseDescription": cause,
        "RecommendedActions": [action],
        "MessageID": message_id,
        "Message": message.format(**values),
        "MessageArguments": [argument.format(**values) for argument in arguments.split("|")],
    }


def test_every_event_makes_its_alert_or_none(served, tmp_path):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = INFO\n", encoding="utf-8")
    host, received = served(environment={"HOME": str(tmp_path)}), []
    system = host.pywbem.EnumerateInstances("ZEMLAR_ComputerSystem")[0]["Name"]
    with subscribed(host, received):
        for event in NO_ALERTS:
            host.server.hxasim("event", *event.split())
        for number, row in enumerate(EVENTS):
            host.server.hxasim("event", *row[0].split())
            wait_until(lambda n=number: len(received) > n)
            alert = {name: value for name, value in received[number].items() if value is not None}
            times = alert.pop("EventTime"), alert.pop("IndicationTime")
            assert alert == expected(row, system), row[0]
            assert times[0] == times[1]
            assert abs(datetime.datetime.now(datetime.timezone.utc) - times[0].datetime) < datetime.timedelta(seconds=TIMEOUT)
    assert len(received) == len(EVENTS)
    assert host.server.hxasim("status")["violations"] == []
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    unheard = re.findall(r"(Not supported .*event|\w+ event callback invoked with event id not)", log)
    words = {word: sum(line.startswith(word) for line in unheard) for word in ("Not", "Port", "Audit", "EthPort")}
    assert words == {"Not": 1, "Port": 6, "Audit": 3, "EthPort": 4}, "an event without a message is not one without support"


def test_queries_choose_by_class_severity_and_event(served):
    host = served()
    queries = {
        "SELECT * FROM CIM_Indication": ["ONLINE", "SFP_REMOVE", "DISCONNECT"],
        "SELECT EventID FROM CIM_AlertIndication WHERE PerceivedSeverity > 2": ["SFP_REMOVE", "DISCONNECT"],
        "SELECT * FROM CIM_ProcessIndication WHERE PerceivedSeverity = 6": ["DISCONNECT"],
        "SELECT * FROM ZEMLAR_AlertIndication WHERE EventID = 'HXA_AEN_PORT_ONLINE'": ["ONLINE"],
    }
    received = {query: [] for query in queries}
    subscriptions = [subscribed(host, alerts, query).__enter__() for query, alerts in received.items()]
    for event in ("online", "sfp-remove", "disconnect"):
        host.server.hxasim("event", "port", event)
    wait_until(lambda: sum(map(len, received.values())) == 7)
    for subscription in subscriptions:
        subscription.__exit__()
    got = {query: [alert["EventID"].removeprefix("HXA_AEN_PORT_") for alert in alerts] for query, alerts in received.items()}
    assert got == queries


def raise_numbered(host, count):
    """Changes of the fabric's name on both ports in turn; the names are numbers."""
    told = re.search(r"HXASIM_CONTROL=(.+) \S+ status", "\n".join(host.server.lines))
    with socket.socket(socket.AF_UNIX) as control, control.makefile("rw") as stream:
        control.connect(told[1])
        for number in range(count):
            data = f"{WWN[:-1]}{number % 2}{number:016X}".ljust(80, "0")
            event = {"request": "event", "category": "port", "event": "fabric-name-change", "instance": number % 2, "data": data}
            print(json.dumps(event), file=stream, flush=True)
            assert json.loads(stream.readline())["ok"]


def test_a_burst_arrives_complete_and_in_order(served):
    host, received = served(), []
    with subscribed(host, received):
        raise_numbered(host, 1000)
        wait_until(lambda: len(received) == 1000)
    for port in "01":
        names = [alert["MessageArguments"][1] for alert in received if alert["MessageArguments"][0] == WWN[:-1] + port]
        assert names == [f"{number:016X}" for number in range(int(port), 1000, 2)]


def test_alerts_keep_their_pace_while_a_listener_is_dead(served):
    host = served(environment={"HXASIM_TIME_SCALE": "1"}, options=["--no-auth", "--delivery-pause", "0.2", "--max-indications", "20"])
    dead, alive = [], []
    with subscribed(host, dead) as subscription, Subscription(host.pywbem, lambda alert: alive.append((time.monotonic(), alert))):
        subscription._listener.stop()
        raise_numbered(host, 60)
        wait_until(lambda: len(alive) == 60)
        assert alive[-1][0] - alive[0][0] > 58 * 0.020 * 0.9, "one in 20 ms"
        assert len(host.device_ids()) == 2
        wait_until(lambda: any(f"{subscription.url}: too much waited" in line for line in host.server.lines))
        subscription._listener.start()
        wait_until(lambda: dead and dead[-1]["MessageArguments"] == alive[-1][1]["MessageArguments"])
        assert len(dead) <= 21


def test_the_end_in_the_middle(served):
    host, received = served(environment={"HXASIM_TIME_SCALE": "1"}), []
    with pytest.raises(pywbem.ConnectionError), subscribed(host, received):
        host.server.hxasim("event", "port", "online", "--count", 20000)
        wait_until(lambda: received)
        begin = time.monotonic()
        assert host.server.stop() == 0
        assert time.monotonic() - begin < 5


@pytest.mark.parametrize("scenario", ["no-driver", {"adapters": []}])
def test_without_adapters_nobody_can_subscribe(served, tmp_path, scenario):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = ERR\n", encoding="utf-8")
    host = served(scenario, {"HOME": str(tmp_path)})
    for _ in range(2):
        assert code_of(subscribed(host, []).__enter__) == pywbem.CIM_ERR_FAILED
    why = "No adapters are found! Registration did NOT happen."
    if scenario == "no-driver":
        why = "Driver is not installed or there is a hxal mismatch. Will not invoke subscription. "
    told = [line.split("): ")[1] for line in (tmp_path / ".cimple/messages").read_text(encoding="utf-8").splitlines()]
    assert [line for line in told if "probe" not in line and "ERROR" not in line][:2] == [why, "Subscribtion for event notifications FAILED."]


def test_the_log_tells_of_a_subscription_step_by_step(served, tmp_path):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = DBG\n", encoding="utf-8")
    host = served({"adapters": [{"kind": "fc-hba", "ports": [{}]}, {"kind": "cna", "ports": [{}]}]}, {"HOME": str(tmp_path)})
    with subscribed(host, []):
        pass
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    steps = re.findall(r"^\S+ \S+ (\w+: (?:Indication\w+|ZEMLAR_AlertIndication_Provider))\(\d+\)(: .*)", log, re.MULTILINE)
    threads = ("Entering: deliver", "Returning: deliver")  # they come when the thread does
    lines = ["".join(step) for step in steps if not any(thread in step[1] for thread in threads)]
    assert lines == (HERE / "alert_log.txt").read_text(encoding="utf-8").splitlines()


def test_script_alerts_shows_them_until_it_is_interrupted(served):
    host = served()
    kinds = ["CIM_IndicationFilter", "CIM_ListenerDestination", "CIM_IndicationSubscription"]
    everything = f" Warning      ZMLR131077  SFP removed: WWN/MAC = {WWN}.  Check whether SFP is inserted properly."
    one_property = ["--query", "SELECT EventID FROM ZEMLAR_AlertIndication"]
    for number, query, told in ((signal.SIGINT, [], everything), (signal.SIGTERM, one_property, "HXA_AEN_PORT_SFP_REMOVE")):
        command = [ROOT / "script/alerts", host.server.url, *query]
        with running(command, stdout=-1, stderr=-1, text=True) as script:
            assert host.server.url in script.stderr.readline()
            host.server.hxasim("event", "port", "sfp-remove")
            line = script.stdout.readline().rstrip("\n")
            assert re.sub(r"^\S+ \S+ ", "", line) == told
            script.send_signal(number)
            assert script.wait(TIMEOUT) == 0
        left = [name for kind in kinds for name in host.pywbem.EnumerateInstanceNames(kind, namespace="root/PG_InterOp")]
        assert left == []
