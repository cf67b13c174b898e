"""Emits the constant tables that drive the engine: names, literals, rules, and the rows of each class."""

from __future__ import annotations

import itertools

from cpp_names import (NOTICE, identifier, literals_name, places, rows_name, rules_name, rules_pointer, simple_types)
from vocabulary import Attribute, Member, ModelClass, SimpleType, Vocabulary
from xsd import SchemaError

FORMS = {"sequence": "sequence", "simple": "simple_content", "choice": "choice", "group": "group", "any": "wildcard"}

FIRST_EVENT = 12

ZONE_PATTERN = r".+T.+(Z|[+\-].+)"
"""hqf/values/datetime_text.h decides it in one pass; the regular expression engine can take far longer"""


def tables_header(vocabulary: Vocabulary) -> str:
    lines = [NOTICE + "#pragma once", "", '#include "hqf/frame/access.h"', '#include "hqf/frame/rows.h"', "",
             "namespace hqf::model {", "", "using frame::class_rows;", "using frame::facets;",
             "using frame::factory_rows;", "using frame::literals;", ""]
    lines += [f"extern const literals {name};" for name in _literal_types(vocabulary)]
    lines += [f"extern const facets {rules_name(type_)};" for type_ in simple_types(vocabulary)]
    lines += [f"extern const class_rows {cls.name}_rows;" for cls in _row_classes(vocabulary)]
    lines += [f"extern const factory_rows {cls.name}_factory;"
              for cls in vocabulary.classes.values() if cls.factory_names]
    return "\n".join(lines + ["", "} // namespace hqf::model", ""])


def tables_source(vocabulary: Vocabulary) -> str:
    return _Tables(vocabulary).text()


def _literal_types(vocabulary: Vocabulary) -> dict[str, SimpleType]:
    return {literals_name(type_): type_ for type_ in simple_types(vocabulary) if type_.literals}


def _row_classes(vocabulary: Vocabulary) -> list[ModelClass]:
    return [cls for cls in vocabulary.classes.values() if rows_name(vocabulary, cls) == cls.name + "_rows"]


