"""Names and types that the C++ emitters share."""

from __future__ import annotations

import re

from vocabulary import Attribute, Body, Member, ModelClass, Option, SimpleType, Vocabulary

NOTICE = "// Generated from hqf/model/hqf-v2.xsd by hqf/model/generator: change the schema, not this file.\n"

VALUE_TYPES = {
    "string": "std::wstring",
    "double": "double",
    "int": "int",
    "unsigned int": "unsigned int",
    "unsigned char": "unsigned char",
    "bool": "bool",
    "datetime": "lmx::c_datetime",
    "binary": "lmx::c_binary",
}

BY_REFERENCE = ("string", "datetime", "binary")


def value_type(type_: SimpleType) -> str:
    return VALUE_TYPES[type_.kind]


def storage_type(type_: SimpleType) -> str:
    """How a single member or a body holds its value."""
    return "hqf::frame::enumerated" if type_.literals else value_type(type_)


def argument_type(type_: SimpleType) -> str:
    """How a value goes in and comes out: text, dates and bytes by reference, numbers by value."""
    return f"const {value_type(type_)}&" if type_.kind in BY_REFERENCE else value_type(type_)


def identifier(text: str) -> str:
    return re.sub(r"[^0-9A-Za-z]", "_", text)


def literals_name(type_: SimpleType) -> str:
    return "literals_of_" + identifier(type_.name)


def has_rules(type_: SimpleType) -> bool:
    """Whether a type needs facets of its own: plain text is preserved, every other built-in type collapsed."""
    return bool(type_.literals) or type_.minimum is not None or type_.maximum is not None or type_.pattern is not None \
        or type_.min_length is not None or type_.max_length is not None \
        or (type_.kind == "string" and type_.whitespace == "collapse")


def rules_name(type_: SimpleType) -> str:
    suffix = "" if type_.setter_checks_minimum else "_unchecked_minimum"
    return "rules_of_" + identifier(type_.name.removeprefix("xs:")) + suffix


def rules_pointer(type_: SimpleType | None) -> str:
    return "&hqf::model::" + rules_name(type_) if type_ is not None and has_rules(type_) else "nullptr"


def places(vocabulary: Vocabulary) -> list[Attribute | Member | Option | Body]:
    """Every declaration that has a simple type or a class, once for each class that declares it."""
    result: list[Attribute | Member | Option | Body] = []
    for cls in vocabulary.classes.values():
        result += [*cls.attributes, *cls.members, *cls.options] + ([cls.body] if cls.body else [])
    return result


def simple_types(vocabulary: Vocabulary) -> list[SimpleType]:
    """The types with rules of their own, each once."""
    types = [place.type for place in places(vocabulary) if place.type is not None and has_rules(place.type)]
    return list(dict.fromkeys(types))


def rows_class(vocabulary: Vocabulary, cls: ModelClass) -> ModelClass:
    """The class whose rows serve a class: an element class without members of its own uses those of its type."""
    return vocabulary.classes[cls.base] if cls.form == "element" and not cls.nillable else cls


def rows_name(vocabulary: Vocabulary, cls: ModelClass) -> str:
    return rows_class(vocabulary, cls).name + "_rows"


def is_virtual(cls: ModelClass) -> bool:
    return cls.polymorphic


def made_on_first_use(vocabulary: Vocabulary, member: Member) -> bool:
    """Whether a single child lies on the heap: where it must, since its class can contain its own kind, and wherever it
    may be absent, which most such children are in most documents; so are contents of elements that may be nil."""
    if member.by_pointer or (not member.minimum and not member.always_written):
        return True
    return vocabulary.classes[member.class_name].nillable and not vocabulary.body(vocabulary.classes[member.class_name])


def enumerations(cls: ModelClass) -> list[tuple[str, SimpleType]]:
    """The enumerated members that a class declares itself, with the name that their enumeration takes."""
    found = [(place.name, place.type) for place in [*cls.attributes, *cls.members, *cls.options]]
    if cls.body:
        found.insert(len(cls.attributes), (cls.name, cls.body.type))
    return [(name, type_) for name, type_ in found if type_ is not None and type_.literals]


def bounds_text(type_: SimpleType) -> str:
    """The rule of a value in a doc comment, with the codes that break it; empty where any value passes."""
    parts = []
    if type_.literals:
        parts.append("one of the literals of its enumeration, else 38")
    if type_.minimum is not None and not type_.implied_bounds[0]:
        parts.append(f"{'above' if type_.minimum_exclusive else 'from'} {type_.minimum}, else 37"
                     + ("" if type_.setter_checks_minimum else " (on reading alone)"))
    if type_.maximum is not None and not type_.implied_bounds[1]:
        parts.append(f"{'below' if type_.maximum_exclusive else 'up to'} {type_.maximum}, else 36")
    if type_.min_length is not None:
        parts.append(f"at least {type_.min_length} character{'s' if type_.min_length > 1 else ''}, else 20")
    if type_.max_length is not None:
        parts.append(f"at most {type_.max_length} character{'s' if type_.max_length > 1 else ''}, else 19")
    if type_.pattern is not None:
        parts.append("with an explicit time zone, which the reader asks for (22)")
    return "; ".join(parts)
