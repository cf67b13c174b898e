"""Does the library export exactly what the generator lists, and does the list hold what callers bind to?

usage: symbols_test.py NM LIBRARY EXPORTS

The numbers below and the names in tests/data/flat/exports.txt are written by hand on purpose: the list of the generator
can't prove itself.
"""

import pathlib
import subprocess
import sys
from collections import Counter

NAMES = pathlib.Path(__file__).resolve().parents[1] / "data" / "flat" / "exports.txt"

# Families of the model, by their counts: 205 classes; 5 roots, 63 type and 68 element classes in hierarchies; 4 groups
# and 7 choices; 68 elements with entry points.
COUNTS = {
    "_swap": 205 + 3, "_reset": 205, "_is_occurs_ok": 205, "_clone": 5 + 63 + 68, "_getid": 136, "_has_id": 136,
    "_id_get": 68, "_id_set": 68, "_factory": 5 + 2, "_getchosen": 4 + 7, "_marshal__SWIG_0": 68,
    "_unmarshal__SWIG_0": 68, "_unmarshal__SWIG_1": 68, "Upcast": 63 + 68 + 2,
}

DELETES = 205 + 1 + 17  # model, the result of a writing, runtime values

FAMILIES = {"registration": 3, "platform": 5, "own": 5}


def main(nm: str, library: str, exports: str) -> int:
    faults = []
    with open(exports, encoding="utf-8") as lines:
        rows = [line.split() for line in lines]
    listed = {name for _, name in rows}
    output = subprocess.run([nm, "-D", "--defined-only", library], check=True, capture_output=True, text=True).stdout
    # C++ names are mangled; of the plain ones a sanitizer brings some of its own.
    exported = {line.split()[-1] for line in output.splitlines()}
    ours = {name for name in exported if name.startswith(("CSharp_", "SWIG", "Sys", "hqf_"))}
    faults += [f"listed, but not exported: {name}" for name in sorted(listed - exported)]
    faults += [f"exported, but not listed: {name}" for name in sorted(ours - listed)]
    there, absent = (part.split() for part in NAMES.read_text(encoding="utf-8").split("[there]")[1].split("[absent]"))
    faults += [f"missing: {name}" for name in there if name not in listed]
    faults += [f"too many: {name}" for name in absent if name in listed]
    counts = {end: sum(name.endswith(end) for name in listed) for end in COUNTS}
    faults += [f"{end}: {counts[end]} exports, not {count}" for end, count in COUNTS.items() if counts[end] != count]
    deletes = sum(name.startswith("CSharp_delete_") for name in listed)
    faults += [f"{deletes} destructors, not {DELETES}"] * (deletes != DELETES)
    families = Counter(family for family, _ in rows)
    faults += [f"{name}: {families[name]}" for name, count in FAMILIES.items() if families[name] != count]
    faults += [f"another prefix than our own: {name}" for family, name in rows
               if (family == "own") != name.startswith("hqf_")]
    print("\n".join(faults) or f"{len(listed)} exports")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main(*sys.argv[1:]))