class _Tables:
    def __init__(self, vocabulary: Vocabulary) -> None:
        self.vocabulary = vocabulary
        elements, attributes = {}, {}
        for place in places(vocabulary):
            if isinstance(place, Attribute):
                attributes[place.name] = True
            elif hasattr(place, "name") and getattr(place, "kind", "") not in ("group", "any"):
                elements[place.name] = True
        for cls in vocabulary.classes.values():
            for entry in cls.group:
                elements[entry.element] = True
        self.elements, self.attributes = list(elements), list(attributes)
        self.events = {name: number for number, name in
                       enumerate(dict.fromkeys([*self.elements, *self.attributes]), FIRST_EVENT)}

    def text(self) -> str:
        lines = [NOTICE,
                 "// The rows of a class are offsets of members of a class with virtual operations, which the standard leaves",
                 "// to the compiler; every compiler that the library is built with defines them.",
                 '#pragma GCC diagnostic ignored "-Winvalid-offsetof"', "",
                 '#include "hqf/frame/row_macros.h"', '#include "hqf/model/classes.h"', '#include "hqf/model/tables.h"', "",
                 "namespace hqf::frame {",
                 f'const lmx::s_ns_map namespace_map[] = {{{{format_namespace_id, "{self.vocabulary.prefix}", '
                 f'"{self.vocabulary.namespace_uri}"}}, {{0, nullptr, nullptr}}}};',
                 "} // namespace hqf::frame", "", "namespace hqf::model {", "", "using namespace hqf_v2;", "",
                 "namespace {", ""]
        prefix = self.vocabulary.prefix
        lines += [f'constexpr frame::element_name element_{name} = {{"<{prefix}:{name}>", '
                  f"{len(name) + len(prefix) + 3}, {self.events[name]}}};" for name in self.elements]
        lines += [f'constexpr frame::attribute_name attribute_{name} = {{" {name}=\\"", {len(name) + 3}, '
                  f"{self.events[name]}}};" for name in self.attributes]
        lines += [""] + self.big_integers()
        for name, type_ in _literal_types(self.vocabulary).items():
            lines += self.literal_arrays(name, type_)
        lines += ["", "} // namespace", ""]
        for name, type_ in _literal_types(self.vocabulary).items():
            lines.append(f"const literals {name} = {{{len(type_.literals)}, {name}_narrow, {name}_lengths, {name}_wide}};")
        lines += [line for type_ in simple_types(self.vocabulary) for line in self.rules(type_)]
        lines += ["", "} // namespace hqf::model", "", "namespace hqf::frame {", "", "using namespace hqf::model;",
                  "using namespace hqf_v2;", ""]
        classes = _row_classes(self.vocabulary)
        for cls in classes:
            lines += self.rows(cls)
        lines += ["} // namespace hqf::frame", "", "namespace hqf::model {", ""]
        lines += [line for cls in classes for line in self.table(cls)]
        for cls in self.vocabulary.classes.values():
            if cls.factory_names:
                names = ", ".join(f"&{name}_rows" for name in cls.factory_names)
                lines += [f"static constexpr const class_rows* {cls.name}_types[] = {{{names}}};",
                          f"const factory_rows {cls.name}_factory = {{{len(cls.factory_names)}, {cls.name}_types}};"]
        return "\n".join(lines + ["", "} // namespace hqf::model", ""])

    # Simple types

    def big_integers(self) -> list[str]:
        bounds = {bound for type_ in simple_types(self.vocabulary) if type_.bounds_tested_as_text
                  for bound in self.integer_bounds(type_)}
        return [f'const lmx::c_big_int big_{identifier(bound)}("{bound}");' for bound in sorted(bounds)] + [""]

    @staticmethod
    def integer_bounds(type_: SimpleType) -> tuple[str, str]:
        """Inclusive bounds: for whole numbers an exclusive bound is the next one inside."""
        return (str(int(type_.minimum) + type_.minimum_exclusive), str(int(type_.maximum) - type_.maximum_exclusive))

    @staticmethod
    def literal_arrays(name: str, type_: SimpleType) -> list[str]:
        narrow = ", ".join(f'"{literal}"' for literal in type_.literals)
        wide = ", ".join(f'L"{literal}"' for literal in type_.literals)
        lengths = ", ".join(str(len(literal)) for literal in type_.literals)
        return [f"constexpr const char* {name}_narrow[] = {{{narrow}}};",
                f"constexpr std::uint8_t {name}_lengths[] = {{{lengths}}};",
                f"const std::wstring {name}_wide[] = {{{wide}}};"]

    def rules(self, type_: SimpleType) -> list[str]:
        facts = [f".whitespace = lmx::{type_.whitespace}"]
        if type_.minimum is not None:
            facts.append(".has_minimum = true")
        if type_.minimum_exclusive:
            facts.append(".minimum_is_exclusive = true")
        if type_.maximum is not None:
            facts.append(".has_maximum = true")
        if type_.maximum_exclusive:
            facts.append(".maximum_is_exclusive = true")
        if not type_.setter_checks_minimum:
            facts.append(".setter_checks_minimum = false")
        if type_.pattern is not None:
            if type_.pattern != ZONE_PATTERN:
                raise SchemaError(f"{type_.name}: the reader knows no pattern but {ZONE_PATTERN}")
            facts.append(".zoned = true")
        if type_.minimum is not None:
            facts.append(f".minimum = {type_.minimum}")
        if type_.maximum is not None:
            facts.append(f".maximum = {type_.maximum}")
        if type_.min_length is not None:
            facts.append(f".minimum_length = {type_.min_length}")
        if type_.max_length is not None:
            facts.append(f".maximum_length = {type_.max_length}")
        if type_.literals:
            facts.append(f".texts = &{literals_name(type_)}")
        if type_.bounds_tested_as_text:
            low, high = self.integer_bounds(type_)
            facts += [f".integer_minimum = &big_{identifier(low)}", f".integer_maximum = &big_{identifier(high)}"]
        return [f"const facets {rules_name(type_)} = {{{', '.join(facts)}}};"]

    # Rows

    def rows(self, cls: ModelClass) -> list[str]:
        vocabulary = self.vocabulary
        lines = [f"template <>", f"struct rows_of<{cls.name}> {{", f"    using own = {cls.name};"]
        attributes = vocabulary.all_attributes(cls)
        if attributes:
            lines.append("    static constexpr row attributes[] = {")
            for attribute in attributes:
                flags = "mandatory_row" if attribute.required else "0"
                if attribute.default is not None:
                    flags = "always_written"
                lines.append(f"        HQF_ATTRIBUTE({attribute.name}, {flags}, {rules_pointer(attribute.type)}),")
            lines.append("    };")
        children = self.child_rows(cls)
        if children:
            lines += ["    static constexpr row rows[] = {", *children, "    };"]
        if cls.nillable:
            lines.append("    static constexpr unsigned int nil = offsetof(own, nil_);")
        if cls.form in ("choice", "group"):
            lines.append("    static constexpr unsigned int slot = offsetof(own, slot_);")
        return lines + ["};", ""]

    def child_rows(self, cls: ModelClass) -> list[str]:
        body = self.vocabulary.body(cls)
        if body:
            flags = "0" if body.optional else "mandatory_row"
            return [f"        HQF_BODY({flags}, {rules_pointer(body.type)}),"]
        if cls.options:
            return [f"        HQF_OPTION({o.name}, {self.option_kind(o)}, {rules_pointer(o.type)}, "
                    f"{self.type_pointer(o.class_name)})," for o in cls.options]
        return [f"        {self.child_row(member)}," for member in self.vocabulary.all_members(cls)]

    @staticmethod
    def option_kind(option) -> str:
        kinds = {"string": "text", "double": "real", "int": "integer", "unsigned int": "natural"}
        return "kind::" + (kinds[option.type.kind] if option.type else "child")

    def type_pointer(self, class_name: str | None) -> str:
        return "nullptr" if class_name is None else "&" + rows_name(self.vocabulary, self.vocabulary.classes[class_name])

    def child_row(self, member: Member) -> str:
        flags = ["mandatory_row"] if member.minimum else []
        if member.always_written:
            flags.append("always_written")
        if not member.counts_for_occurs:
            flags.append("not_counted")
        if member.simple_type_error is not None:
            flags.append("value_error_only")
        joined = " | ".join(flags) or "0"
        if member.kind == "any":
            return f"HQF_WILDCARD(any, {joined})"
        if member.kind == "group":
            return f"HQF_GROUP({member.name}, {joined}, {self.type_pointer(member.class_name)})"
        return f"HQF_ELEMENT({member.name}, {joined}, {rules_pointer(member.type)}, {self.type_pointer(member.class_name)})"

    # Tables

    def event_rows(self, names: list[str], namespace: str) -> str:
        rows = [f'{{{namespace}, "{name}", {len(name)}, {self.events[name]}}}' for name in names]
        return ", ".join(rows + ["{0, nullptr, 0, 1}"])

    def table(self, cls: ModelClass) -> list[str]:
        name, vocabulary = cls.name, self.vocabulary
        attributes = vocabulary.all_attributes(cls)
        own_form = cls.form if cls.form != "element" else vocabulary.classes[cls.base].form
        base_form = vocabulary.classes[cls.base] if cls.form == "element" else cls
        lines: list[str] = []
        facts = [f'.name = "{cls.base if cls.form == "element" else name}"', f".shape = frame::form::{FORMS[own_form]}"]
        if cls.tolerant:
            facts.append(".tolerant = true")
        if base_form.named_type:
            facts.append(".writes_namespaces = true")
        if cls.end_checks_minimums:
            facts.append(".minimums_at_end = true")
        if cls.attributes_when_nil:
            facts.append(".attributes_when_nil = true")
        rows = self.child_rows(cls)
        facts += [f".needed_{what} = frame::needed(frame::rows_of<{name}>::{what})"
                  for what, some in (("attributes", attributes), ("rows", rows)) if some]
        if rows:
            facts.append(f".mandatory_rows = frame::mandatory_among(frame::rows_of<{name}>::rows)")
        if attributes:
            lines.append(f"static constexpr lmx::s_event_map {name}_attribute_events[] = "
                         f"{{{self.event_rows([a.name for a in attributes], '1')}}};")
            facts.append(f".attribute_count = {len(attributes)}")
        if rows:
            facts.append(f".row_count = {len(rows)}")
        if cls.group:
            facts.append(f".member_count = {len(cls.group)}")
        if attributes:
            facts.append(f".attributes = frame::rows_of<{name}>::attributes")
        if rows:
            facts.append(f".rows = frame::rows_of<{name}>::rows")
        if cls.group:
            members = ", ".join(f"{{&element_{g.element}, {self.type_pointer(g.type_class)}}}" for g in cls.group)
            lines.append(f"static constexpr frame::group_member {name}_members[] = {{{members}}};")
            lines.append(self.member_index(cls))
            facts += [f".members = {name}_members", f".index = &{name}_index"]
        if attributes:
            facts.append(f".attribute_events = {name}_attribute_events")
        lines += self.element_events(cls, rows, facts)
        if cls.nillable:
            facts.append(f".nil = frame::rows_of<{name}>::nil")
        if cls.form in ("choice", "group"):
            facts.append(f".slot = frame::rows_of<{name}>::slot")
        facts.append(f'.item = "{vocabulary.item(cls)}"' if cls.form != "group" else f'.item = "{name}"')
        if cls.polymorphic:
            facts.append(f".id = &{cls.base if cls.form == 'element' else name}::id")
        facts += [f".create = frame::create_object<{name}>", f".clone = frame::clone_object<{name}>",
                  f".destroy = frame::destroy_object<{name}>"]
        if cls.group:
            lines.append(self.group_calls(cls))
            facts.append(f".calls = &{name}_calls")
        return lines + [f"const class_rows {name}_rows = {{{', '.join(facts)}}};", ""]

    def element_events(self, cls: ModelClass, rows: list[str], facts: list[str]) -> list[str]:
        name = cls.name
        if cls.group:
            names, first = [g.element for g in cls.group], None
        elif cls.options:
            names, first = [o.name for o in cls.options], None
        elif self.vocabulary.body(cls) or not rows:
            return []
        else:
            members = self.vocabulary.all_members(cls)
            named = [member for member in members if member.kind not in ("group", "any")]
            names = [member.name for member in named]
            first = [sum(1 for each in members[:i] if each in named) for i in range(len(members) + 1)]
        facts.append(f".element_events = {name}_element_events")
        lines = [f"static constexpr lmx::s_event_map {name}_element_events[] = "
                 f"{{{self.event_rows(names, 'frame::format_namespace_id')}}};"]
        if first is not None:
            lines.append(f"static constexpr std::uint8_t {name}_first_event[] = {{{', '.join(map(str, first))}}};")
            facts.append(f".first_event = {name}_first_event")
        return lines

    @staticmethod
    def member_index(cls: ModelClass) -> str:
        """Places of two characters, from the end, and a factor that give each member's name a hash of its own."""
        names = [entry.element for entry in cls.group]
        shortest, size = min(map(len, names)), 128
        for first, second, factor in itertools.product(range(shortest), range(shortest), range(1, 64)):
            slots = {(len(name) + ord(name[-1 - first]) + ord(name[-1 - second]) * factor) % size: number
                     for number, name in enumerate(names)}
            if len(slots) == len(names):
                row = ", ".join(str(slots.get(i, 255)) for i in range(size))
                return (f"static constexpr frame::member_index {cls.name}_index = "
                        f"{{{first}, {second}, {factor}, {{{row}}}}};")
        raise SchemaError(f"{cls.name}: no two characters tell its members apart")

    def group_calls(self, cls: ModelClass) -> str:
        root = self.vocabulary.classes[cls.group[0].type_class].root
        head = any(entry.needs_xsi_type for entry in cls.group)
        return f"static constexpr frame::group_calls {cls.name}_calls = frame::calls_of<{root}, {str(head).lower()}>;"
