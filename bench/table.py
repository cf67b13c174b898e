#!/usr/bin/env python3
"""Runs the benchmarks and prints their tables: speed of loading and writing beside the peers, and the heap of a load.

usage: bench/table.py [--build FOLDER] [--sizes 1,50] [--repetitions 5] [--cpu N] [--quick] [--archive] [--first]

Speeds are medians, in million bytes of document a second of CPU time. The repetitions of all rows are interleaved, so
that a slow minute of the machine falls on every peer alike. A ratio is this library's speed divided by the peer's; the
floor is the ratio that the project aims at, and "below" marks what misses it. With --archive: archives alone, each row
in a process of its own, since what another row leaves in the heap costs a load up to a tenth. With --first: the first
load of a process alone, 30 MB unless --sizes says otherwise.
"""

from __future__ import annotations

import argparse
import json
import statistics
import sys
import tempfile
from pathlib import Path

from measure import Row, run_benchmarks, run_program, usual_build_folder

ORDINARY = ("palettes", "spectra", "quality_control")
KINDS = (*ORDINARY, "mix")
LOAD_FLOORS = {**dict.fromkeys(ORDINARY, 6.0), "mix": 3.5}
WRITE_FLOORS = {"palettes": 2.5, "spectra": 2.0, "quality_control": 2.5, "mix": 1.5}
FIRST_LOAD_FLOOR = 2.0
HEAP_LIMIT = 2.0
# An archive may cost this many times what its parts do: zlib with the CRC-32, and the plain operation.
ARCHIVE_LIMIT = 1.15
ARCHIVE_PARTS = {"archive_load": ("zlib", "memory"), "archive_save": ("zlib", "plain_file")}

# task, the peer that the floor is about, floors, all peers in the order of the columns
COMPARISONS = (
    ("load", "expat", LOAD_FLOORS, ("hqf", "expat", "pugixml")),
    ("write", "pugixml", WRITE_FLOORS, ("hqf", "pugixml", "pugixml_raw")),
)
# What else is done with a document: the row, the row that it is set beside, and how many times as long it may take; 0
# where the row only explains another.
OTHER_ROWS = (("load/hqf_file", "load/hqf", 1.2), ("load/hqf_string", "load/hqf", 1.4),
              ("write/hqf_file", "write/hqf", 1.4), ("write/hqf_old_file", "write/hqf", 0),
              ("write/hqf_string", "write/hqf", 1.4), ("write/wide_memory", "write/hqf", 0),
              ("objects/destroy", "load/hqf", 1.0), ("objects/copy", "load/hqf", 1.0),
              ("objects/equal", "load/hqf", 1.0))


def markdown(head: list[str], lines: list[list[str]]) -> str:
    widths = [max(len(line[i]) for line in [head, *lines]) for i in range(len(head))]
    def line_text(cells: list[str]) -> str:
        return "| " + " | ".join(cell.ljust(width) for cell, width in zip(cells, widths)) + " |"
    rule = "|" + "|".join("-" * (width + 2) for width in widths) + "|"
    return "\n".join([line_text(head), rule, *map(line_text, lines)])


def floor_text(ratio: float | None, floor: float) -> str:
    if ratio is None:
        return f"{floor}"
    return f"{floor}" + (" below" if ratio < floor else "")


def comparison(rows: dict[str, Row], documents: list[tuple[str, str]], task: str, rival: str,
               floors: dict[str, float], peers: tuple[str, ...]) -> str:
    head = ["kind", "size", *(f"{peer} MB/s" for peer in peers), *(f"hqf/{peer}" for peer in peers[1:]), "floor"]
    lines = []
    for kind, size in documents:
        speeds = [rows[name].speed if (name := f"{task}/{kind}/{size}/{peer}") in rows else None for peer in peers]
        if speeds[0] is None:
            continue
        ratios = {peer: speeds[0] / speed if speed else None for peer, speed in zip(peers, speeds)}
        lines.append([kind, size, *(f"{speed:.0f}" if speed else "-" for speed in speeds),
                      *(f"{ratios[peer]:.2f}" if ratios[peer] else "-" for peer in peers[1:]),
                      f"{rival}: " + floor_text(ratios[rival], floors[kind])])
    checks = [[peer, next((row.checks for row in rows.values() if row.task == task and row.peer == peer), "not built")]
              for peer in peers]
    return markdown(head, lines) + "\n\n" + markdown([f"{task}: peer", "what it checks"], checks)


def other_speeds(rows: dict[str, Row], documents: list[tuple[str, str]]) -> str:
    lines = []
    for kind, size in documents:
        cells = []
        for name, base, limit in OTHER_ROWS:
            row, beside = (rows.get(f"{task}/{kind}/{size}/{peer}")
                           for task, peer in (name.split("/"), base.split("/")))
            times = beside.speed / row.speed if row and beside else None
            cells.append("-" if times is None else f"{times:.2f}" + (" above" if 0 < limit < times else ""))
        lines.append([kind, size, *cells])
    return markdown(["kind", "size", *(f"{name} / {base}" + (f" ({limit})" if limit else "")
                                       for name, base, limit in OTHER_ROWS)], lines)


