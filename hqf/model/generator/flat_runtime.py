"""The exports of the runtime's values, from one table. A line is an export: result, operation, arguments with their
kinds (flat_model.py tells them), and its sentence for the documentation where the name doesn't say it all.

Numbers behind __SWIG_ are those of the C++ forms; a form without an export leaves its number out.
"""

from __future__ import annotations

import re
from pathlib import Path

from flat_model import Argument, Export, Result

CONSTANTS_HEADER = Path(__file__).parents[2] / "platform" / "build_constants.h"
CONSTANTS = {name: int(value) for name, value in re.findall(r"#define (\w+) (\d+)", CONSTANTS_HEADER.read_text())}

FUNCTIONS = """
    raw_text get_error_description(code code)        // The sentence of a code; the library keeps it.
    unsigned length(narrow s)                        // Characters of a UTF-8 text.
    int total_digits(narrow s)                       // ASCII digits in the text.
    int fraction_digits(narrow s)                    // ASCII digits behind the first point.
    bool is_valid_bool(narrow s)
    bool is_valid_float(narrow s)
    bool is_valid_integer(narrow s)
    bool is_min_length_ok(narrow s, unsigned n)      // Whether the text has at least n characters.
    bool is_max_length_ok(narrow s, unsigned n)      // Whether the text has at most n characters.
    int stringncompare(narrow s, narrow_or_null t, unsigned position, unsigned count) // As std::string; t: not null.
    bool xisalnum(int c)                             // The C library's test; 0 for c below 1.
    bool xisalpha(int c)                             // The C library's test; 0 for c below 1.
    bool xisdigit(int c)                             // The C library's test; 0 for c below 1.
    bool xisprint(int c)                             // The C library's test; 0 for c below 1.
    bool xisspace(int c)                             // The C library's test; 0 for c below 1.
    bool xisxdigit(int c)                            // The C library's test; 0 for c below 1.
"""

DATE_FIELDS = {
    "c_datetime": ("xs:dateTime.", "year month day hours mins secs"),
    "c_date": ("xs:date.", "year month day"),
    "c_time": ("xs:time.", "hours mins secs"),
    "c_gyear": ("xs:gYear.", "year"),
    "c_gyearmonth": ("xs:gYearMonth.", "year month"),
    "c_gmonth": ("xs:gMonth.", "month"),
    "c_gmonthday": ("xs:gMonthDay.", "month day"),
    "c_gday": ("xs:gDay.", "day"),
}

FIELD_KINDS = {"year": "int", "secs": "float", "is_neg": "bool", "is_utc": "bool", "total_offset_mins": "int"}
"""the others are 'unsigned'"""


def _fields(names: str) -> str:
    kinds = {name: FIELD_KINDS.get(name, "unsigned") for name in names.split()}
    return "".join(f"{kind} get_{name}()\nset_{name}({kind} value)\n" for name, kind in kinds.items())


