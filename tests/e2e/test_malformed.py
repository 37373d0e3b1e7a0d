"""Requests that lack an element or have one twice, carry wrong attributes or values: every answer is one that clients read."""

import copy
import http.client
import xml.etree.ElementTree as ElementTree

import pytest
from pywbem import _tupleparse, _tupletree

NAME_SPACE = '<LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="zemlar"/></LOCALNAMESPACEPATH>'
RED = '<INSTANCENAME CLASSNAME="TST_Box"><KEYBINDING NAME="Name"><KEYVALUE VALUETYPE="string">red</KEYVALUE></KEYBINDING></INSTANCENAME>'
PROPERTY = '<PROPERTY NAME="Uint8Value" TYPE="uint8"><VALUE>7</VALUE></PROPERTY>'
ARRAY = '<PROPERTY.ARRAY NAME="StringValues" TYPE="string"><VALUE.ARRAY><VALUE>a</VALUE><VALUE>b</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>'
HOLDS = (
    f'<INSTANCENAME CLASSNAME="TST_Holds"><KEYBINDING NAME="Container"><VALUE.REFERENCE>{RED}</VALUE.REFERENCE></KEYBINDING>'
    '<KEYBINDING NAME="Content"><VALUE.REFERENCE><LOCALINSTANCEPATH>' + NAME_SPACE + '<INSTANCENAME CLASSNAME="TST_Item">'
    '<KEYBINDING NAME="Name"><KEYVALUE>bolt</KEYVALUE></KEYBINDING></INSTANCENAME></LOCALINSTANCEPATH></VALUE.REFERENCE>'
    "</KEYBINDING></INSTANCENAME>"
)


def parameter(name, value):
    return f'<IPARAMVALUE NAME="{name}">{value}</IPARAMVALUE>'


def message(call):
    return (
        '<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLEREQ>'
        f"{call}</SIMPLEREQ></MESSAGE></CIM>"
    )


def operation(name, *parameters):
    return message(f'<IMETHODCALL NAME="{name}">{NAME_SPACE}{"".join(parameters)}</IMETHODCALL>')


CLASS = parameter("ClassName", '<CLASSNAME NAME="TST_Box"/>')
FLAGS = parameter("DeepInheritance", "<VALUE>TRUE</VALUE>")
UNNAMED = '<INSTANCENAME CLASSNAME="TST_Box"><KEYVALUE>red</KEYVALUE></INSTANCENAME>'
LIST = parameter("PropertyList", "<VALUE.ARRAY><VALUE>Name</VALUE></VALUE.ARRAY>")

GOOD = {
    "GetClass": operation("GetClass", CLASS, LIST),
    "EnumerateInstances": operation("EnumerateInstances", CLASS, FLAGS, LIST),
    "GetInstance": operation("GetInstance", parameter("InstanceName", RED), LIST),
    "GetInstance by an unnamed key": operation("GetInstance", parameter("InstanceName", UNNAMED)),
    "GetInstance by references": operation("GetInstance", parameter("InstanceName", HOLDS)),
    "ModifyInstance": operation(
        "ModifyInstance",
        parameter("ModifiedInstance", f'<VALUE.NAMEDINSTANCE>{RED}<INSTANCE CLASSNAME="TST_Box">{PROPERTY}{ARRAY}</INSTANCE></VALUE.NAMEDINSTANCE>'),
    ),
    "CreateInstance": operation("CreateInstance", parameter("NewInstance", f'<INSTANCE CLASSNAME="TST_Refusal">{PROPERTY}</INSTANCE>')),
    "Associators": operation(
        "Associators",
        parameter("ObjectName", RED),
        parameter("AssocClass", '<CLASSNAME NAME="TST_Link"/>'),
        parameter("Role", "<VALUE>Container</VALUE>"),
    ),
    "ReferenceNames": operation("ReferenceNames", parameter("ObjectName", RED)),
    "GetProperty": operation("GetProperty", parameter("InstanceName", RED), parameter("PropertyName", "<VALUE>Caption</VALUE>")),
    "SetProperty": operation(
        "SetProperty",
        parameter("InstanceName", RED),
        parameter("PropertyName", "<VALUE>Uint8Value</VALUE>"),
        parameter("NewValue", "<VALUE>7</VALUE>"),
    ),
    "ExecQuery": operation("ExecQuery", parameter("QueryLanguage", "<VALUE>WQL</VALUE>"), parameter("Query", "<VALUE>select * from TST_Box</VALUE>")),
    "a method": message(
        f'<METHODCALL NAME="EchoObjects"><LOCALINSTANCEPATH>{NAME_SPACE}{RED}</LOCALINSTANCEPATH>'
        f'<PARAMVALUE NAME="Element" PARAMTYPE="reference"><VALUE.REFERENCE>{RED}</VALUE.REFERENCE></PARAMVALUE>'
        f'<PARAMVALUE NAME="Elements"><VALUE.REFARRAY><VALUE.REFERENCE>{RED}</VALUE.REFERENCE></VALUE.REFARRAY></PARAMVALUE>'
        "</METHODCALL>"
    ),
}
HOSTILE_TEXTS = ["", " ", "\u00e9\U0001f600", "<&>]]>\"'", "%n%s", "../..", "-1", "1e999", "0x", "9" * 400, "TRUE", "x" * 100_000]
HOSTILE_NAMES = HOSTILE_TEXTS[:4] + HOSTILE_TEXTS[-2:]  # an attribute is no number


