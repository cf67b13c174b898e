"""Emits the flat exports in C++, a file for each topic: each names its operation and hands it to call() of
hqf/flat/conventions.h."""

from __future__ import annotations

from cpp_names import NOTICE
from flat_c_types import c_prototype, c_result
from flat_model import ALIASES, OBJECT_KINDS, Argument, Export, Result, null_message

INSIDE = {
    # kind: type that the operation's function takes, and how an operation gets its argument from it
    "self": ("void*", "of<{cls}>({name})"),
    "object": ("void*", "static_cast<{cls}*>({name})"),
    "reference": ("void*", "of<{cls}>({name})"),
    "const_reference": ("const void*", "of<{cls}>({name})"),
    "wide": ("const std::wstring&", "{name}"),
    "narrow": ("const std::string&", "{name}"),
    "narrow_or_null": ("nullable_text", "{name}.text"),
    "bool": ("bool", "{name}"),
    "int": ("int", "{name}"),
    "long": ("int", "long{{{name}}}"),
    "unsigned": ("unsigned int", "{name}"),
    "unsigned_long": ("unsigned int", "{name}"),
    "byte": ("unsigned int", "static_cast<unsigned char>({name})"),
    "double": ("double", "{name}"),
    "float": ("float", "{name}"),
    "enum": ("int", "static_cast<{cls}>({name})"),
    "code": ("int", "static_cast<lmx::elmx_error>({name})"),
    "bytes": ("const unsigned char*", "{name}"),
    "buffer": ("unsigned char*", "{name}"),
    "flag": ("bool*", "{name}"),
}

OUTSIDE = {
    # kind: result of the operation's function, and how it is made from the operation's
    "nothing": ("void", "{}"),
    "code": ("lmx::elmx_error", "{}"),
    "bool": ("bool", "{}"),
    "int": ("int", "{}"),
    "long": ("int", "static_cast<int>({})"),
    "unsigned": ("unsigned int", "{}"),
    "unsigned_long": ("unsigned int", "static_cast<unsigned int>({})"),
    "byte": ("unsigned int", "{}"),
    "double": ("double", "{}"),
    "float": ("float", "{}"),
    "enum": ("int", "{}"),
    "wide": ("const std::wstring&", "{}"),
    "narrow": ("const std::string&", "{}"),
    "raw_text": ("const char*", "{}"),
}

BY_VALUE = ("getXmlDocument", "get_as_string", "hqf::flat::any_namespace", "hqf::flat::any_name",
            "hqf::flat::any_value")
"""operations that give text by value"""

INCLUDES = {"values": ["hqf/flat/additions.h", "hqf/model/Hqf.h", "hqf/values/c_big_int.h", "hqf/values/c_decimal.h",
                       "hqf/values/c_duration.h", "hqf/values/c_datetime.h", "hqf/values/c_binary.h",
                       "hqf/values/c_pattern.h", "hqf/values/c_empty.h", "hqf/values/lexical.h",
                       "hqf/xml_in/c_any_info.h"]}


def flat_sources(exports: list[Export]) -> dict[str, str]:
    """The text of each file by its name."""
    files = {}
    for part in dict.fromkeys(export.part for export in exports if export.part):
        includes = INCLUDES.get(part, ["hqf/document/XMLDocumentResult.h", "hqf/model/classes.h"])
        includes = sorted([*includes, "hqf/flat/conventions.h", "hqf/flat/hqf_flat.h"])
        head = "".join(f'#include "{name}"\n' for name in includes)
        body = "\n".join(_definition(export) for export in exports if export.part == part)
        files[f"hqf/flat/exports_{part}.cpp"] = f"{NOTICE}{head}\nusing namespace hqf::flat;\n\n{body}"
    return files


def _definition(export: Export) -> str:
    lines = []
    for argument in export.arguments:
        if argument.kind in ("reference", "const_reference"):
            result = c_result(export.result)
            raise_it = "null_argument(" if result == "void" else f"null_argument_result<{result}>("
            lines.append(f"if ({argument.name} == nullptr) return {raise_it}\"{null_message(argument)}\");")
    lines += _body(export)
    return c_prototype(export, "") + " {\n" + "".join(f"    {line}\n" for line in lines) + "}\n"


def _body(export: Export) -> list[str]:
    cls = export.owner
    if export.shape == "constant":
        return [f"return {export.operation};"]
    if export.shape == "delete":
        return [f"destroy<{cls}>(self);"]
    if export.shape == "upcast":
        return [f"return static_cast<{c_result(export.result)}>(upcast<{export.result.cls}, {cls}>(self));"]
    names = [argument.name for argument in export.arguments]
    if export.operation == "get_any":
        # The operation gives its texts through pointers, which these arguments can't be: they are checked, no more.
        return [f"call(+[](void*, unsigned int, const char*, const char*, const char*) {{}}, {', '.join(names)});"]
    inner = dict(zip(names, "abcdefghijkl"))
    parameters = ", ".join(f"{_inside_type(export, argument)} {inner[argument.name]}"
                           for argument in export.arguments)
    result, _ = _outside(export)
    given = "" if result == "void" else "return "
    function = f"+[]({parameters}) -> {result} {{ {given}{_expression(export, inner)}; }}"
    call = f"call({', '.join([function, *names])})"
    if export.result.kind == "object":
        call = f"static_cast<{c_result(export.result)}>({call})"
    line = f"{given}{call};"
    if len(line) <= 116:
        return [line]
    arguments = ", ".join(["}", *names])
    head = line[:line.index("{ ")]
    tail = ")" * (2 if export.result.kind == "object" else 1)
    return [head + "{", f"    {given}{_expression(export, inner)};", f"{arguments}{tail};"]


def _inside_type(export: Export, argument: Argument) -> str:
    # These take the text as it lies: by its pointer alone, or with a size of its own.
    is_pattern = export.owner == "lmx::c_pattern" and export.shape == "new"
    as_it_lies = export.operation in ("marshal", "unmarshal", "has_id") or is_pattern
    return "const char*" if argument.kind == "narrow" and as_it_lies else INSIDE[argument.kind][0]


def _outside(export: Export) -> tuple[str, str]:
    result = export.result
    if result.kind == "object":
        return "void*", "{}" if export.shape != "method" or result.owned else "address({})"
    inside, expression = OUTSIDE[result.kind]
    if inside.endswith("string&") and export.operation in BY_VALUE:
        inside = inside.removeprefix("const ").removesuffix("&")
    return inside, expression


def _expression(export: Export, inner: dict[str, str]) -> str:
    cls = export.owner
    values = [INSIDE[argument.kind][1].format(cls=ALIASES.get(argument.cls, argument.cls), name=inner[argument.name])
              for argument in export.arguments]
    if export.shape == "new":
        return f"new {cls}({', '.join(values)})"
    if export.shape == "id_get":
        return f"{cls}::id"
    if export.shape == "id_set":
        return f"{cls}::id = kept_identity({values[0]})"
    _, made = _outside(export)
    if export.shape == "function":
        return made.format(f"{export.operation}({', '.join(values)})")
    if export.shape == "static":
        return made.format(f"{cls}::{export.operation}({', '.join(values)})")
    call = f"{values[0]}.{export.operation}({', '.join(values[1:])})"
    if export.role == "assign" and export.arguments[-1].kind == "object":
        # The object itself comes back, also where it is none.
        return f"static_cast<void>({call}), {inner[export.arguments[-1].name]}"
    if export.result == Result("object", export.result.cls, owned=True) and export.operation != "clone":
        return f"new {export.result.cls}({call})"
    return made.format(call)
