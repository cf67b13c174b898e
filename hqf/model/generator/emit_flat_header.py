"""Emits hqf_flat.h, the C header of the flat layer."""

from __future__ import annotations

import textwrap

from cpp_names import NOTICE
from flat_c_types import c_class, c_prototype
from flat_classes import enumerators
from flat_model import ALIASES, Export
from typed_model import Vocabulary

HEAD = """\
/// @file
/// The library for callers in C, and for every language that can call C.
///
/// An export is named after the class and the operation that it forwards to: CSharp_Header_set_Creator is set_Creator
/// of Header. Where an operation has several forms, __SWIG_ and the number of the form stand behind it. What a class
/// inherits is reached through the pointer to its base that CSharp_<class>Upcast gives.
///
/// Objects are opaque. One that CSharp_new_, clone, factory or writeString gives belongs to the caller, who frees it
/// with CSharp_delete_ and its class. One that a get_, assign_ or back_ gives lies inside its parent: it stays valid
/// until it is deleted there, or the parent is reset, swapped or deleted. The object itself, the first argument, must
/// never be null; any other null object raises the message "<class> & type is null" ("const &" where it is only read).
///
/// Text comes in as wchar_t (UTF-16 units, one in each wchar_t; a character above U+FFFF is two), where null is the
/// empty text, or as UTF-8 bytes, where null raises "null string". It goes out as a new platform string, wchar_t* or
/// char*, with a NUL behind it and its length before it (SysStringLen, SysStringByteLen); free it with SysFreeString.
/// What is `const char*` as a result stays the library's.
///
/// Codes: 0 is success, CSharp_get_error_description() tells what another one means. A truth is 0 or 1; coming in,
/// anything but 0 is true. A byte crosses as its number, of which only the low 8 bits count.
///
/// Failures. An export that refuses a null argument calls row 1 of the argument callbacks and gives 0 or null; nothing
/// else happens then. If an operation raises an exception, such as std::bad_alloc, row 0 of the exception callbacks
/// gets its text, and the export gives 0 or null, but 42 for a code (1000 for one of the archive layer). Callbacks
/// that were never registered are not called. Callbacks must return.
///
/// One thread at a time may use a document; register callbacks before anything else.
"""

TYPES = """\
/// Gets the text of an exception; the text is valid during the call.
typedef void (*hqf_exception_callback)(const char* message);
/// Gets the message about an argument; the parameter's name is always null.
typedef void (*hqf_argument_callback)(const char* message, const char* parameter_name);
/// Stored for callers that register one, never called.
typedef void* (*hqf_string_callback)(const char* text);
"""

MARK = """\
#if defined(_WIN32)
#if defined(HQF_BUILDING)
#define HQF_FLAT __declspec(dllexport)
#else
#define HQF_FLAT __declspec(dllimport)
#endif
#else
#define HQF_FLAT __attribute__((visibility("default")))
#endif
"""

SECTIONS = (("registration", "Registration of callbacks"), ("platform", "Platform strings"),
            ("own", "What no operation gives in a form that can cross"))


def flat_header(vocabulary: Vocabulary, exports: list[Export]) -> str:
    classes = dict.fromkeys(ALIASES.get(export.owner, export.owner) for export in exports if export.owner)
    lines = [NOTICE + HEAD, "#ifndef HQF_FLAT_HQF_FLAT_H", "#define HQF_FLAT_HQF_FLAT_H", "", "#include <stdbool.h>",
             "#include <stdint.h>", "#include <wchar.h>", "", MARK, "#ifdef __cplusplus", 'extern "C" {', "#endif",
             "", TYPES]
    lines += [f"typedef struct {c_class(cls)} {c_class(cls)};" for cls in classes]
    for family, title in SECTIONS:
        lines += _section(title, [export for export in exports if export.family == family])
    runtime = [export for export in exports if export.family == "runtime"]
    lines += _section("Build constants", [export for export in runtime if export.shape == "constant"])
    lines += _section("Functions", [export for export in runtime if export.shape == "function"])
    for cls in classes:
        mine = [export for export in exports if export.owner == cls]
        numbers = enumerators(vocabulary.classes[cls.removeprefix("hqf_v2::")]) if cls.removeprefix(
            "hqf_v2::") in vocabulary.classes else []
        lines += _section(cls.rsplit("::", 1)[1], mine, [line for name, entries in numbers
                                                         for line in _enumeration(cls, name, entries)])
    lines += ["", "#ifdef __cplusplus", "}", "#endif", "", "#endif", ""]
    return "\n".join(lines)


def _section(title: str, exports: list[Export], before: list[str] | None = None) -> list[str]:
    lines = ["", f"// {title}", "", *(before or [])]
    for export in exports:
        lines += textwrap.wrap(" ".join(export.doc.split()), 116, initial_indent="/// ", subsequent_indent="/// ",
                               break_long_words=False, break_on_hyphens=False)
        lines.append(f"HQF_FLAT {c_prototype(export, 'void')};")
    return lines


def _enumeration(cls: str, name: str, entries: list[tuple[str, int]]) -> list[str]:
    prefix = c_class(cls)
    what = "What is chosen." if name == "elmx_chosen" else (
        f"Numbers of the literals of {name.removeprefix('Eenum_')}; 0 stands for any other text.")
    return [f"/// {what}", f"enum {prefix}_{name} {{",
            ",\n".join(f"    {prefix}_{entry} = {number}" for entry, number in entries), "};", ""]
