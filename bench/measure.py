"""Starts the benchmark programs and reads what they print; shared by table.py and compare.py."""

from __future__ import annotations

import json
import os
import statistics
import subprocess
import sys
from dataclasses import dataclass
from pathlib import Path


@dataclass
class Row:
    """One row of the benchmark program, over its repetitions."""

    task: str
    kind: str
    size: str
    peer: str
    checks: str
    document_bytes: int
    speeds: list[float]

    @property
    def speed(self) -> float:
        """Median, million bytes a second."""
        return statistics.median(self.speeds)

    @property
    def spread(self) -> float:
        """From the slowest to the fastest repetition, as a part of the median."""
        return (max(self.speeds) - min(self.speeds)) / self.speed

    @staticmethod
    def medians(raw: dict) -> dict[str, Row]:
        """The rows by "task/kind/size/peer". A row that failed ends the program: it must not go unseen."""
        rows: dict[str, Row] = {}
        for run in raw["benchmarks"]:
            if run.get("error_occurred"):
                sys.exit(f"{run['name']}: {run['error_message']}")
            if run["run_type"] != "iteration" or "document_bytes" not in run:
                continue  # single calls have no document
            task, kind, size, peer = run["run_name"].split("/")[:4]
            row = rows.setdefault(f"{task}/{kind}/{size}/{peer}",
                                  Row(task, kind, size, peer, run["label"], int(run["document_bytes"]), []))
            row.speeds.append(run["bytes_per_second"] / 1e6)
        return rows


def usual_build_folder() -> Path:
    """Where the preset "bench" builds."""
    return Path(__file__).resolve().parent.parent / "build/bench"


def run_program(command: list[str], cpu: int | None) -> str:
    """Standard output of a program that must succeed, kept on one CPU if told."""
    settle = (lambda: os.sched_setaffinity(0, {cpu})) if cpu is not None else None
    try:
        return subprocess.run(command, check=True, stdout=subprocess.PIPE, text=True, preexec_fn=settle).stdout
    except FileNotFoundError:
        sys.exit(f"{command[0]} is not built: cmake --preset bench && cmake --build --preset bench")
    except subprocess.CalledProcessError as error:
        sys.exit(f"{command[0]} ended with {error.returncode}")


def run_benchmarks(build: Path, sizes: str, repetitions: int, seconds: float, cpu: int | None,
                   only: str | None = None) -> dict:
    """The JSON of Google Benchmark. `only` is a regular expression over names of rows."""
    command = [str(build / "bench/hqf_bench"), f"--sizes={sizes}", "--benchmark_format=json",
               f"--benchmark_repetitions={repetitions}", f"--benchmark_min_time={seconds}",
               "--benchmark_enable_random_interleaving=true"]
    if only:
        command.append(f"--benchmark_filter={only}")
    return json.loads(run_program(command, cpu))
