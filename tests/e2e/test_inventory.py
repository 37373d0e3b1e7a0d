"""The inventory as clients see it. Golden inventories hold all that is served on a scenario; script/golden rewrites them."""

import difflib
import re
from pathlib import Path

import pytest
import pywbem

from tools.inventory_text import inventory_text, served_classes

FILES = sorted((Path(__file__).parent / "golden").glob("*.txt"))


@pytest.fixture(scope="module", params=FILES, ids=lambda file: file.stem)
def scenario(request, module_start):
    return module_start(request.param.stem), request.param


def test_all_that_is_served(scenario):
    host, file = scenario
    served = (inventory_text(host.server.url) + "\n").splitlines()
    golden = file.read_text(encoding="utf-8").splitlines()
    difference = list(difflib.unified_diff(golden, served, "golden", "served", lineterm="", n=4))
    assert not difference, "\n".join(difference)


def sample(instances):
    return instances[:4] + instances[4::37]


def test_each_instance_is_fetched_again_by_its_path(scenario):
    host, _ = scenario
    for class_name in served_classes():
        instances = host.pywbem.EnumerateInstances(class_name)
        names = host.pywbem.EnumerateInstanceNames(class_name)
        assert [instance.path for instance in instances] == names
        first_of = {}
        for instance in instances:
            first_of.setdefault(instance.path, instance)
        for name in sample(names):
            whole = host.pywbem.GetInstance(name)
            assert whole == first_of[name]
            asked = list(whole.keys())[::7] + ["NoSuchProperty"]
            some = host.pywbem.GetInstance(name, PropertyList=asked)
            assert {key: some[key] for key in some.keys()} == {key: whole[key] for key in asked if key in whole}


def test_script_server_lets_its_host_remember_the_latest_requests_only(scenario):
    status = scenario[0].server.hxasim("status")
    assert status["remembered"] == min(status["requests"], 1000)


def key_values(path):
    for value in path.keybindings.values():
        yield from key_values(value) if isinstance(value, pywbem.CIMInstanceName) else [str(value)]


def as_wbemcli_prints(value):
    if isinstance(value, list):
        return ",".join(map(as_wbemcli_prints, value))
    return "" if value is None else str(value).lower() if isinstance(value, bool) else str(value)


def test_wbemcli_sees_the_same(mixed):
    for class_name in served_classes():
        lines = mixed.wbemcli.enumerate_instance_names(class_name)
        seen = mixed.wbemcli.enumerate_instances(class_name)
        for instance, other, line in zip(mixed.pywbem.EnumerateInstances(class_name), seen, lines, strict=True):
            plain = {key: as_wbemcli_prints(value) for key, value in instance.items() if not isinstance(value, pywbem.CIMInstanceName)}
            assert plain.items() <= other.items()
            for value in key_values(instance.path):
                _, found, line = line.partition(value)
                assert found
        if lines:
            assert mixed.wbemcli.get_instance(lines[-1]) == seen[-1]
            listed = list(seen[-1])[1::5]
            assert mixed.wbemcli.get_instance(lines[-1], *listed).items() == {key: seen[-1][key] for key in ["__path", *listed]}.items()


def test_the_beacon_does_what_it_is_told(start, tmp_path):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = INFO\n", encoding="utf-8")
    host = start("cna", {"HOME": str(tmp_path)})
    path = host.pywbem.EnumerateInstanceNames("ZEMLAR_AlarmDevice")[0]

    def set_state(state, of=path):
        """The code that comes back, and whether the driver was asked at all."""
        arguments = {} if state is None else {"State": pywbem.Uint16(state)}
        before = host.server.hxasim("requests")
        code = host.pywbem.InvokeMethod("SetAlarmState", of, **arguments)[0]
        return code, host.server.hxasim("requests") != before

    seen = []
    for state in (3, 3, 1, 1, 2, 0, None):
        seen.append((*set_state(state), host.pywbem.GetInstance(path)["AlarmState"]))
    assert seen == [(0, True, 3), (2, True, 3), (0, True, 1), (2, True, 1), (2, False, 1), (2, False, 1), (2, False, 1)]
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    done, failed, refused = ("INFO", "return value = 0"), ("INFO", "return value = 2"), ("ERR", "Error: Invalid Input State")
    said = [done, failed, done, failed, *[refused, failed] * 3]
    assert re.findall(r"(\w+): ZEMLAR_AlarmDevice_Provider\(\d+\): (.*)", log) == said

    nobody = path.copy()
    nobody["DeviceID"] = "1000000000000000"
    assert [set_state(3, of) for of in (nobody, path.classname)] == [(2, False), (2, False)]


def test_the_beacon_of_a_mezzanine_card_is_not_supported(mixed):
    path = mixed.pywbem.EnumerateInstanceNames("ZEMLAR_AlarmDevice")[0]
    path["DeviceID"] = "100000051E100200"
    assert mixed.pywbem.InvokeMethod("SetAlarmState", path, State=pywbem.Uint16(3))[0] == 1
