"""Times benchmarks, and counts the instructions of one iteration under callgrind: instructions.py PROGRAM..."""

import json
import re
import subprocess
import sys
import tempfile
from pathlib import Path

# By program: the benchmarks to measure, and how many of which unit one iteration handles.
MEASURED = {
    "enumerate_fc_ports": [(f"enumerate_fc_ports/{adapters}", 2 * adapters, "port") for adapters in [1, 4, 16, 64]],
    "scan": [(f"scan/{iocs}", 2 * iocs, "IOC") for iocs in [1, 16, 128]],
    "runtime_instances": [
        ("life_of_a_port", 1_000, "port"),
        ("key_eq_of_two_ports", 1_000, "call"),
        ("find_a_class_by_name", 1_000, "call"),
        ("filter_ten_properties", 1_000, "call"),
    ],
    "conversion": [("convert_fc_port", 100, "port"), ("bare_broker_calls", 100, "port")],
    "log_call": [("suppressed_log_call", 100_000, "call")],
}

NANOSECONDS = {"ns": 1, "us": 1_000, "ms": 1_000_000}


def nanoseconds(program, benchmark):
    """The time of one iteration, without callgrind."""
    run = subprocess.run(
        [program, f"--benchmark_filter=^{benchmark}$", "--benchmark_format=json"], check=True, capture_output=True
    )
    row = json.loads(run.stdout)["benchmarks"][0]
    return row["real_time"] * NANOSECONDS[row["time_unit"]]


def instructions(program, benchmark):
    """Instructions inside the benchmark's loop, which runs once."""
    with tempfile.TemporaryDirectory() as folder:
        output = Path(folder) / "callgrind.out"
        subprocess.run(
            [
                "valgrind",
                "--tool=callgrind",
                "--collect-atstart=no",
                f"--callgrind-out-file={output}",
                program,
                f"--benchmark_filter=^{benchmark}$",
                "--benchmark_min_time=0.000001",
            ],
            check=True,
            capture_output=True,
        )
        return int(re.search(r"^(?:totals|summary): (\d+)", output.read_text(), re.MULTILINE)[1])


def main():
    print(f"\n{'benchmark':<24} {'instructions':>14} {'per unit':>12} {'ns':>10}  unit")
    for program in sys.argv[1:]:
        for benchmark, units, unit in MEASURED[Path(program).name]:
            time = nanoseconds(program, benchmark)
            total = instructions(program, benchmark)
            print(f"{benchmark:<24} {total:>14,} {total / units:>12,.1f} {time / units:>10,.1f}  {unit}")


if __name__ == "__main__":
    main()
