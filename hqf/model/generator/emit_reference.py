"""Emits the vocabulary reference: a page with a table for each class, for people who look a name or a rule up."""

from __future__ import annotations

from cpp_names import bounds_text, enumerations, value_type
from vocabulary import ModelClass, SimpleType, Vocabulary


def reference_page(vocabulary: Vocabulary) -> str:
    lines = ["# Vocabulary", "",
             f"Every class of the format, namespace `{vocabulary.namespace_uri}`, generated from `hqf/model/hqf-v2.xsd`. "
             "Elements stand in document order, behind those of the base. Numbers such as 36 are the codes of "
             "`lmx::elmx_error`.", ""]
    for part in dict.fromkeys(cls.part for cls in vocabulary.classes.values()):
        lines += [f"## {part.capitalize()}", ""]
        for cls in vocabulary.classes.values():
            if cls.part == part and cls.has_own_members():
                lines += _class(vocabulary, cls)
    return "\n".join(lines)


def _class(vocabulary: Vocabulary, cls: ModelClass) -> list[str]:
    facts = [f"element `{cls.element}`"] if cls.element else []
    facts += [f"base `{cls.base}`"] if cls.base else []
    facts += ["may be nil"] if cls.nillable else []
    facts += ["accepts an element without any content"] if cls.tolerant else []
    lines = [f"### {cls.name}", "", cls.doc + (f" ({', '.join(facts)})" if facts else ""), ""]
    rows = []
    for attribute in cls.attributes:
        count = "required" if attribute.required else "optional"
        rows.append((f"attribute `{attribute.name}`", count, _type(attribute.type), attribute.doc))
    if cls.body:
        rows.append(("body", "optional" if cls.body.optional else "1", _type(cls.body.type), cls.body.doc))
    for member in cls.members:
        count = f"{member.minimum}..{'*' if member.repeating else '1'}"
        kind = _type(member.type) if member.type else f"`{member.class_name or 'any element'}`"
        rows.append((f"`{member.name}`", count, kind, member.doc))
    for number, option in enumerate(cls.options):
        kind = _type(option.type) if option.type else f"`{option.class_name}`"
        rows.append((f"`{option.name}`", f"option {number}", kind, option.doc))
    if rows:
        lines += ["| Member | Occurs | Type and rule | Meaning |", "|---|---|---|---|"]
        lines += [f"| {' | '.join(cell.replace('|', '&#124;') for cell in row)} |" for row in rows] + [""]
    for name, type_ in enumerations(cls):
        literals = ", ".join(f'{number} "{literal}"' for number, literal in enumerate(type_.literals, 1))
        lines += [f"Literals of `{name}`: {literals}.", ""]
    return lines


def _type(type_: SimpleType) -> str:
    rule = bounds_text(type_)
    return f"`{value_type(type_)}`" + (f"; {rule}" if rule else "")
