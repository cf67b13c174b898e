"""The flat layer as its emitters see it: one list of exports, whatever language they are written in.

flat_classes.py makes those of the model classes from the vocabulary, flat_runtime.py those of the runtime's values and
flat_own.py the rest, each from one table; flat_exports() joins them. An emitter of another language needs no
more than that list, and typed_model.py for the literals of enumerations.
"""

from __future__ import annotations

from dataclasses import dataclass

OBJECT_KINDS = ("self", "object", "reference", "const_reference")

ALIASES = {"lmx::tc_datetime": "lmx::c_datetime", "lmx::tc_binary": "lmx::c_binary"}
"""names that model accessors use for runtime values; a message about a null argument spells the alias"""


@dataclass(frozen=True)
class Argument:
    name: str
    kind: str
    """'self' (never checked), 'object' (a pointer that may be null), 'reference' and 'const_reference' (null raises
    "... & type is null"); 'wide' (null is the empty string), 'narrow' (null raises "null string"), 'narrow_or_null'
    (passed on as it is); 'bool', 'int', 'unsigned', 'byte', 'long', 'unsigned_long' (both of 32 bits), 'double',
    'float', 'enum', 'code'; 'bytes' (read, as many as the argument behind it tells), 'buffer' (written likewise),
    'flag' (a bool that is written, unless null); 'pointer' and 'const_pointer' (to no class);
    'exception_callback', 'argument_callback', 'string_callback'"""
    cls: str | None = None
    """the qualified C++ class of an object, or enumeration of an enum"""


@dataclass(frozen=True)
class Result:
    kind: str = "nothing"
    """'nothing', 'code', 'bool', 'int', 'unsigned', 'byte', 'long', 'unsigned_long', 'double', 'float', 'enum';
    'wide' and 'narrow' (a platform string that the caller frees), 'raw_text' (UTF-8 that the library keeps);
    'object'"""
    cls: str | None = None
    owned: bool = False
    """the caller owns the object and frees it with CSharp_delete_ and the class; else it lies in its parent"""


NOTHING, CODE, BOOL, UNSIGNED = Result(), Result("code"), Result("bool"), Result("unsigned")


@dataclass(frozen=True)
class Export:
    name: str
    family: str
    """'model', 'runtime', 'registration', 'platform' or 'own'"""
    part: str
    """the file that it is emitted into; empty where it is written by hand"""
    owner: str | None
    """the qualified C++ class that it belongs to"""
    shape: str
    """'new' (any constructor), 'delete', 'upcast', 'method', 'static', 'id_get', 'id_set', 'function', 'constant'"""
    operation: str
    """what it forwards to: the member's name, a free function's qualified name, a constant's value"""
    arguments: tuple[Argument, ...] = ()
    """with the object itself as the first one of a method"""
    result: Result = NOTHING
    doc: str = ""
    role: str = ""
    """of an accessor: 'get', 'set', 'isset', 'unset', 'append', 'insert', 'delete', 'clear', 'size', 'back',
    'assign', 'getenum', 'setenum', 'isnil', 'setnil'"""
    member: str = ""
    """of an accessor: the X in get_X"""
    form: str = ""
    """of an accessor: 'value', 'values' (repeating), 'object', 'objects' (repeating), 'option' (a value of a choice),
    'option_object' (also a group's member), 'wildcard', 'nil'"""


def bare(cls: str) -> str:
    """A class's name as exports and C spell it: "c_datetime" for "lmx::tc_datetime"."""
    return ALIASES.get(cls, cls).rsplit("::", 1)[-1]


def null_message(argument: Argument) -> str | None:
    """What a null pointer in this place raises; None where nothing checks it."""
    if argument.kind == "narrow":
        return "null string"
    if argument.kind in ("reference", "const_reference"):
        return f"{argument.cls} {'const ' if argument.kind == 'const_reference' else ''}& type is null"
    return None
