"""Runs `inventory` (bench/inventory.cpp), then once more under callgrind, and prints its figures as tables."""

import argparse
import collections
import json
import math
import re
import statistics
import subprocess
import tempfile
from pathlib import Path

ADAPTERS = [1, 4, 16, 64]
LUNS = [10, 1_000, 10_000]


def measured(program, selection):
    """By benchmark: its counters, and the microseconds of one iteration."""
    command = [program, selection, "--benchmark_min_time=0.05", "--benchmark_format=json"]
    run = subprocess.run(command, check=True, stdout=subprocess.PIPE)
    return {row["name"]: row for row in json.loads(run.stdout)["benchmarks"]}


def instructions(program, names, repetitions):
    """By benchmark: the mean instructions of one iteration, the simulated driver's left out."""
    if not names:
        return {}
    selection = [f"--benchmark_filter=^({'|'.join(names)})$", f"--benchmark_repetitions={repetitions}"]
    with tempfile.TemporaryDirectory() as folder:
        command = ["valgrind", "--tool=callgrind", "--collect-atstart=no", f"--callgrind-out-file={folder}/out", program]
        subprocess.run([*command, *selection, "--benchmark_min_time=0.000001"], check=True, capture_output=True)
        dumps = [path.read_text() for path in Path(folder).iterdir()]
    counts = collections.defaultdict(list)
    for dump in dumps:
        if name := re.search(r"^desc: Trigger: Client Request: (.+)$", dump, re.MULTILINE):
            counts[name[1]].append(int(re.search(r"^(?:totals|summary): (\d+)", dump, re.MULTILINE)[1]))
    return {name: statistics.fmean(values) for name, values in counts.items()}


def print_table(title, head, rows):
    print(f"\n{title}\n\n| {' | '.join(head)} |\n|---|{'---:|' * (len(head) - 1)}")
    for row in rows:
        print(f"| {' | '.join(f'{cell:,.0f}' if isinstance(cell, (int, float)) else cell for cell in row)} |")


def fold(values):
    """Equal figures once, others all: 2 or 2 / 5 / 17."""
    texts = [f"{value:,.4g}" for value in values]
    return texts[0] if len(set(texts)) == 1 else " / ".join(texts)


class Figures:
    def __init__(self, program, selection):
        self.rows = measured(program, selection)
        # From run to run the allocator finds more or less to put together: by as much as these are to stay within.
        of_classes = [name for name in self.rows if name.startswith(("enumerate/", "get/"))]
        others = [name for name in self.rows if name not in of_classes]
        self.counts = instructions(program, of_classes, 4) | instructions(program, others, 1)

    def names(self, kind):
        return sorted({name.rsplit("/", 1)[0] for name in self.rows if name.startswith(kind + "/")})

    def of(self, name, sizes, counter):
        return [self.rows[f"{name}/{size}"][counter] for size in sizes]

    def instructions(self, name, sizes):
        return [self.counts[f"{name}/{size}"] / self.rows[f"{name}/{size}"]["instances"] for size in sizes]

    def last(self, name, size):
        """Microseconds, peaks in bytes: each per instance."""
        row = self.rows[f"{name}/{size}"]
        return [row["real_time"] / row["instances"], row["module peak/instance"], row["peak/instance"]]


def increments(totals, sizes):
    """What one more costs, from each size to the next."""
    return [(after - before) / (more - less) for before, after, less, more in zip(totals, totals[1:], sizes, sizes[1:])]


def class_rows(figures, kind, requests):
    for name in figures.names(kind):
        counts = figures.instructions(name, ADAPTERS)
        instances = figures.of(name, ADAPTERS, "instances")
        totals = [count * number for count, number in zip(counts, instances)]
        sizes = instances if len(set(instances)) == len(ADAPTERS) else ADAPTERS
        spread = 100 * (max(counts[1:]) / min(counts[1:]) - 1)
        yield [
            f"`{name.split('_')[1]}`",
            fold(instances),
            fold(figures.of(name, ADAPTERS, requests)),
            *counts,
            f"{spread:.1f} %",
            " / ".join(f"{more:,.0f}" for more in increments(totals[1:], sizes[1:])),
            *figures.last(name, ADAPTERS[-1]),
        ]


def exponent(sizes, totals):
    """Of the size, by least squares: 1 where twice the size costs twice as much."""
    logs = [(math.log(size), math.log(total)) for size, total in zip(sizes, totals)]
    mean_size, mean_total = (sum(values) / len(logs) for values in zip(*logs))
    slope = sum((size - mean_size) * (total - mean_total) for size, total in logs)
    return slope / sum((size - mean_size) ** 2 for size, _ in logs)


def traversal_rows(figures):
    for name in figures.names("associators"):
        totals = [figures.counts[f"{name}/{size}"] for size in ADAPTERS]
        found = figures.of(name, ADAPTERS, "instances")
        yield [f"`{name.split('_')[1]}`", fold(found), fold(figures.of(name, ADAPTERS, "requests")), *totals, f"{exponent(ADAPTERS, totals):.2f}"]


def lun_rows(figures):
    for name in ["enumerate_luns", "get_lun"]:
        for size, count in zip(LUNS, figures.instructions(name, LUNS)):
            row = figures.rows[f"{name}/{size}"]
            yield [f"`{name}/{size}`", row["instances"], row["requests"], count, *figures.last(name, size)]


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("program", metavar="PROGRAM", help="the built benchmark")
    parser.add_argument("filter", metavar="FILTER", nargs="?", default=".", help="an expression for the names of those to run")
    options = parser.parse_args()
    figures = Figures(options.program, f"--benchmark_filter={options.filter}")
    counts = [f"instructions at {adapters}" for adapters in ADAPTERS]
    ends = ["µs", "peak bytes", "with the server's answer"]
    head = ["class", "instances", "requests", *counts, "spread 4 to 64"]
    head_of_all = [*head, "one more instance, to 16 / to 64", *ends]
    print_table("All instances; each figure per instance", head_of_all, class_rows(figures, "enumerate", "requests/instance"))
    head_of_one = [*head, "one more adapter, to 16 / to 64", *ends]
    print_table("One instance by its path", head_of_one, class_rows(figures, "get", "requests"))
    head = ["of", "associators", "requests", *counts, "exponent"]
    print_table("Associators through all association classes", head, traversal_rows(figures))
    if "enumerate_luns/10" in figures.rows:
        head = ["units", "instances", "requests", "instructions per instance", *ends]
        print_table("Units of two equal targets", head, lun_rows(figures))


if __name__ == "__main__":
    main()
