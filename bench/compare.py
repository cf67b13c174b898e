#!/usr/bin/env python3
"""Compares the speed of the working tree with that of a commit, on this machine, by turns.

usage: bench/compare.py COMMIT [--sizes 1,50] [--rounds 7] [--only REGEX] [--cpu N] [--compiler clang++]

Both are built in a temporary folder, the commit from a git worktree, both with the working tree's bench/ (the same
documents and rows; the interface that they use must exist in both). Then the two programs run by turns, and each round
gives one ratio a row: working tree divided by commit, above 1 is faster. Printed are the median of the ratios and the
smallest and largest. Rows of the peers, whose code is the same on both sides, show what the machine's noise makes of a
ratio that is 1: believe no gain that is smaller.
"""

from __future__ import annotations

import argparse
import shutil
import statistics
import subprocess
import sys
import tempfile
from pathlib import Path

from measure import Row, run_benchmarks

ROOT = Path(__file__).resolve().parent.parent
USUAL_ROWS = "^(load|write)/.*/(hqf|expat|pugixml)$"


def build(source: Path, folder: Path, compiler: str | None, jobs: int) -> None:
    configure = ["cmake", "-S", str(source), "-B", str(folder), "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Release",
                 "-DBUILD_TESTING=OFF", "-DHQF_BUILD_BENCH=ON"]
    if compiler:
        configure.append(f"-DCMAKE_CXX_COMPILER={compiler}")
    for command in (configure, ["cmake", "--build", str(folder), "--target", "hqf_bench", "-j", str(jobs)]):
        print("+", " ".join(command), file=sys.stderr)
        subprocess.run(command, check=True, stdout=subprocess.DEVNULL)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("commit")
    parser.add_argument("--sizes", default="1,50", help="million bytes, separated by commas (default: %(default)s)")
    parser.add_argument("--rounds", type=int, default=7)
    parser.add_argument("--only", default=USUAL_ROWS, help="rows by regular expression (default: %(default)s)")
    parser.add_argument("--seconds", type=float, default=0.3, help="a row and round (default: %(default)s)")
    parser.add_argument("--cpu", type=int, help="keep the programs on this CPU")
    parser.add_argument("--compiler", help="C++ compiler of both builds")
    parser.add_argument("--jobs", type=int, default=2)
    options = parser.parse_args()

    with tempfile.TemporaryDirectory(prefix="hqf-compare-") as scratch:
        base = Path(scratch) / "commit"
        builds = {"tree": Path(scratch) / "build-tree", "commit": Path(scratch) / "build-commit"}
        subprocess.run(["git", "-C", str(ROOT), "worktree", "add", "--detach", str(base), options.commit], check=True,
                       stdout=subprocess.DEVNULL)
        try:
            shutil.rmtree(base / "bench", ignore_errors=True)
            shutil.copytree(ROOT / "bench", base / "bench")
            build(ROOT, builds["tree"], options.compiler, options.jobs)
            build(base, builds["commit"], options.compiler, options.jobs)
            compare(builds, options)
        finally:
            subprocess.run(["git", "-C", str(ROOT), "worktree", "remove", "--force", str(base)], check=True)
    return 0


def compare(builds: dict[str, Path], options: argparse.Namespace) -> None:
    ratios: dict[str, list[float]] = {}
    speeds: dict[str, dict[str, list[float]]] = {"tree": {}, "commit": {}}
    for turn in range(options.rounds):
        rows: dict[str, dict[str, Row]] = {}
        # Who goes first changes from round to round, so that a machine that warms up favours neither.
        for side in (("tree", "commit"), ("commit", "tree"))[turn % 2]:
            rows[side] = Row.medians(run_benchmarks(builds[side], options.sizes, 1, options.seconds, options.cpu,
                                                    options.only))
        for name in rows["tree"].keys() & rows["commit"].keys():
            tree, commit = rows["tree"][name], rows["commit"][name]
            if tree.document_bytes != commit.document_bytes:
                sys.exit(f"{name}: the two sides write different documents")
            ratios.setdefault(name, []).append(tree.speed / commit.speed)
            speeds["tree"].setdefault(name, []).append(tree.speed)
            speeds["commit"].setdefault(name, []).append(commit.speed)
        print(f"round {turn + 1} of {options.rounds}", file=sys.stderr)

    width = max(map(len, ratios))
    print(f"{'row':{width}}  commit MB/s  tree MB/s   ratio  smallest  largest")
    for name in sorted(ratios):
        values = ratios[name]
        print(f"{name:{width}}  {statistics.median(speeds['commit'][name]):11.0f}  "
              f"{statistics.median(speeds['tree'][name]):9.0f}  {statistics.median(values):6.3f}  "
              f"{min(values):8.3f}  {max(values):7.3f}")


if __name__ == "__main__":
    sys.exit(main())
