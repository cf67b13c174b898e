"""Emits the C# side of the flat layer: the declarations of its exports, and the classes that stand over them. What no
rule gives is written by hand in bindings/csharp."""

from __future__ import annotations

import re
from pathlib import Path

from cpp_names import NOTICE
from csharp_names import doc_comment, pascal, wrapped
from emit_csharp_classes import model_class
from emit_csharp_native import declarations
from emit_csharp_values import functions_class, value_class
from flat_model import Export
from typed_model import Vocabulary

CODES = Path(__file__).parents[2] / "errors" / "elmx_error.h"
"""The one list of codes: row(1, err_unable_to_open_file, "Unable to open file")."""


def csharp_sources(vocabulary: Vocabulary, exports: list[Export]) -> dict[str, str]:
    """The text of each file by its name."""
    files = {"csharp/Native.cs": _file(["System", "System.Runtime.InteropServices"], [declarations(exports)])}
    owners: dict[str, list[Export]] = {}
    for export in exports:
        if export.owner:
            owners.setdefault(export.owner.removeprefix("hqf_v2::"), []).append(export)
    for part in dict.fromkeys(cls.part for cls in vocabulary.classes.values()):
        files[f"csharp/classes_{part}.cs"] = _file(
            ["System", "System.Collections.Generic", "System.Runtime.InteropServices"],
            [model_class(vocabulary, cls, owners[cls.name]) for cls in vocabulary.classes.values() if cls.part == part])
    values = [value_class(name, mine) for name, mine in owners.items() if name not in vocabulary.classes]
    functions = functions_class([export for export in exports if export.family == "runtime" and not export.owner])
    files["csharp/values.cs"] = _file(["System", "System.Runtime.InteropServices"], [_codes(), functions, *values])
    return files


def _file(usings: list[str], types: list[str]) -> str:
    head = "".join(f"using {name};\n" for name in usings)
    lines = [line for text in types for line in [*text.splitlines(), ""]][:-1]
    indented = "".join(wrapped("    " + line) if line.strip() else "\n" for line in lines)
    return f"{NOTICE}\n{head}\nnamespace HqfV2\n{{\n{indented}}}\n"


def _codes() -> str:
    rows = re.findall(r'row\((\d+), err_(\w+),\s*(?:\\\s*)?"(.*?)"\)', CODES.read_text(encoding="utf-8"))
    lines = [doc_comment("What an operation gives: NoError, or the rule that was broken.").rstrip(),
             "public enum ErrorCode", "{"]
    for number, name, sentence in rows:
        lines.append(_indented(doc_comment(sentence + ".")) + f"    {pascal(name)} = {number},")
    return "\n".join([*lines, "}", ""])


def _indented(text: str) -> str:
    return "".join(f"    {line}\n" for line in text.splitlines())
