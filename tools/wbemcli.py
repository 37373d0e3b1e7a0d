"""wbemcli, the command line CIM client, with its answers read into dictionaries."""

import re
import subprocess

TIMEOUT = 60  # seconds


class WbemcliError(Exception):
    """wbemcli failed; the text is what it said."""


class Wbemcli:
    """Runs wbemcli against one name space of one server."""

    def __init__(self, port, name_space="root/zemlar"):
        self._base = f"http://127.0.0.1:{port}/{name_space}"

    def run(self, operation, target, *arguments):
        """The lines that `wbemcli OPERATION -nl URL:target arguments...` prints."""
        command = ["wbemcli", operation, "-nl", f"{self._base}:{target}" if target else self._base, *arguments]
        done = subprocess.run(command, capture_output=True, text=True, timeout=TIMEOUT, check=False)
        if done.returncode != 0:
            raise WbemcliError((done.stdout + done.stderr).strip())
        return done.stdout.splitlines()

    def enumerate_class_names(self):
        return [re.sub(r".*:", "", line) for line in self.run("ecn", "") if line]

    def get_class(self, class_name):
        return self.run("gc", class_name)

    def enumerate_instance_names(self, class_name):
        return [line for line in self.run("ein", class_name) if line]

    def enumerate_instances(self, class_name):
        return read_instances(self.run("ei", class_name))

    def get_instance(self, path, *properties):
        """One instance by the path that an enumeration gave, with a property list if names are given."""
        target = re.sub(r"^[^:]*(:\d+)?/[^:]*:", "", path)
        instances = read_instances(self.run("gi", target, *([",".join(properties)] if properties else [])))
        return instances[0]


def read_instances(lines):
    """Instances from wbemcli's -nl form: a path line, then one "-Name=value" line per property."""
    instances = []
    for line in lines:
        if line.startswith("-") and instances:
            name, _, value = line[1:].partition("=")
            instances[-1][name.rstrip("#[]")] = value.strip('"')
        elif line:
            instances.append({"__path": line})
    return instances
