"""Emits the declaration of every export in C#, under its own name."""

from __future__ import annotations

from flat_model import Argument, Export

ARGUMENTS = {
    "self": "HandleRef", "object": "HandleRef", "reference": "HandleRef", "const_reference": "HandleRef",
    "wide": "int[]", "narrow": "byte[]", "narrow_or_null": "byte[]", "bytes": "byte[]", "buffer": "[Out] byte[]",
    "bool": "bool", "int": "int", "long": "int", "enum": "int", "code": "int", "unsigned": "uint",
    "unsigned_long": "uint", "byte": "uint", "double": "double", "float": "float",
    "flag": "[MarshalAs(UnmanagedType.I1)] out bool", "pointer": "IntPtr", "const_pointer": "IntPtr",
    "exception_callback": "Callbacks.ExceptionCallback", "argument_callback": "Callbacks.ArgumentCallback",
    "string_callback": "Callbacks.StringCallback",
}

RESULTS = {
    "nothing": "void", "bool": "bool", "int": "int", "long": "int", "enum": "int", "code": "int", "unsigned": "uint",
    "unsigned_long": "uint", "byte": "uint", "double": "double", "float": "float", "wide": "IntPtr",
    "narrow": "IntPtr", "raw_text": "IntPtr", "object": "IntPtr",
}

HEAD = """\
static partial class Native
{
    // Hqf.dll.config tells where it is.
    const string Library = "hqf";

"""


def declarations(exports: list[Export]) -> str:
    lines = []
    for export in exports:
        arguments = ", ".join(f"{_type(export, argument)} @{argument.name}" for argument in export.arguments)
        lines.append(f"    [DllImport(Library)] internal static extern {RESULTS[export.result.kind]} {export.name}"
                     f"({arguments});\n")
    return HEAD + "".join(lines) + "}\n"


def _type(export: Export, argument: Argument) -> str:
    if export.shape == "delete":
        return "IntPtr"  # called where its object is past keeping alive
    if export.operation == "has_id" and argument.kind == "narrow":
        return "IntPtr"  # compared as a pointer
    return ARGUMENTS[argument.kind]
