"""What zmlr-inventory shows of simulated hosts, and of texts that no simulated host can send."""

import copy
import json
import os
import xml.etree.ElementTree
from pathlib import Path

import jsonschema
import pytest
import pywbem

from tools.simulated_server import ROOT
from zmlr_inventory import model, reading, topology, tree, values
from zmlr_inventory.json_text import json_text

HERE = Path(__file__).parent
DEAD = "http://127.0.0.1:1"
HOSTILE = "\x1b]0;owned\x07 \u202egnp </text><script>alert(1)</script>\"'&amp;\n\udcff|}]>"


def strict(schema):
    """A schema that takes no member that it does not describe."""
    if isinstance(schema, dict):
        closed = {"additionalProperties": False} if "properties" in schema else {}
        return {**{key: strict(value) for key, value in schema.items()}, **closed}
    return [strict(value) for value in schema] if isinstance(schema, list) else schema


SCHEMA = strict(json.loads((ROOT / "client/inventory.schema.json").read_text(encoding="utf-8")))


def same_as_golden(name, text, host, url):
    anonymous, golden = text.replace(url, "<url>").replace(host, "<host>"), HERE / "golden" / name
    if os.environ.get("ZMLR_REWRITE_GOLDEN"):
        golden.write_text(anonymous, encoding="utf-8")
    assert anonymous == golden.read_text(encoding="utf-8")


@pytest.mark.parametrize("scenario", ["mixed", "odd"])
def test_a_host_as_tree_json_and_picture(serve, run, tmp_path, scenario):
    server = serve(scenario)
    told = json.loads(run(server.url, "--json").stdout)
    jsonschema.validate(told, SCHEMA)
    host = told["hosts"][0]["name"]
    shown = run(server.url)
    assert (shown.returncode, shown.stderr) == (0, "")
    same_as_golden(f"{scenario}.txt", shown.stdout, f"{host}  ", server.url)

    picture = tmp_path / "topology.svg"
    assert run(server.url, "--svg", picture).returncode == 0
    texts = [element.text for element in xml.etree.ElementTree.parse(picture).iter("{http://www.w3.org/2000/svg}text")]
    same_as_golden(f"{scenario}-picture.txt", "\n".join(texts) + "\n", f"{host}\n", server.url)

    assert run("--all", server.url).stdout.count("LUN ") == sum(
        len(target["luns"]) for adapter in told["hosts"][0]["adapters"] for port in adapter["ports"] for target in port["targets"]
    )


def test_a_failed_host_costs_its_own_part(serve, run, tmp_path):
    listed = tmp_path / "hosts"
    listed.write_text(f"# what we have\n{DEAD}\n{serve('odd').url}  # the odd one\n{serve('mixed').url}\n", encoding="utf-8")
    shown = run(serve("mixed").url, "--hosts", listed)
    assert shown.returncode == 1
    assert [tree_of_host.split()[1] for tree_of_host in shown.stdout.split("\n\n")] == [serve("mixed").url, serve("odd").url]
    assert shown.stderr.startswith(f"zmlr-inventory: {DEAD}: ") and "refused" in shown.stderr and shown.stderr.count("\n") == 1

    told = json.loads(run("--json", "--hosts", listed).stdout)
    jsonschema.validate(told, SCHEMA)
    assert (len(told["hosts"]), [failure["url"] for failure in told["failures"]]) == (2, [DEAD])
    assert run(DEAD).returncode == 3


def test_a_class_that_cannot_be_read_costs_its_own_part():
    class Server:
        url = "http://server:5988"

        def EnumerateInstances(self, name, **_):
            if name == "ZEMLAR_TapeDrive":
                raise pywbem.CIMError(pywbem.CIM_ERR_FAILED, "out of order")
            return []

    assert reading.read_host(Server()).unread == ["ZEMLAR_TapeDrive: CIM_ERR_FAILED: out of order"]


def hostile_inventory():
    lun = model.Lun(0, "disk", HOSTILE, HOSTILE, 99)
    port = model.Port(HOSTILE, number=0, name=HOSTILE, module=model.Module(*[HOSTILE] * 7), targets=[model.Target(HOSTILE, [lun])])
    ethernet = model.EthernetPort(HOSTILE, number=1, interface=HOSTILE)
    software = [model.Software(*[HOSTILE] * 3)]
    adapter = model.Adapter(HOSTILE, "CNA", HOSTILE, HOSTILE, HOSTILE, HOSTILE, software=software, ports=[port], ethernet_ports=[ethernet])
    host = model.Host("http://h:1", HOSTILE, software=software, adapters=[adapter], unread=[HOSTILE], notes=[HOSTILE])
    return model.Inventory([host], [model.Failure("http://f:1", HOSTILE)])


def test_no_text_of_a_device_is_more_than_text():
    inventory = hostile_inventory()
    drawn = tree.tree_text(inventory, tree.Style())
    assert all(c == "\n" or values.visible(c) == c for c in drawn)
    assert len(drawn.splitlines()) == len(tree.tree_text(harmless(inventory), tree.Style()).splitlines())

    picture = xml.etree.ElementTree.fromstring(topology.svg(inventory))
    assert {element.tag.rpartition("}")[2] for element in picture.iter()} <= {"svg", "g", "title", "polygon", "polyline", "path", "text"}
    assert any("\\x1b]0;owned\\x07" in (element.text or "") and "</text><script>" in element.text for element in picture.iter())

    told = json_text(inventory)
    assert told.isascii() and "\x1b" not in told
    jsonschema.validate(json.loads(told), SCHEMA)


def harmless(inventory):
    other = copy.deepcopy(inventory)
    pending = [other]
    while pending:
        thing = pending.pop()
        for name, value in vars(thing).items():
            if value == HOSTILE:
                setattr(thing, name, "text")
            pending += [element for element in (value if isinstance(value, list) else [value]) if hasattr(element, "__dict__")]
    return other


def test_many_units_and_targets_stay_few_rows_and_lines():
    def targets(luns):
        return [model.Target(f"50060E800000000{t}", [model.Lun(number, "disk", "M", "N", 2) for number in luns]) for t in range(2)]

    def lines_of(*views):
        ports = [model.Port(str(n), number=n, status=11, targets=targets(luns)) for n, luns in enumerate(views)]
        dot = topology.dot_text(model.Inventory([model.Host("u", "h", adapters=[model.Adapter("a", "FC HBA", ports=ports)])]))
        assert len(dot) < 8000
        return dot.count("LUN 0-199<br"), [line.split("[")[0].split(" -> ") for line in dot.splitlines() if "->" in line]

    assert lines_of(range(200), range(200)) == (2, [["  h0:a0p0:e", "t0:w "], ["  h0:a0p1:e", "t0:w "]])
    other = [[f"  h0:a0p{port}:e", f"t{target}:v{port}:w "] for target in (0, 1) for port in (0, 1)]
    assert lines_of(range(200), range(0, 200, 2)) == (2, other)