def elements(root):
    """Every element below the root, as (parent, element)."""
    return [(parent, child) for parent in root.iter() for child in parent]


def mutations(text):
    """(what was done, request) for each element missing, twice, renamed, with each hostile text and attribute."""
    for number, (_, original) in enumerate(elements(ElementTree.fromstring(text))):
        tag = f"{number}:{original.tag}"

        def edited(edit, number=number):
            root = ElementTree.fromstring(text)
            edit(*elements(root)[number])
            return ElementTree.tostring(root)

        yield f"{tag} missing", edited(lambda parent, child: parent.remove(child))
        yield f"{tag} twice", edited(lambda parent, child: parent.append(copy.deepcopy(child)))
        yield f"{tag} emptied", edited(lambda parent, child: child.clear())
        yield f"{tag} renamed", edited(lambda parent, child: setattr(child, "tag", "VALUE.NULL"))
        yield f"{tag} inside itself", edited(lambda parent, child: child.append(copy.deepcopy(child)))
        for hostile in HOSTILE_TEXTS if original.text else HOSTILE_TEXTS[3:4]:
            yield f"{tag} says {hostile[:12]!r}", edited(lambda parent, child, hostile=hostile: setattr(child, "text", hostile))
        for name in original.attrib:
            yield f"{tag} without {name}", edited(lambda parent, child, name=name: child.attrib.pop(name))
            for hostile in HOSTILE_NAMES:
                yield f"{tag} {name}={hostile[:12]!r}", edited(
                    lambda parent, child, name=name, hostile=hostile: child.set(name, hostile)
                )


def outcome_of(connection, body):
    """The HTTP status with the CIM status (0 for success), read as pywbem reads it."""
    connection.request("POST", "/cimom", body, {"Content-Type": "application/xml", "CIMOperation": "MethodCall"})
    response = connection.getresponse()
    answer = response.read()
    if response.status != 200:
        assert response.status in (400, 413, 501)
        assert response.getheader("CIMError"), response.status
        return response.status, None
    parsed = _tupleparse.TupleParser().parse_cim(_tupletree.xml_to_tupletree_sax(answer, "answer"))
    children = parsed[2][2][2][2]
    error = next((child for child in children or [] if child[0] == "ERROR"), None)
    if error:
        assert error[1]["DESCRIPTION"]
        assert len(answer) < 1_100_000, "what a client sent is not sent back several times"
    return 200, int(error[1]["CODE"]) if error else 0


@pytest.mark.parametrize("name", GOOD)
def test_every_mutation_gets_an_answer_that_clients_read(tst, name):
    connection = http.client.HTTPConnection("127.0.0.1", tst.server.port, timeout=60)
    status, code = outcome_of(connection, GOOD[name])
    assert (status, code) == (200, {"ExecQuery": 7, "CreateInstance": 4}.get(name, 0))
    outcomes = {what: outcome_of(connection, body) for what, body in mutations(GOOD[name])}
    assert all(code is None or 0 <= code <= 17 for _, code in outcomes.values())
    assert sum(code != 0 for _, code in outcomes.values()) > len(outcomes) // 2, "most of these are wrong"
    frame = [f"{element} {done}" for element in ("0:MESSAGE", "1:SIMPLEREQ") for done in ("missing", "twice", "emptied", "renamed")]
    assert {outcomes[what] for what in frame} == {(400, None)}
    assert tst.pywbem.GetInstance(tst.pywbem.EnumerateInstanceNames("TST_Item")[0])["Weight"] == 1
