"""The management agent's access point. Every server of the machine sees the agent, so nothing else is tested meanwhile."""

import re
import shutil

from tools.running import running


def test_the_access_point_is_there_while_the_agent_runs(start, tmp_path):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = INFO\n", encoding="utf-8")
    agent = tmp_path / "quillonagent"
    shutil.copy(shutil.which("sleep"), agent)
    host = start("no-driver", {"HOME": str(tmp_path)})

    def addresses():
        points = host.pywbem.EnumerateInstances("ZEMLAR_RemoteServiceAccessPoint")
        return [(point["Name"], point["ElementName"], point["InfoFormat"], point["AccessInfo"]) for point in points]

    def hosted(source, role, far_role):
        return client.AssociatorNames(source, AssocClass="ZEMLAR_RemoteServiceHostedAccessPoint", Role=role, ResultRole=far_role)

    client = host.pywbem
    system_path = client.EnumerateInstanceNames("ZEMLAR_ComputerSystem")[0]
    system = system_path["Name"]
    other = shutil.copy(agent, tmp_path / "quillonagentd")
    with running([other, "60"]) as process:
        before = addresses()
        process.terminate()
    with running([agent, "60"]) as process:
        during = addresses()
        points = hosted(system_path, "Antecedent", "Dependent")
        systems = hosted(points[0], "Dependent", "Antecedent") if points else []
        process.terminate()
    service = ("Quillon Service", "Quillon Service Access Point", 200, f"https://{system}:34568/index.html")
    assert (before, during, addresses()) == ([], [service], [])
    assert ([point["Name"] for point in points], [found["Name"] for found in systems]) == (["Quillon Service"], [system])
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    for level, line in (("INFO", "The Quillon Agent is not running so no service available"), ("ERR", "Warning: No service is available")):
        assert len(re.findall(rf"{level}: \w+\(\d+\): {line}\n", log)) == 2
