"""Writes the generated corpus: for every class of the schema, documents that break each of its rules by the smallest
step, with the code and item that a load must report and what a write must then give. The same for the setters.

    corpus.py SCHEMA CORPUS SETTERS ENTRIES

Nothing here runs the library. An expectation comes from the schema and from the reader's rules, which stand below in
Corpus.body and in the families. A case is a record of corpus.h, which corpus_test.cpp runs; SETTERS and
ENTRIES are lists of macro calls for setters_test.cpp and entries_test.cpp.
"""

from __future__ import annotations

import math
import pathlib
import sys
from dataclasses import dataclass, field, replace

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "hqf" / "model" / "generator"))
sys.dont_write_bytecode = True

import vocabulary  # noqa: E402

DECLARATION = '<?xml version="1.0" encoding="UTF-8"?>\n'
XSI = "http://www.w3.org/2001/XMLSchema-instance"
FOREIGN = '<x xmlns="urn:foreign"/>'
UNKNOWN = "Unknown"
SAME, ANY = "=", "-"
RECORD, UNIT = "\x1e", "\x1f"  # no XML document can hold them

# Texts by kind, each with why it can't be read. All give code 35.
MALFORMED = {
    "double": ["", "1e", "1,5", "abc", ".", "+INF", "-NaN", "inf", "0x10", "1 2"],
    "bool": ["", "TRUE", "yes", "2"],
    "datetime": ["", "yesterday", "2024-05-01", "2024-05-01T9:00:00Z", "2024-05-01T09:00:00+01"],
    "binary": ["A", "=", "QUJ", "Q===", "QQ=a", "Q-JD"],
} | dict.fromkeys(("int", "unsigned int", "unsigned char"), ["", "1.0", "1e2", "+", "--5", "abc"])
# Other spellings of sound values, none as the writer has them.
SPELLINGS = {
    "bool": ["1", "0", " true ", "false"],
    "datetime": ["2024-05-01T09:00:00+01:00", " 2024-05-01T09:00:00.250Z ", "2024-02-30T10:00:00Z"],
    "binary": ["", " QU JD ", "QQ==", "QUI="],
} | dict.fromkeys(("int", "unsigned int", "unsigned char"), [" 5 ", "+5", "0005", "+0000000000000000000000005"])


@dataclass
class Element:
    name: str
    attributes: list = field(default_factory=list)
    content: object = None
    """a text, a list of elements, or None for an element without a body"""
    inner: str = ""
    """raw XML behind the text"""
    end: str = ""
    """the end tag's name, where it is another one"""


def escaped(text):
    for plain, reference in (("&", "&amp;"), ("<", "&lt;"), ('"', "&quot;"), ("'", "&apos;")):
        text = text.replace(plain, reference)
    return text


def render(element, depth):
    """The element as the writer lays it out; a text in place of an element stands as it is."""
    tabs = "\t" * depth
    if isinstance(element, str):
        return tabs + element + "\n"
    name = "Hqf:" + element.name
    start = tabs + "<" + name + "".join(f' {key}="{escaped(text)}"' for key, text in element.attributes)
    end = f"</Hqf:{element.end or element.name}>\n"
    if element.content is None:
        return start + "/>\n"
    if isinstance(element.content, str):
        return start + ">" + escaped(element.content) + element.inner + end
    return start + ">\n" + "".join(render(child, depth + 1) for child in element.content) + tabs + end


def value(type_):
    """A sound value, as the writer spells it."""
    if type_.literals:
        return type_.literals[0]
    if type_.kind == "double":
        low, high = (None if bound is None else float(bound) for bound in (type_.minimum, type_.maximum))
        middle = 1.5 if low is None else low + 1 if high is None else (low + high) / 2
        return f"{middle:.14g}" if middle else "0.0"
    return {"string": "x", "bool": "true", "datetime": "2024-05-01T09:00:30Z", "binary": "AAEC"}.get(type_.kind, "5")


