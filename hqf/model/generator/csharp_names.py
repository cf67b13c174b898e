"""Names, types and conversions that the C# emitters share."""

from __future__ import annotations

import re
import textwrap
from xml.sax.saxutils import escape

from flat_model import Argument, Result, bare


def pascal(name: str) -> str:
    """GetAsString for get_as_string; what is written in capitals already stays."""
    return "".join(part[:1].upper() + part[1:] for part in name.split("_"))


def plural(name: str) -> str:
    if name.endswith("y"):
        return name[:-1] + "ies"
    return name if name.endswith("s") else name + "s"


def identifier(literal: str) -> str:
    name = re.sub(r"[^0-9A-Za-z]", "_", literal)
    return "_" + name if name[0].isdigit() else name


def doc_comment(text: str, tag: str = "summary") -> str:
    """The lines of a documentation comment."""
    text = f"<{tag}>{escape(' '.join(text.split()))}</{tag}>"
    lines = textwrap.wrap(text, 106, break_long_words=False, break_on_hyphens=False)
    return "".join(f"/// {line}\n" for line in lines)


def wrapped(line: str, limit: int = 120) -> str:
    """The line, broken where a statement can be; declarations of exports stay whole, one a line."""
    if len(line) <= limit or "extern" in line or line.lstrip().startswith("///"):
        return line + "\n"
    at = max(line.rfind(mark, 0, limit - len(mark)) + keep for mark, keep in ((" ? ", 0), (", ", 1), (" => ", 3),
                                                                          (" = new ", 2), (" : ", 0)))
    indent = len(line) - len(line.lstrip())
    if at <= indent:
        return line + "\n"
    return line[:at].rstrip() + "\n" + wrapped(" " * (indent + 4) + line[at:].lstrip(), limit)


TYPES = {"wide": "string", "narrow": "string", "narrow_or_null": "string", "raw_text": "string", "bool": "bool",
         "int": "int", "long": "int", "unsigned": "uint", "unsigned_long": "uint", "byte": "byte", "double": "double",
         "float": "float", "code": "ErrorCode", "bytes": "byte[]", "nothing": "void"}


def public_type(place: Argument | Result) -> str:
    return TYPES[place.kind] if place.kind in TYPES else bare(place.cls)


def passed(argument: Argument, name: str | None = None) -> str:
    """How a C# value is given to an export."""
    name = name or argument.name
    forms = {"self": "Self", "wide": "NativeText.ToWide({})", "narrow": "NativeText.ToNarrow({})",
             "narrow_or_null": "NativeText.ToNarrow({})", "code": "(int){}", "flag": "out {}",
             "object": "Ref({})", "reference": "Ref({})", "const_reference": "Ref({})"}
    return forms.get(argument.kind, "{}").format(name)


def received(result: Result, call: str, parent: str) -> str:
    """How a C# value is made from what an export gave; `parent` is the object that a part lies in."""
    if result.kind == "object":
        return f"new {bare(result.cls)}({call}, {'null' if result.owned else parent})"
    if result.kind in ("wide", "narrow"):
        return f"NativeText.From{pascal(result.kind)}({call})"
    casts = {"byte": "(byte)", "code": "(ErrorCode)"}
    if result.kind == "raw_text":
        return f"NativeText.FromRaw(Call.Done({call}))"
    return f"{casts.get(result.kind, '')}Call.Done({call})"
