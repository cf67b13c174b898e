#!/usr/bin/env python3
"""Shows whether a colour costs the same in a large document as in a small one: palettes of 1 to 500 MB.

usage: bench/growth.py [--build FOLDER] [--sizes 1,10,100,500] [--seconds 10] [--cpu N]

Per size a process of its own: the median CPU time of a load and the destruction, over as many as fit into the seconds,
and the peak heap of a load. In brackets, each beside the smallest size. 500 MB take 3 GB of memory while the document
is made, and some minutes.
"""

from __future__ import annotations

import argparse
from pathlib import Path

from measure import run_program, usual_build_folder
from table import markdown


def main() -> None:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--build", type=Path, default=usual_build_folder())
    parser.add_argument("--sizes", default="1,10,100,500", help="million bytes")
    parser.add_argument("--seconds", type=float, default=10)
    parser.add_argument("--cpu", type=int)
    options = parser.parse_args()

    lines = []
    first: tuple[float, float] | None = None
    for size in options.sizes.split(","):
        command = [str(options.build / "bench/hqf_bench_growth"), size, str(options.seconds)]
        _, colours, seconds, peak = (float(field) for field in run_program(command, options.cpu).split("\t"))
        cost = (seconds / colours * 1e6, peak / colours)
        first = first or cost
        lines.append([size, f"{colours:.0f}", f"{cost[0]:.3f} ({cost[0] / first[0]:.2f})",
                      f"{cost[1]:.0f} ({cost[1] / first[1]:.2f})"])
    print(markdown(["MB", "colours", "µs a colour", "bytes of heap a colour"], lines))


if __name__ == "__main__":
    main()