class Corpus:
    def __init__(self, words):
        self.words = words
        self.classes = words.classes
        self.records = []
        self.groups = {}
        self.parents = self._parents()

    def _parents(self):
        """For each class that a document can hold: the class above it and the child or option that leads to it."""
        root = next(cls for cls in self.classes.values() if cls.document)
        parents = {root.name: (root.element.split(":")[1], None, None)}
        waiting = [root]
        while waiting:
            cls = waiting.pop(0)
            for place in [*self.words.all_members(cls), *cls.options]:
                if not place.class_name:
                    continue
                group = self.classes[place.class_name].group
                entries = [(g.type_class, g.element) for g in group if not g.needs_xsi_type]
                for name, element in entries if group else [(place.class_name, place.name)]:
                    if name not in parents:
                        parents[name] = (element, cls, place)
                        waiting.append(self.classes[name])
        return parents

    # Instances

    def child(self, place):
        """A smallest element for a member or an option; of a group the member with the shortest text."""
        if place.type:
            return Element(place.name, [], value(place.type))
        if not place.class_name:
            return FOREIGN
        cls = self.classes[place.class_name]
        if not cls.group:
            return self.instance(cls, place.name)
        if cls.name not in self.groups:
            found = [self.instance(self.classes[g.type_class], g.element) for g in cls.group if not g.needs_xsi_type]
            self.groups[cls.name] = min(found, key=lambda element: len(render(element, 0)))
        return replace(self.groups[cls.name])

    def parts(self, cls, full=False, wanted=None):
        """The children as (member, elements): what must be there, and all else or the wanted member."""
        return [(m, [self.child(m) for _ in range(2 if full and m.repeating else 1)])
                for m in self.words.all_members(cls) if full or m.minimum or m.always_written or m is wanted]

    def instance(self, cls, name, full=False, parts=None, content=None, wanted=None):
        attributes = [(a.name, value(a.type)) for a in self.words.all_attributes(cls)
                      if full or a.required or a.default or a is wanted]
        if cls.document:
            attributes += self.declarations()
        if content is None:
            if body := self.words.body(cls):
                content = value(body.type)
            elif cls.options:
                content = [self.child(cls.options[0])]
            else:
                parts = self.parts(cls, full) if parts is None else parts
                content = [element for _, elements in parts for element in elements]
        return Element(name, attributes, content)

    def around(self, cls):
        """What stands before and behind an element of the class in a smallest document, and its depth."""
        element, mark = "\x00", cls
        while self.parents[mark.name][1]:
            name, above, place = self.parents[mark.name]
            if above.options:
                element = self.instance(above, self.parents[above.name][0], content=[element])
            else:
                parts = [(m, [element] if m is place else found) for m, found in self.parts(above, wanted=place)]
                element = self.instance(above, self.parents[above.name][0], parts=parts)
            mark = above
        text = DECLARATION + render(element, 0)
        before = text[:text.index("\x00")].rstrip("\t")
        depth = text.index("\x00") - len(before)
        return before, text[text.index("\x00") + 2:], depth

    # Expectations

    def takes(self, member):
        group = self.classes[member.class_name].group if member.kind == "group" else None
        return {entry.element for entry in group} if group else {member.name}

    def body(self, cls, name, children):
        """Code, item and code of writing for children of these names, each sound in itself.

        Children are taken in schema order. A mandatory one that isn't next is missing (21). What nobody took is found
        at the end tag (10). A group that must occur once takes whatever element is next.
        """
        members = self.words.all_members(cls)
        if not children:
            return (0, ANY, "46" if any(m.minimum for m in members) else "0") if cls.tolerant else (32, q(name), ANY)
        if cls.form == "any":
            return 0, ANY, "0"
        ahead, incomplete, missing_at_end = list(children), False, False
        for member in members:
            takes = self.takes(member)
            if member.kind == "group" and member.minimum and not member.repeating:
                if not ahead:
                    return 10, ANY, ANY
                incomplete |= ahead.pop(0) not in takes
            elif ahead and ahead[0] in takes:
                ahead.pop(0)
                while member.repeating and ahead and ahead[0] in takes:
                    ahead.pop(0)
            elif member.minimum and member.kind != "group":
                return 21, q(member.name), ANY
            else:
                missing_at_end |= bool(member.minimum)
                incomplete |= member.always_written
        if missing_at_end:
            return 21, self.words.item(cls), ANY
        return (10, q(name), ANY) if ahead else (0, ANY, "46" if incomplete else "0")

    # Cases

    def case(self, family, what, element, code=0, item=ANY, write="0", written=SAME):
        """`written` is the element as it must be written, or ANY where only the code counts."""
        if not code and write == "0" and isinstance(written, Element):
            written = self.before + render(written, self.depth) + self.behind
        document = self.before + render(element, self.depth) + self.behind
        fields = (family, f"{self.cls.name}: {what}", str(code), item, ANY if code else write,
                  document, written if not code and write == "0" else ANY)
        self.records.append(UNIT.join(fields))

    def order(self, family, what, children, written=ANY):
        names = [child.name if isinstance(child, Element) else "x" for child in children]
        code, item, write = self.body(self.cls, self.name, names)
        self.case(family, what, self.instance(self.cls, self.name, content=children), code, item, write, written)

    def run(self):
        for name, (element, _, _) in self.parents.items():
            self.cls, self.name = self.classes[name], element
            self.before, self.behind, self.depth = self.around(self.cls)
            sound, full = (self.instance(self.cls, element, full) for full in (False, True))
            self.case("sound", "smallest", sound)
            self.case("sound", "with everything", full)
            self.attributes(sound, full)
            self.end_tags(sound, full)
            if self.cls.nillable:
                self.nil(sound, full)
            if self.cls.options:
                self.choice(sound)
            elif not self.words.body(self.cls):
                self.sequence()
            for place in self.places():
                self.values(*place)
        self.before, self.behind, self.depth = DECLARATION, "", 0
        for self.cls in entry_classes(self.words):
            name = self.cls.element.split(":")[1]
            element = self.instance(self.cls, name)
            if not self.cls.document:
                element.attributes = [*self.declarations(), *element.attributes]
                # entries_test.cpp loads it as what it is.
                self.case("entry", "root", element, 16, q(name))
        return RECORD.join(self.records)

    def declarations(self):
        return [("xmlns:Hqf", self.words.namespace_uri), ("xmlns:xsi", XSI)]

    def attributes(self, sound, full):
        owner = self.cls.base if self.cls.form == "element" else self.cls.name
        for attribute in self.words.all_attributes(self.cls):
            others = [pair for pair in full.attributes if pair[0] != attribute.name]
            gone = (25, owner) if attribute.required else (0, ANY)
            self.case("attribute missing", attribute.name, replace(full, attributes=others), *gone,
                      written=full if attribute.default else SAME)
            once = (attribute.name, value(attribute.type))
            self.case("attribute twice", attribute.name, replace(full, attributes=full.attributes + [once]), 3, once[0])
            prefixed = ("Hqf:" + attribute.name, once[1])
            self.case("attribute unknown", prefixed[0], replace(full, attributes=others + [once, prefixed]), 39,
                      q(self.name))
        for key, known in (("unknown", False), ("xsi:schemaLocation", True), ("xsi:type", True), ("xsi:nil", True)):
            if key == "xsi:nil" and self.cls.nillable:
                continue
            text = "true" if key == "xsi:nil" else "Hqf:FunctionDEType"
            expected = (0, ANY) if known else (39, q(self.name))
            self.case("attribute of xsi" if known else "attribute unknown", key,
                      replace(sound, attributes=sound.attributes + [(key, text)]), *expected, written=sound)

    def end_tags(self, sound, full):
        self.case("end tag", "wrong", replace(sound, end="Wrong"), *((10, q(self.name)) if sound.content else (0, ANY)),
                  written=ANY)
        if full.content is not sound.content:
            self.case("end tag", "wrong behind everything", replace(full, end="Wrong"), 10, q(self.name))
        if self.words.body(self.cls):
            self.case("child in a value", "body", replace(sound, inner="<Hqf:Inner/>"), 10, q(self.name))
            return
        empty = self.instance(self.cls, self.name, content=[])
        code, item, write = (32, q(self.name), ANY) if self.cls.options else self.body(self.cls, self.name, [])
        for element in (replace(empty, content=None), empty):
            self.case("empty", "/>" if element.content is None else "start and end tag", element, code, item, write,
                      written=empty)
        for place in [*self.words.all_members(self.cls), *self.cls.options]:
            if place.type:
                code = getattr(place, "simple_type_error", None) or 10
                good = self.child(place)
                for inner in (replace(good, inner="<!-- -->"),
                              Element(place.name, [], "", f"<![CDATA[{good.content}]]>")):
                    self.case("markup in a value", place.name, self.with_child(place, inner),
                              written=self.with_child(place, good))
                for family, bad in (("end tag", replace(good, end="Wrong")),
                                    ("child in a value", replace(good, inner="<Hqf:Inner/>"))):
                    self.case(family, place.name, self.with_child(place, bad), code, q(place.name))
                self.case("attribute of a value", place.name,
                          self.with_child(place, replace(good, attributes=[("unknown", "x"), ("xsi:nil", "true")])),
                          written=self.with_child(place, good))

    def nil(self, sound, full):
        def with_nil(element, text, content=None):
            return replace(element, attributes=element.attributes + [("xsi:nil", text)], content=content)

        bare = Element(self.name, [("xsi:nil", "true")])
        kept = with_nil(full, "true") if self.cls.attributes_when_nil else bare
        for what, element, written in (
                ("true", bare, SAME), ("with attributes", with_nil(full, "true"), kept),
                ("1", with_nil(sound, "1"), bare), ("blanks around", with_nil(sound, " true "), bare),
                ("start and end tag", with_nil(sound, "true", ""), bare),
                ("false", with_nil(sound, "false", sound.content), sound),
                ("other letters are false", with_nil(sound, "TRUE", sound.content), sound)):
            self.case("nil", what, element, written=written)
        self.case("nil", "with content", with_nil(sound, "true", sound.content), 10, q(self.name))

    def choice(self, sound):
        for option in self.cls.options:
            good = self.child(option)
            self.case("choice", option.name, replace(sound, content=[good]))
            for other in self.cls.options:
                self.case("choice", f"{option.name} and {other.name}",
                          replace(sound, content=[good, self.child(other)]), 10, q(self.name))
            self.case("choice", f"{option.name} and an unknown one",
                      replace(sound, content=[good, Element(UNKNOWN)]), 10, q(self.name))
        for child, item in ((Element(UNKNOWN), q(UNKNOWN)), (FOREIGN, "x")):
            self.case("choice", "unknown " + item, replace(sound, content=[child]), 31, item)

    def sequence(self):
        for full in (False, True):
            parts = self.parts(self.cls, full)
            every = [element for _, elements in parts for element in elements]
            kind = "of everything" if full else "of the smallest"
            at = 0
            for i, (member, elements) in enumerate(parts):
                before, behind = every[:at], every[at + len(elements):]
                at += len(elements)
                if member.minimum or member.always_written:
                    self.order("missing", f"{member.name} {kind}", before + behind)
                    self.order("missing", f"{member.name} {kind} and all behind it", before)
                self.order("twice", f"{member.name} {kind}", before + elements * 2 + behind, SAME)
                if behind:
                    following = parts[i + 1][1]
                    self.order("swapped", f"{member.name} {kind} with the next",
                               before + following + elements + behind[len(following):])
                for other in (Element(UNKNOWN), FOREIGN):
                    self.order("unknown child", f"before {member.name} {kind}", before + [other] + elements + behind)
            for other in (Element(UNKNOWN), Element(UNKNOWN, [], "text"), FOREIGN):
                self.order("unknown child", f"at the end {kind}", every + [other])
            # No element names stand in for a group's own.
            for member, elements in parts:
                if member.kind == "group":
                    heads = [Element(member.name) if element is elements[0] and not self.head(member) else element
                             for element in every]
                    self.order("group", f"{member.name} by its own name {kind}", heads)
        for member in self.words.all_members(self.cls):
            if member.kind == "group":
                self.group(member)
        if self.cls.form == "any":
            self.case("wildcard", "text", self.instance(self.cls, self.name, content="text"), 21, "Hqf:")
            self.case("wildcard", "nested", self.instance(
                self.cls, self.name, content=[f'<a b="1" c=\'2\'>x &amp; <!-- -->y{FOREIGN}</a>', "<Hqf:Wild/>"]),
                written=self.instance(self.cls, self.name, content=[f'<a b="1" c=\'2\'>x &amp; y{FOREIGN}</a>',
                                                                    "<Hqf:Wild/>"]))

    def head(self, member):
        return next((entry for entry in self.classes[member.class_name].group if entry.needs_xsi_type), None)

    def group(self, member):
        def holding(element):
            parts = [(m, [element] if m is member else found) for m, found in self.parts(self.cls, wanted=member)]
            return self.instance(self.cls, self.name, parts=parts)

        for entry in self.classes[member.class_name].group:
            if not entry.needs_xsi_type:
                element = self.instance(self.classes[entry.type_class], entry.element)
                self.case("group", f"{member.name} as {entry.element}", holding(element))
        head = self.head(member)
        if not head:
            return
        for type_name in self.classes[head.type_class].factory_names:
            element = self.instance(self.classes[type_name], head.element)
            typed = replace(element, attributes=[*element.attributes, ("xsi:type", "Hqf:" + type_name)])
            self.case("group", f"{head.element} of {type_name}", holding(typed))
        for why, attributes in (("no type", []), ("its own type", [("xsi:type", "Hqf:" + head.type_class)]),
                                ("unknown type", [("xsi:type", "Hqf:Unknown")]),
                                ("element's name", [("xsi:type", "Hqf:FunctionDE")]),
                                ("no namespace", [("xsi:type", "FunctionDEType")]),
                                ("another namespace", [("xsi:type", "xsi:FunctionDEType")]),
                                ("no xsi", [("type", "Hqf:FunctionDEType")])):
            self.case("group", f"{head.element} with {why}", holding(Element(head.element, attributes, [])), 44)

    # Values

    def with_child(self, place, element):
        if self.cls.options:
            return self.instance(self.cls, self.name, content=[element])
        parts = [(m, [element] if m is place else found) for m, found in self.parts(self.cls, wanted=place)]
        return self.instance(self.cls, self.name, parts=parts)

    def places(self):
        """All that holds a value: name, type, item of a report, and a function that gives an element with a text."""
        def attribute_setter(attribute):
            element = self.instance(self.cls, self.name, wanted=attribute)
            return lambda text: replace(element, attributes=[
                (key, text if key == attribute.name else old) for key, old in element.attributes])

        def child_setter(place):
            return lambda text: self.with_child(place, Element(place.name, [], text))

        for attribute in self.words.all_attributes(self.cls):
            yield attribute.name, attribute.type, attribute.name, attribute_setter(attribute)
        for place in [*self.words.all_members(self.cls), *self.cls.options]:
            if place.type:
                yield place.name, place.type, q(place.name), child_setter(place)
        if body := self.words.body(self.cls):
            yield "body", body.type, q(self.name), lambda text: self.instance(self.cls, self.name, content=text)

    def values(self, label, type_, item, element):
        def check(family, text, code=0, written=ANY):
            what = f"{label} '{text if len(text) < 60 else str(len(text)) + ' characters'}'"
            if written not in (SAME, ANY):
                written = element(written)
            self.case(family, what, element(text), code, item if code else ANY, written=written)

        if type_.literals:
            for literal in type_.literals:
                check("literal", literal, written=SAME)
            first = type_.literals[0]
            for wrong in ("", first + " ", " " + first, first.lower(), first[:-1], first + "x", "Unheard_Of"):
                check("wrong text", wrong, 38)
        elif type_.kind == "string":
            self.strings(check, type_)
        else:
            for text in MALFORMED[type_.kind]:
                check("malformed", text, 35)
            for text in SPELLINGS.get(type_.kind, [f" {value(type_)} "]):
                check("spelling", text)
            if type_.pattern:
                check("no zone", "2024-05-01T09:00:00", 22)
                check("no zone", " 2024-05-01T09:00:00.5 ", 22)
            if type_.kind == "double":
                self.double_bounds(check, type_)
            elif type_.kind in ("int", "unsigned int", "unsigned char"):
                self.integer_bounds(check, type_)

    @staticmethod
    def strings(check, type_):
        collapses = type_.whitespace == "collapse"
        check("length", "", 20 if type_.min_length else 0, SAME)
        check("length", "   ", (20 if collapses and type_.min_length else 0) or (19 if type_.max_length else 0),
              "" if collapses else SAME)
        for one in ("x", "\u00e9", "\u20ac", "\U0001d11e"):
            check("length", one, written=SAME)
            check("length", one * 2, 19 if type_.max_length else 0, SAME)
        if not type_.max_length:
            check("length", "x" * 5000, written=SAME)
            check("spelling", " a < b & \"c\"  'd' ", 0, "a < b & \"c\" 'd'" if collapses else SAME)

    @staticmethod
    def double_bounds(check, type_):
        low, high = (None if bound is None else float(bound) for bound in (type_.minimum, type_.maximum))
        for bound, exclusive, outward, code in ((low, type_.minimum_exclusive, -math.inf, 37),
                                                (high, type_.maximum_exclusive, math.inf, 36)):
            if bound is not None:
                check("bound", f"{bound:.17g}", code if exclusive else 0)
                check("bound", repr(math.nextafter(bound, outward)), code)
                check("bound", repr(math.nextafter(bound, -outward)))
        check("bound", "NaN", 0 if low is None else 37)
        check("bound", "-INF", 0 if low is None else 37)
        check("bound", "INF", 0 if high is None else 36)

    @staticmethod
    def integer_bounds(check, type_):
        low = int(type_.minimum) + type_.minimum_exclusive
        high = int(type_.maximum) - type_.maximum_exclusive
        for text, code in ((low, 0), (low - 1, 37), (high, 0), (high + 1, 36), (low - 2**32, 37), (high + 2**32, 36),
                           (-10**40, 37), (10**40, 36)):
            check("bound", str(text), code, SAME if not code else ANY)