def heap_table(build: Path, sizes: str, cpu: int | None) -> str:
    lines = []
    for line in run_program([str(build / "bench/hqf_bench_memory"), f"--sizes={sizes}"], cpu).splitlines():
        kind, size, peer, given, *counted = line.split("\t")
        peak, loaded, by_allocator, left = (int(number) / int(given) for number in counted)
        # An archive's text is made by the load: it counts once beside the model.
        highest = {"hqf": HEAP_LIMIT, "hqf_archive": HEAP_LIMIT + 1}.get(peer)
        limit = f"{highest:.0f}" + (" above" if peak > highest else "") if highest else "-"
        lines.append([kind, size + "MB", peer, f"{peak:.2f}", f"{loaded:.2f}", f"{by_allocator:.2f}", f"{left:.4f}",
                      limit])
    return markdown(["kind", "size", "peer", "peak", "loaded", "loaded, by mallinfo2", "left behind", "limit"], lines)


def first_loads(build: Path, sizes: str, repetitions: int, cpu: int | None) -> str:
    lines = []
    with tempfile.TemporaryDirectory(prefix="hqf-first-") as folder:
        run_program([str(build / "bench/hqf_bench"), f"--sizes={sizes}", f"--dump={folder}"], cpu)
        for size in sizes.split(","):
            for kind in KINDS:
                took: dict[str, list[float]] = {"hqf": [], "expat": []}
                for _ in range(repetitions):
                    for peer, times in took.items():
                        command = [str(build / "bench/hqf_bench_first"), peer, f"{folder}/{kind}-{size}.hqf"]
                        times.append(float(run_program(command, cpu)))
                medians = {peer: statistics.median(times) for peer, times in took.items()}
                ratio = medians["expat"] / medians["hqf"]
                lines.append([kind, size + "MB", *(f"{median * 1e3:.0f}" for median in medians.values()),
                              f"{ratio:.2f}", floor_text(ratio, FIRST_LOAD_FLOOR)])
    return "## First load of a process\n\n" + markdown(["kind", "size", "hqf ms", "expat ms", "expat/hqf", "floor"],
                                                      lines)


def archive_tables(build: Path, sizes: str, repetitions: int, seconds: float, cpu: int | None) -> str:
    tables = []
    for task, parts in ARCHIVE_PARTS.items():
        peers = list(dict.fromkeys(("hqf", *parts, "plain_file")))
        lines = []
        for size in (f"{number}MB" for number in sizes.split(",")):
            for kind in ("palettes", "spectra"):
                names = {peer: f"{task}/{kind}/{size}/{peer}" for peer in peers}
                took = {}
                for peer, name in names.items():
                    row = Row.medians(run_benchmarks(build, size.removesuffix("MB"), repetitions, seconds, cpu,
                                                     f"^{name}$"))[name]
                    took[peer] = row.document_bytes / row.speed / 1e3
                ratio = took["hqf"] / sum(took[part] for part in parts)
                lines.append([kind, size, *(f"{took[peer]:.1f}" for peer in peers), f"{ratio:.3f}",
                              f"{ARCHIVE_LIMIT}" + (" above" if ratio > ARCHIVE_LIMIT else "")])
        head = ["kind", "size", *(f"{peer} ms" for peer in peers), f"hqf / ({' + '.join(parts)})", "limit"]
        tables.append(f"## {task.removeprefix('archive_').capitalize()} of archives\n\n{markdown(head, lines)}\n")
    return "\n".join(tables)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--build", type=Path, default=usual_build_folder(), help="build folder (default: %(default)s)")
    parser.add_argument("--sizes", help="million bytes, separated by commas (default: 1,50)")
    parser.add_argument("--repetitions", type=int, default=5)
    parser.add_argument("--cpu", type=int, help="keep the programs on this CPU")
    parser.add_argument("--quick", action="store_true", help="1 MB alone and short runs: a look, not a result")
    parser.add_argument("--archive", action="store_true", help="loading and saving of archives alone")
    parser.add_argument("--first", action="store_true", help="the first load of a process alone")
    parser.add_argument("--json", type=Path, help="also save the raw results here")
    options = parser.parse_args()
    if options.quick:
        options.sizes, options.repetitions = "1", 3

    if options.first:
        print(first_loads(options.build, options.sizes or "30", options.repetitions, options.cpu))
        return 0
    options.sizes = options.sizes or "1,50"
    seconds = 0.05 if options.quick else 0.3
    if options.archive:
        print(archive_tables(options.build, options.sizes, options.repetitions, seconds, options.cpu))
        return 0

    raw = run_benchmarks(options.build, options.sizes, options.repetitions, seconds, options.cpu, "-^archive_")
    if options.json:
        options.json.write_text(json.dumps(raw, indent=1), encoding="utf-8")
    rows = Row.medians(raw)
    documents = sorted({(row.kind, row.size) for row in rows.values()},
                       key=lambda document: (int(document[1].removesuffix("MB")), KINDS.index(document[0])))
    context = raw["context"]
    print(f"{context['num_cpus']} CPUs of {context['mhz_per_cpu']} MHz, load {context['load_avg']}, "
          f"median of {options.repetitions}\n")
    for task, rival, floors, peers in COMPARISONS:
        print(f"## {task.capitalize()}\n\n{comparison(rows, documents, task, rival, floors, peers)}\n")
    print(f"## Other rows\n\n{other_speeds(rows, documents)}\n")
    print(f"## Heap of a load, bytes per byte of input\n\n{heap_table(options.build, options.sizes, options.cpu)}")
    spread = [row.spread for row in rows.values() if row.task in ("load", "write")]
    print(f"\nSpread of a row's repetitions: median {statistics.median(spread):.1%}, worst {max(spread):.1%}")
    return 0


if __name__ == "__main__":
    sys.exit(main())
