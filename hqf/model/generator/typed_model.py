"""The vocabulary as the emitters see it: classes with typed members, in an order in which C++ can define them.

vocabulary.py makes it from the schema and tells by which rules; nothing here knows of XML Schema.
"""

from __future__ import annotations

from dataclasses import dataclass, field


@dataclass(frozen=True)
class SimpleType:
    """A value's type with its facets. `name` is the schema's ("from0To1", "xs:string"), one for each set of facets."""

    name: str
    kind: str
    """'string', 'double', 'int', 'unsigned int', 'unsigned char', 'bool', 'datetime' or 'binary' (Base64)"""
    whitespace: str
    """'preserve' or 'collapse'"""
    minimum: str | None = None
    minimum_exclusive: bool = False
    maximum: str | None = None
    maximum_exclusive: bool = False
    implied_bounds: tuple[bool, bool] = (False, False)
    """whether minimum and maximum are the range of the integer type and not facets"""
    setter_checks_minimum: bool = True
    bounds_tested_as_text: bool = False
    """integers: the reader tests the text as a big integer, before it converts"""
    min_length: int | None = None
    max_length: int | None = None
    pattern: str | None = None
    literals: tuple[str, ...] = ()
    base64: bool = False
    doc: str = ""


@dataclass
class Attribute:
    name: str
    type: SimpleType
    required: bool
    default: str | None
    doc: str


@dataclass
class Member:
    """A child element. `name` is the element's local name and the stem of the accessors."""

    name: str
    kind: str
    """'simple', 'complex', 'group' or 'any'"""
    type: SimpleType | None
    class_name: str | None
    minimum: int
    repeating: bool
    by_pointer: bool
    counts_for_occurs: bool
    has_isset: bool
    always_written: bool
    simple_type_error: int | None
    """the code that is reported in place of the one that reading a simple element gave"""
    doc: str


@dataclass
class Body:
    """Simple content. An optional body has isset_ and unset_, and no occurrence test asks for it."""

    type: SimpleType
    optional: bool
    doc: str


@dataclass
class Option:
    """An option of a choice; its number is its place in the list."""

    name: str
    type: SimpleType | None
    class_name: str | None
    doc: str


@dataclass
class GroupMember:
    """A member of a substitution group; its number is its place in the list."""

    element: str
    type_class: str
    element_class: str
    needs_xsi_type: bool


@dataclass
class ModelClass:
    name: str
    form: str
    """'sequence', 'choice', 'simple', 'any', 'element' (derives from a type, adds at most a nil flag) or 'group'"""
    base: str | None = None
    element: str | None = None
    """the qualified name of the one element that the class stands for; a named type has none"""
    attributes: list[Attribute] = field(default_factory=list)
    members: list[Member] = field(default_factory=list)
    body: Body | None = None
    options: list[Option] = field(default_factory=list)
    group: list[GroupMember] = field(default_factory=list)
    nillable: bool = False
    attributes_when_nil: bool = False
    tolerant: bool = False
    named_type: bool = False
    """can start a document: a named type, or a global element with a type of its own; both namespace steps"""
    global_element: bool = False
    has_entry_points: bool = False
    document: bool = False
    """the root class: stamped when it is made, load and write operations by hand"""
    polymorphic: bool = False
    root: str | None = None
    """the root class of a polymorphic class's hierarchy"""
    abstract: bool = False
    """no document holds this type itself; the class can be constructed all the same"""
    factory_names: list[str] = field(default_factory=list)
    end_checks_minimums: bool = False
    doc: str = ""
    part: str = ""

    def has_own_members(self) -> bool:
        return self.form not in ("element", "group") or self.nillable


@dataclass
class Vocabulary:
    """`classes` has a base, and the class of a member held by value, before the class that needs it."""

    classes: dict[str, ModelClass]
    namespace_uri: str
    prefix: str
    version: str

    def lineage(self, cls: ModelClass) -> list[ModelClass]:
        """The class and its bases, the root first."""
        return (self.lineage(self.classes[cls.base]) if cls.base else []) + [cls]

    def all_members(self, cls: ModelClass) -> list[Member]:
        return [member for each in self.lineage(cls) for member in each.members]

    def all_attributes(self, cls: ModelClass) -> list[Attribute]:
        return [attribute for each in self.lineage(cls) for attribute in each.attributes]

    def body(self, cls: ModelClass) -> Body | None:
        return next((each.body for each in self.lineage(cls) if each.body), None)

    def item(self, cls: ModelClass) -> str:
        """The name of a class in a report about the class as a whole, such as "Hqf:ColorType"."""
        return cls.element or f"{self.prefix}:{cls.name}"

    def classes_in_documents(self) -> list[ModelClass]:
        """The classes whose objects a document makes, from the root down, without the sg_ classes."""
        found: dict[str, ModelClass] = {}
        waiting = [cls.name for cls in self.classes.values() if cls.document]
        while waiting:
            cls = self.classes[waiting.pop()]
            if cls.name in found:
                continue
            found[cls.name] = cls
            for child in [*self.all_members(cls), *cls.options]:
                if child.class_name:
                    group = self.classes[child.class_name].group
                    names = [entry.type_class for entry in group if not entry.needs_xsi_type]
                    waiting += names if group else [child.class_name]
        return list(found.values())

    def counts(self) -> dict[str, int]:
        """The size of the vocabulary.

        The first rows count classes. The others count what can stand in a document, each place of use apart: a class
        counts with its bases' members, and a specification held nillable and not nillable counts twice. Child
        elements are those with a name of their own in that place, and the wildcard; groups count by their members.
        """
        all_classes = list(self.classes.values())
        used = self.classes_in_documents()
        members = [member for cls in used for member in self.all_members(cls)]
        children = [member for member in members if member.kind != "group"]
        attributes = [attribute for cls in used for attribute in self.all_attributes(cls)]
        options = [option for cls in used for option in cls.options]
        bodies = [body for body in map(self.body, used) if body]
        types = [place.type for place in [*children, *attributes, *options, *bodies] if place.type]
        groups = [self.classes[member.class_name].group for member in members if member.kind == "group"]
        nilled = [member for member in children if member.class_name and self.classes[member.class_name].nillable]
        return {
            "classes": len(all_classes),
            "with members": sum(cls.has_own_members() for cls in all_classes),
            "element classes without members": sum(
                cls.form == "element" and not cls.nillable for cls in all_classes),
            "group classes": sum(cls.form == "group" for cls in all_classes),
            "with entry points": sum(cls.has_entry_points for cls in all_classes),
            "nillable classes": sum(cls.nillable for cls in all_classes),
            "tolerant classes": sum(cls.tolerant and cls.form != "element" for cls in all_classes),
            "child elements": len(children),
            "repeating child elements": sum(member.repeating for member in children),
            "attributes": len(attributes),
            "options": len(options),
            "group members": sum(len(group) for group in groups),
            "types by xsi:type": len({name for cls in all_classes for entry in cls.group if entry.needs_xsi_type
                                      for name in self.classes[entry.type_class].factory_names}),
            "nilled elements": len(nilled),
            "literals by place": sum(len(type_.literals) for type_ in types),
            "literals": sum(len(literals) for literals in {type_.name: type_.literals for type_ in types}.values()),
            "enumerations": len({type_.name for type_ in types if type_.literals}),
            "lower bounds": sum(type_.minimum is not None and not type_.implied_bounds[0] for type_ in types),
            "upper bounds": sum(type_.maximum is not None and not type_.implied_bounds[1] for type_ in types),
        }
