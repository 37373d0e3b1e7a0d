"""Counts the instructions of one enumeration under callgrind, per host size: instructions.py PROGRAM."""

import re
import subprocess
import sys
import tempfile
from pathlib import Path

ADAPTERS = [1, 4, 16, 64]
PORTS_PER_ADAPTER = 2


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
    program = sys.argv[1]
    print(f"\n{'adapters':>8} {'ports':>6} {'instructions':>14} {'per port':>10}")
    for adapters in ADAPTERS:
        ports = adapters * PORTS_PER_ADAPTER
        total = instructions(program, f"enumerate_fc_ports/{adapters}")
        print(f"{adapters:>8} {ports:>6} {total:>14,} {total // ports:>10,}")


if __name__ == "__main__":
    main()