def q(name):
    return "Hqf:" + name


def entry_classes(words):
    return [cls for cls in words.classes.values() if cls.has_entry_points]


def entries(words):
    """ENTRY(class, code of writing a new object)."""
    def code(cls):
        mandatory = [a.required for a in words.all_attributes(cls)] + [m.minimum for m in words.all_members(cls)]
        return 46 if any(mandatory) else 0

    return "".join(f"ENTRY({cls.name}, {code(cls)})\n" for cls in entry_classes(words))


def setters(words):
    """SET(class, member, sound value, value, code) and ENUM(class, member, number, literal, count of literals)."""
    rows = []
    for cls in words.classes.values():
        single = [m for m in cls.members if m.type and not m.repeating]
        places = [(place.name, place.type) for place in [*cls.attributes, *single, *cls.options] if place.type]
        for name, type_ in places + ([(cls.name, cls.body.type)] if cls.body else []):
            values = [*setter_values(type_)]
            good = next(text for text, code in values if not code) if values else None
            rows += [f"SET({cls.name}, {name}, {good}, {text}, {code})" for text, code in values]
            rows += [f'ENUM({cls.name}, {name}, {number}, L"{text}", {len(type_.literals)})'
                     for number, text in enumerate(type_.literals, 1)]
    return "\n".join(rows) + "\n"


