"""Emits the C# classes of the runtime's values, and its functions and constants, from their exports alone."""

from __future__ import annotations

from csharp_names import doc_comment, passed, pascal, public_type, received
from flat_model import Argument, Export, bare


def value_class(name: str, exports: list[Export]) -> str:
    name = bare(name)
    lines = [doc_comment(_summary(exports)) + f"public sealed partial class {name} : NativeObject", "{"]
    setters = {_property(export, "set"): export for export in exports if _property(export, "set")}
    getters = {_property(export, "get"): export for export in exports if _property(export, "get")}
    for export in exports:
        if export.shape == "delete":
            lines += [f"    internal override void Delete(IntPtr pointer) => Native.{export.name}(pointer);", ""]
        elif export.shape == "new":
            lines += _member(export, f"public {name}({_parameters(export)})", f"this(Native.{export.name}"
                             f"({_passed(export)}), null)", " :")
        elif _property(export, "get") in setters:
            lines += _accessors(export, setters[_property(export, "get")])
        elif _property(export, "set") not in getters:
            lines += _method(export)
    lines += [f"    internal {name}(IntPtr pointer, NativeObject parent) : base(pointer, parent) {{ }}", "}", ""]
    return "\n".join(lines)


def functions_class(exports: list[Export]) -> str:
    lines = [doc_comment("The runtime's functions, and how it is built.") + "public static partial class Lmx", "{"]
    for export in exports:
        if export.shape == "constant":
            name = export.name.removeprefix("CSharp_").removesuffix("_get")
            lines += _documented(export, [f"public static int {name} => Native.{export.name}();"])
        else:
            lines += _method(export)
    return "\n".join([*lines, "}", ""])


def _summary(exports: list[Export]) -> str:
    first = next(export for export in exports if export.shape == "new")
    return first.doc.split(" The caller owns it")[0]


def _property(export: Export, role: str) -> str | None:
    """The field that a getter without arguments, or a setter with one, belongs to."""
    count = {"get": 1, "set": 2}[role]
    if export.shape != "method" or not export.operation.startswith(role + "_") or len(export.arguments) != count:
        return None
    return None if "__SWIG" in export.name else export.operation[4:]


def _visible(export: Export) -> list[Argument]:
    """The arguments without the object and without sizes, which an array has itself."""
    return [argument for before, argument in zip((None, *export.arguments), export.arguments)
            if argument.kind != "self" and not (before and before.kind == "bytes")]


def _parameters(export: Export) -> str:
    return ", ".join(f"out bool {argument.name}" if argument.kind == "flag" else
                     f"{public_type(argument)} {argument.name}" for argument in _visible(export))


def _passed(export: Export) -> str:
    given = []
    for before, argument in zip((None, *export.arguments), export.arguments):
        if before and before.kind == "bytes":
            given.append(f"(uint){before.name}.Length")
        elif argument.kind == "narrow_or_null" and export.shape == "function":
            given.append(f"NativeText.ToNarrow({argument.name} ?? throw new ArgumentNullException())")
        else:
            given.append(passed(argument))
    return ", ".join(given)


def _accessors(getter: Export, setter: Export) -> list[str]:
    value = passed(setter.arguments[1], "value")
    return _documented(getter, [
        f"public {public_type(getter.result)} {pascal(getter.operation[4:])}", "{",
        f"    get => {received(getter.result, f'Native.{getter.name}(Self)', 'this')};",
        f"    set {{ Native.{setter.name}(Self, {value}); Call.Done(); }}", "}"])


def _method(export: Export) -> list[str]:
    static = "" if export.shape == "method" else "static "
    name = pascal(export.operation.removeprefix("lmx::")) if export.operation != "size" else "GetSize"
    call = f"Native.{export.name}({_passed(export)})"
    if export.operation == "get_as_string":
        return _documented(export, [f"public override string ToString() => {received(export.result, call, 'this')};"])
    head = f"public {static}{public_type(export.result)} {name}({_parameters(export)})"
    if export.result.kind == "nothing":
        return _documented(export, [head, "{", f"    {call};", "    Call.Done();", "}"])
    return _member(export, head, received(export.result, call, "this"))


def _member(export: Export, head: str, expression: str, arrow: str = " =>") -> list[str]:
    end = " { }" if arrow == " :" else ";"
    return _documented(export, [head + arrow, f"    {expression}{end}"])


def _documented(export: Export, lines: list[str]) -> list[str]:
    return ["    " + line for line in (doc_comment(export.doc.replace(" The caller owns it.", ""))).splitlines()] + [
        "    " + line for line in lines] + [""]
