"""Times benchmarks, and counts the instructions of one iteration under callgrind: instructions.py PROGRAM..."""

import argparse
import json
import re
import subprocess
import sys
import tempfile
from pathlib import Path

# By program: the benchmarks to measure, and how many of which unit one iteration handles.
MEASURED = {
    "inventory": [("enumerate/ZEMLAR_FCPort/16", 32, "port")],
    "scan": [(f"scan/{iocs}", 2 * iocs, "IOC") for iocs in [1, 16, 128]],
    "runtime_instances": [
        ("life_of_a_port", 1_000, "port"),
        ("key_eq_of_two_ports", 1_000, "call"),
        ("find_a_class_by_name", 1_000, "call"),
        ("filter_ten_properties", 1_000, "call"),
    ],
    "conversion": [("convert_fc_port", 100, "port"), ("bare_broker_calls", 100, "port")],
    "scsi": [(f"{name}/10000", 10_000, "LUN") for name in ["report_luns", "inquire_luns"]],
    "joins": [
        (f"{work}/ZEMLAR_{name}", 12_800, "unit")
        for name in ["StorageResourcesSystemDevice", "SCSIInitiatorTargetLogicalUnitPath"]
        for work in ["join", "sides"]
    ],
    "log_call": [("suppressed_log_call", 100_000, "call")],
}

# Where the instructions of one enumeration go: benchmark, units, and the functions whose whole cost is counted. What the
# callback does belongs to the conversion and the rest, not to the provider that calls it.
SHARES = {"inventory": ("enumerate/ZEMLAR_FCPort/16", 32, "port")}
CONVERSION = ["zmlr::make_cmpi_object("]
PROVIDER = "zmlr::Enumerating_Provider<zmlr::ZEMLAR_FCPort_Provider_Skeleton>::enum_instances("
CALLBACK = "bool zmlr::answer_with<"
DRIVER = ":ioctl ["

NANOSECONDS = {"ns": 1, "us": 1_000, "ms": 1_000_000}


def nanoseconds(program, benchmark):
    """The time of one iteration, without callgrind."""
    run = subprocess.run(
        [program, f"--benchmark_filter=^{benchmark}$", "--benchmark_format=json"], check=True, capture_output=True
    )
    row = json.loads(run.stdout)["benchmarks"][0]
    return row["real_time"] * NANOSECONDS[row["time_unit"]]


def callgrind(program, benchmark, output):
    """Counts what happens inside the benchmark's loop, which runs once."""
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
    dumped = Path(f"{output}.1")  # by a program that dumps each benchmark
    if dumped.exists():
        dumped.replace(output)
    return int(re.search(r"^(?:totals|summary): (\d+)", output.read_text(), re.MULTILINE)[1])


def instructions(program, benchmark):
    with tempfile.TemporaryDirectory() as folder:
        return callgrind(program, benchmark, Path(folder) / "callgrind.out")


def shares(program, benchmark):
    """Instructions of one iteration in the conversion (broker calls included), in the provider, in the simulated driver and in the
    rest, which is the server's. The first two are what the module spends."""
    with tempfile.TemporaryDirectory() as folder:
        output = Path(folder) / "callgrind.out"
        total = callgrind(program, benchmark, output)
        command = ["callgrind_annotate", "--inclusive=yes", "--threshold=100", output]
        table = subprocess.run(command, check=True, capture_output=True, text=True).stdout

    def cost(function):
        counts = re.findall(rf"^ *([\d,]+) .*{re.escape(function)}", table, re.MULTILINE)
        if not counts:
            sys.exit(f"{benchmark}: no call of {function}")
        return max(int(count.replace(",", "")) for count in counts)

    conversion = sum(cost(function) for function in CONVERSION)
    driver = cost(DRIVER)
    provider = cost(PROVIDER) - cost(CALLBACK) - driver
    rest = total - conversion - provider - driver
    return {"conversion": conversion, "provider": provider, "module": conversion + provider, "driver": driver, "rest": rest}


def main():
    parser = argparse.ArgumentParser(description="Times benchmarks, and counts their instructions under callgrind.")
    parser.add_argument("programs", metavar="PROGRAM", nargs="+", help="a built benchmark")
    programs = parser.parse_args().programs
    print(f"\n{'benchmark':<48} {'instructions':>14} {'per unit':>12} {'ns':>10}  unit")
    for program in programs:
        for benchmark, units, unit in MEASURED[Path(program).name]:
            time = nanoseconds(program, benchmark)
            total = instructions(program, benchmark)
            print(f"{benchmark:<48} {total:>14,} {total / units:>12,.1f} {time / units:>10,.1f}  {unit}")
    for program in programs:
        if Path(program).name in SHARES:
            benchmark, units, unit = SHARES[Path(program).name]
            for share, count in shares(program, benchmark).items():
                print(f"{benchmark + ': ' + share:<36} {count / units:>12,.1f} instructions/{unit}")


if __name__ == "__main__":
    main()
