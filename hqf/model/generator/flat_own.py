"""The exports that no rule gives: registration of callbacks, the platform's string allocator, and what we add."""

from __future__ import annotations

from flat_model import NOTHING, Argument, Export, Result

EXCEPTION_ROWS = 11
ARGUMENT_ROWS = 3


def own_exports() -> list[Export]:
    return _registration() + _platform() + _added()


def _registration() -> list[Export]:
    """Written by hand in hqf/flat/conventions.cpp."""
    rows = (
        ("SWIGRegisterExceptionCallbacks_HqfModule",
         tuple(Argument(f"row_{row}", "exception_callback") for row in range(EXCEPTION_ROWS)),
         "Stores the exception callbacks, rows 0 to 10. Row 0 gets the text of an exception that an operation raised."),
        ("SWIGRegisterExceptionArgumentCallbacks_HqfModule",
         tuple(Argument(f"row_{row}", "argument_callback") for row in range(ARGUMENT_ROWS)),
         "Stores the argument callbacks, rows 0 to 2. Row 1 gets the message about a null argument, and null with it."),
        ("SWIGRegisterStringCallback_HqfModule", (Argument("callback", "string_callback"),),
         "Stores the string callback, which nothing calls: text leaves in platform strings."),
    )
    return [Export(name, "registration", "", None, "function", "", arguments, NOTHING, doc)
            for name, arguments, doc in rows]


def _platform() -> list[Export]:
    """Written by hand in hqf/flat/platform_strings.cpp."""
    text, size = Argument("text", "const_pointer"), Argument("size", "unsigned")
    rows = (
        ("SysAllocStringLen", (Argument("text", "wide"), size), Result("wide"),
         "A new string of `size` units; zeros where `text` is null. Null where memory is out."),
        ("SysAllocStringByteLen", (Argument("text", "narrow"), size), Result("narrow"),
         "A new string of `size` bytes; zeros where `text` is null. Null where memory is out."),
        ("SysFreeString", (Argument("text", "pointer"),), NOTHING,
         "Frees a string that an export gave, wide or of bytes; null is allowed."),
        ("SysStringLen", (text,), Result("unsigned"), "The units of a wide string, 0 for null."),
        ("SysStringByteLen", (text,), Result("unsigned"), "The bytes of a string of either kind, 0 for null."),
    )
    return [Export(name, "platform", "", None, "function", "", arguments, result, doc)
            for name, arguments, result, doc in rows]


def _added() -> list[Export]:
    """Forwards to functions of hqf/flat/additions.h. Their names have our own prefix, for no rule gives them."""
    revision = (Argument("self", "self", "hqf_v2::Revision"), Argument("index", "unsigned"))
    rows = (
        ("Revision_any_namespace", "flat::any_namespace", revision, Result("narrow"),
         "The namespace of an entry; null, and a report to row 0, from the size on."),
        ("Revision_any_name", "flat::any_name", revision, Result("narrow"),
         "The name of an entry; null, and a report to row 0, from the size on."),
        ("Revision_any_value", "flat::any_value", revision, Result("narrow"),
         "An entry as raw XML; null, and a report to row 0, from the size on."),
        ("c_binary_get", "flat::copy_bytes",
         (Argument("self", "self", "lmx::c_binary"), Argument("buffer", "buffer"), Argument("size", "unsigned")),
         Result("unsigned"), "Copies the first bytes, as many as both sides have, and gives their number."),
        ("Hqf_equal", "equal",
         (Argument("self", "self", "hqf_v2::Hqf"), Argument("other", "const_reference", "hqf_v2::Hqf")),
         Result("bool"), "Whether the same is set in both documents, and to the same values."),
    )
    return [Export(f"hqf_{name}", "own", "values", None, "function", f"hqf::{function}", arguments, result, doc)
            for name, function, arguments, result, doc in rows]
