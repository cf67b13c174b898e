"""Emits what the tests of the flat layer take from the list of exports: its names, and a call with a null pointer for
each place that refuses one. What such a call must do is the tests' to say."""

from __future__ import annotations

from cpp_names import NOTICE
from flat_model import Argument, Export

PLACEHOLDERS = {"narrow": '"x"', "narrow_or_null": '"x"'}


def name_list(exports: list[Export]) -> str:
    return "".join(f"{export.family} {export.name}\n" for export in exports)


def null_arguments(exports: list[Export]) -> str:
    """Rows of {export, class or null for text, whether it is only read, call}; a call tells whether it gave the
    default."""
    rows = [_row(export, place) for export in exports if export.part for place in range(len(export.arguments))
            if export.arguments[place].kind in ("narrow", "reference", "const_reference")]
    return NOTICE + "".join(f"{row},\n" for row in rows)


def _row(export: Export, place: int) -> str:
    argument = export.arguments[place]
    values = ", ".join("nullptr" if at == place else _value(each) for at, each in enumerate(export.arguments))
    call = f"{export.name}({values})"
    cls = "nullptr" if argument.kind == "narrow" else f'"{argument.cls}"'
    given = f"return {call}, true;" if export.result.kind == "nothing" else f"return !{call};"
    is_const = "true" if argument.kind == "const_reference" else "false"
    return f'{{"{export.name}", {cls}, {is_const}, [] {{ {given} }}}}'


def _value(argument: Argument) -> str:
    if argument.kind in ("self", "object", "wide", "flag", "bytes", "buffer"):
        return "nullptr"
    return PLACEHOLDERS.get(argument.kind, "0")
