"""How the flat layer's kinds of values are spelled in C."""

from __future__ import annotations

from flat_model import ALIASES, OBJECT_KINDS, Argument, Export, Result, bare

PLAIN = {
    "code": "int32_t", "bool": "int32_t", "int": "int32_t", "enum": "int32_t", "long": "int32_t",
    "unsigned": "uint32_t", "byte": "uint32_t", "unsigned_long": "uint32_t", "double": "double", "float": "float",
}

ARGUMENTS = PLAIN | {
    "wide": "const wchar_t*", "narrow": "const char*", "narrow_or_null": "const char*",
    "bytes": "const unsigned char*", "buffer": "unsigned char*", "flag": "bool*",
    "pointer": "void*", "const_pointer": "const void*", "exception_callback": "hqf_exception_callback",
    "argument_callback": "hqf_argument_callback", "string_callback": "hqf_string_callback",
}

RESULTS = PLAIN | {"nothing": "void", "wide": "wchar_t*", "narrow": "char*", "raw_text": "const char*"}


def c_class(cls: str) -> str:
    """hqf_ColorType for hqf_v2::ColorType, lmx_c_binary for lmx::c_binary and its alias."""
    return ("lmx_" if ALIASES.get(cls, cls).startswith("lmx::") else "hqf_") + bare(cls)


def c_argument(argument: Argument) -> str:
    if argument.kind in OBJECT_KINDS:
        const = "const " if argument.kind == "const_reference" else ""
        return f"{const}{c_class(argument.cls)}*"
    return ARGUMENTS[argument.kind]


def c_result(result: Result) -> str:
    return c_class(result.cls) + "*" if result.kind == "object" else RESULTS[result.kind]


def c_prototype(export: Export, nothing: str) -> str:
    """`nothing` stands for an empty list of arguments: "void" in C."""
    arguments = [f"{c_argument(argument)} {argument.name}" for argument in export.arguments] or [nothing]
    head = f"{c_result(export.result)} {export.name}("
    line = head + ", ".join(arguments) + ")"
    if len(line) < 118:
        return line
    lines, current = [head], "   "
    for argument in arguments:
        if len(current) + len(argument) > 116:
            lines, current = lines + [current], "   "
        current += f" {argument},"
    return "\n".join([*lines, current.rstrip(",") + ")"])
