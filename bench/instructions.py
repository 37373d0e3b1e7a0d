"""Counts the instructions of one iteration of benchmarks under callgrind: instructions.py PROGRAM..."""

import re
import subprocess
import sys
import tempfile
from pathlib import Path

# By program: the benchmarks to count, and how many of which unit one iteration handles.
MEASURED = {
    "enumerate_fc_ports": [(f"enumerate_fc_ports/{adapters}", 2 * adapters, "port") for adapters in [1, 4, 16, 64]],
    "log_call": [("suppressed_log_call", 100_000, "call")],
}


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
    print(f"\n{'benchmark':<24} {'instructions':>14} {'per unit':>12}")
    for program in sys.argv[1:]:
        for benchmark, units, unit in MEASURED[Path(program).name]:
            total = instructions(program, benchmark)
            print(f"{benchmark:<24} {total:>14,} {total / units:>12,.1f}/{unit}")


if __name__ == "__main__":
    main()