def setter_values(type_):
    """Values in C++ and their codes. Unlike the reader, a setter counts wide units and may leave out the minimum."""
    if type_.literals:
        first = type_.literals[0]
        yield from [(f'L"{first}"', 0), ('L""', 38), (f'L" {first}"', 38), (f'L"{first.lower()}"', 38)]
    elif type_.kind == "string":
        one_unit, two_units = 'L"\\x20AC"', 'L"\\xD834\\xDD1E"'
        yield from [(one_unit, 0), ('L""', 20 if type_.min_length else 0), (two_units, 19 if type_.max_length else 0)]
    elif type_.kind == "double":
        low = 0 if type_.minimum is None else 37
        yield from [(value(type_), 0), ("nan", low), ("-infinity", low), ("infinity", 36 if type_.maximum else 0)]
        if type_.minimum == "0":
            yield "-0.0", 37 if type_.minimum_exclusive else 0
        for bound, exclusive, outward, code in (
                (type_.minimum, type_.minimum_exclusive, -math.inf, 37),
                (type_.maximum, type_.maximum_exclusive, math.inf, 36)):
            if bound is not None:
                yield repr(float(bound)), code if exclusive else 0
                yield repr(math.nextafter(float(bound), outward)), code
                yield repr(math.nextafter(float(bound), -outward)), 0
    elif type_.kind in ("unsigned int", "unsigned char"):
        low, high = int(type_.minimum) + type_.minimum_exclusive, int(type_.maximum)
        below = 37 if type_.setter_checks_minimum else 0
        yield from [(f"{low}.0", 0), (f"{low - 1}.0", below), (f"{high}.0", 0), (f"{high + 1}.0", 36)]
    elif type_.kind == "int":
        yield from [("5", 0), ("std::numeric_limits<int>::min()", 0), ("std::numeric_limits<int>::max()", 0)]
    elif type_.kind == "bool":
        yield from [("true", 0), ("false", 0)]


def main():
    words = vocabulary.load(sys.argv[1])
    for path, text in zip(sys.argv[2:], (Corpus(words).run(), setters(words), entries(words))):
        pathlib.Path(path).write_text(text, encoding="utf-8", newline="\n")


if __name__ == "__main__":
    main()
