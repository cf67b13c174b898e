"""Turns the schema into C++: run by the build, which compiles what it writes.

usage: generate.py SCHEMA OUTPUT_DIRECTORY     writes the files whose content changed
       generate.py --list SCHEMA               prints the names of all files, relative to the output directory
"""

from __future__ import annotations

import sys
from pathlib import Path

from cpp_names import NOTICE
from emit_classes import class_bodies
from emit_csharp import csharp_sources
from emit_flat import flat_sources
from emit_flat_header import flat_header
from emit_flat_tests import name_list, null_arguments
from emit_headers import class_header
from emit_reference import reference_page
from emit_tables import tables_header, tables_source
from flat_exports import flat_exports
from vocabulary import Vocabulary, load
from xsd import SchemaError


def generate(vocabulary: Vocabulary) -> dict[str, str]:
    """The text of each file by its name."""
    files = {f"hqf/model/{cls.name}.h": class_header(vocabulary, cls) for cls in vocabulary.classes.values()}
    includes = "\n".join(f'#include "hqf/model/{name}.h"' for name in sorted(vocabulary.classes))
    files["hqf/model/classes.h"] = f"{NOTICE}/// All model classes.\n#pragma once\n\n{includes}\n"
    files["hqf/model/tables.h"] = tables_header(vocabulary)
    files["hqf/model/tables.cpp"] = tables_source(vocabulary)
    files["docs/vocabulary.md"] = reference_page(vocabulary)
    for part in dict.fromkeys(cls.part for cls in vocabulary.classes.values()):
        files[f"hqf/model/classes_{part}.cpp"] = class_bodies(vocabulary, part)
    exports = flat_exports(vocabulary)
    files |= flat_sources(exports)
    files["hqf/flat/hqf_flat.h"] = flat_header(vocabulary, exports)
    files["tests/flat/exports.txt"] = name_list(exports)
    files["tests/flat/null_arguments.inc"] = null_arguments(exports)
    files |= csharp_sources(vocabulary, exports)
    return files


def main(arguments: list[str]) -> int:
    try:
        if len(arguments) == 2 and arguments[0] == "--list":
            print("\n".join(generate(load(arguments[1]))))
            return 0
        if len(arguments) != 2:
            print(__doc__, file=sys.stderr)
            return 2
        for name, text in generate(load(arguments[0])).items():
            path = Path(arguments[1]) / name
            path.parent.mkdir(parents=True, exist_ok=True)
            if not path.exists() or path.read_text(encoding="utf-8") != text:
                path.write_text(text, encoding="utf-8")
        return 0
    except SchemaError as error:
        print(error, file=sys.stderr)
        return 1


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