TYPES = {
    "c_any_info": ("One element of any name, as raw XML.", """
        new__SWIG_0()
        new__SWIG_1(narrow ns, narrow name, narrow value)
        new__SWIG_2(narrow name, narrow value)
        new__SWIG_3(narrow value)
        narrow get_namespace()
        narrow get_name()
        narrow get_value()
        set_namespace(narrow ns)
        set_name(narrow name)
        set_value(narrow value)
    """),
    "c_big_int": ("An integer of any size.", """
        new__SWIG_0()                                    // Zero.
        new__SWIG_1(const_reference other)
        new__SWIG_2(narrow text)                         // An optional sign and the digits behind it.
        new__SWIG_4(long value)
        long get(flag overflow)                          // The value as a 32-bit number, wrapped where it doesn't fit.
        double get_as_float()
        narrow get_as_string()
        swap(reference other)
    """),
    "c_decimal": ("A decimal number of any size.", """
        new__SWIG_0()                                    // Zero.
        new__SWIG_1(const_reference other)
        new__SWIG_2(narrow text)                         // An optional sign, digits, and those behind a point.
        new__SWIG_4(long value, int scale)               // The value divided by ten to the power of the scale.
        new__SWIG_5(long value)
        new__SWIG_6(double value, unsigned digits)       // The value with so many decimals, at most 15.
        new__SWIG_7(double value)                        // The value with 15 decimals.
        double get_as_float()
        narrow get_as_string()
        long get_integral(flag overflow)                 // The integral part, wrapped where it doesn't fit 32 bits.
        unsigned_long get_fractional(int digits, flag overflow) // The first digits behind the point, as a number.
        long get_scaled(int scale, flag overflow)        // The value times ten to the power of the scale, truncated.
        set__SWIG_0(double value, unsigned digits)       // The value with so many decimals, at most 15.
        set__SWIG_1(double value)                        // The value with 15 decimals.
        set_integral(long value)                         // Sets integral part and sign.
        set_fractional(unsigned_long value, unsigned width) // Sets the digits behind the point, with zeros in front.
        set_scaled__SWIG_0(long value, int scale)        // The value divided by ten to the power of the scale.
        set_scaled__SWIG_1(long value)                   // The value itself.
        static bool is_valid(narrow text)
        swap(reference other)
    """),
    "c_duration": ("A signed duration.", """
        new__SWIG_0()                                    // Zero.
        new__SWIG_1(narrow text)                         // As xs:duration spells it, such as "P1DT12H".
        narrow get_as_string()
        static bool is_valid__SWIG_0(narrow text)
        normalize()                                      // Carries what is too large into the next field up.
    """ + _fields("is_neg years months days hours mins secs")),
    **{name: (doc, """
        new__SWIG_0()
        new__SWIG_1(narrow text)                         // Takes what can be read of the text.
        narrow get_as_string()
        static bool is_valid(narrow text)                // Whether the text has the lexical form of the class.
    """ + _fields(fields + " is_utc total_offset_mins") + """
        set_offset(int hours, unsigned mins)             // Minutes count in the direction of the hours' sign.
        set_offset_mins(int hours, unsigned mins)        // The same operation as set_offset.
    """) for name, (doc, fields) in DATE_FIELDS.items()},
    "c_binary": ("A sequence of bytes.", """
        new__SWIG_0()                                    // No bytes.
        new__SWIG_1(const_reference other)
        new__SWIG_2(bytes data, unsigned size)
        set(bytes data, unsigned size)                   // Replaces all bytes.
        append(byte value)
        bool equal(bytes data, unsigned size)            // Whether these are exactly the bytes held.
        unsigned size()
        swap(reference other)
        static bool is_valid_base64(narrow text)
        static bool is_valid_hex(narrow text)
    """),
    "c_pattern": ("A compiled pattern of XML Schema.", """
        new(narrow pattern)                              // An invalid pattern gives an object that matches nothing.
        bool is_match__SWIG_0(narrow text)               // Whether the pattern matches the whole UTF-8 text.
    """),
    "c_pattern_null": ("The pattern of a type without one.", """
        new()
        bool is_match__SWIG_0(narrow text)               // 1 for any text but null.
    """),
    "c_empty": ("The value of a type without content.", "new()"),
    "c_datetime_base": ("The fields that all dates and times have.", "new()"),
}

_LINE = re.compile(r"(static )?(?:(\w+) )?(\w+?)(__SWIG_\d)?\((.*?)\)\s*(?://\s*(.*))?")


def runtime_exports() -> list[Export]:
    exports = [Export(f"CSharp_{name}_get", "runtime", "values", None, "constant", str(value), (), Result("int"),
                      f"How the runtime is built: {value}.") for name, value in CONSTANTS.items()]
    exports += [_export(line, None, "") for line in FUNCTIONS.strip().splitlines()]
    for name, (summary, lines) in TYPES.items():
        cls = "lmx::" + name
        exports += [_export(line, cls, summary) for line in lines.splitlines() if line.strip()]
        exports.append(Export(f"CSharp_delete_{name}", "runtime", "values", cls, "delete", "",
                              (Argument("self", "self", cls),), doc="Deletes the object; null is allowed."))
    return exports


def _export(line: str, cls: str | None, summary: str) -> Export:
    static, result, operation, form, arguments, doc = _LINE.fullmatch(line.strip()).groups()
    form = form or ""
    parsed = tuple(_argument(text, cls) for text in arguments.split(", ") if text)
    if cls is None:
        return Export(f"CSharp_{operation}", "runtime", "values", None, "function", f"lmx::{operation}", parsed,
                      Result(result), doc or _sentence(operation))
    name = cls.removeprefix("lmx::")
    if operation == "new":
        copies = any(argument.kind == "const_reference" for argument in parsed)
        doc = f"{summary} {'A copy.' if copies else doc or ''}".strip()
        return Export(f"CSharp_new_{name}{form}", "runtime", "values", cls, "new", "", parsed,
                      Result("object", cls, owned=True), f"{doc} The caller owns it.")
    if not static:
        parsed = (Argument("self", "self", cls), *parsed)
    return Export(f"CSharp_{name}_{operation}{form}", "runtime", "values", cls, "static" if static else "method",
                  operation, parsed, Result(result or "nothing"), doc or _sentence(operation))


def _argument(text: str, cls: str | None) -> Argument:
    kind, name = text.split(" ")
    return Argument(name, kind, cls if kind.endswith("reference") else None)


def _sentence(operation: str) -> str:
    """The fields' accessors and the validators say themselves what they do."""
    verb, _, what = operation.partition("_")
    what = what.replace("_", " ")
    if operation.startswith("is_valid"):
        kind = what.removeprefix("valid").strip()
        return "Whether the text has the lexical form" + (f" of {kind}." if kind else " of the class.")
    if operation.startswith("get_as_"):
        return f"The value as {'UTF-8 text' if what == 'as string' else 'a double'}."
    return {"get": f"The {what}.", "set": f"Sets the {what}.", "swap": "Exchanges the contents.",
            "append": "Adds one at the end.", "size": "Their number."}[verb]
