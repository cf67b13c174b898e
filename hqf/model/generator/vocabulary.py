"""Makes the classes of typed_model.py from the schema that xsd.py has read, by these rules:

- A complex type is a class of its name; an anonymous one takes its element's name or the name of the fact `class`.
- A global element of a named type is an element class that derives from the type's class. So is a nillable local
  element of a named type. A nillable element of a simple type is a class of simple content.
- A reference to the head of a substitution group is a member of the class sg_ of that head. The members of the group
  stand in the order of their elements. A head that is abstract lies outside; any other is the first member, and its
  abstract type means that a document names a derived type by xsi:type.
- Types that extend each other are a polymorphic hierarchy. Each class in it with classes below it has a factory, which
  knows the types of its branch but not the root.
- A class without mandatory content accepts an element without any content; others do so by the fact `tolerant`.
- xs:int, xs:unsignedInt and xs:unsignedByte have the bounds of their range where no facet narrows it.
"""

from __future__ import annotations

from dataclasses import replace
from decimal import Decimal, InvalidOperation
from pathlib import Path

from typed_model import Attribute, Body, GroupMember, Member, ModelClass, Option, SimpleType, Vocabulary
from xsd import AttributeUse, Complex, GlobalElement, Node, Particle, Schema, SchemaError, Simple, read_schema

KINDS = {
    # built-in type: (kind, whitespace, implied minimum, implied maximum)
    "xs:string": ("string", "preserve", None, None),
    "xs:token": ("string", "collapse", None, None),
    "xs:double": ("double", "collapse", None, None),
    "xs:int": ("int", "collapse", "-2147483648", "2147483647"),
    "xs:unsignedInt": ("unsigned int", "collapse", "0", "4294967295"),
    "xs:unsignedByte": ("unsigned char", "collapse", "0", "255"),
    "xs:boolean": ("bool", "collapse", None, None),
    "xs:dateTime": ("datetime", "collapse", None, None),
    "xs:base64Binary": ("binary", "collapse", None, None),
}

INTEGER_KINDS = ("int", "unsigned int", "unsigned char")

FACETS_OF = {
    "string": ("minLength", "maxLength"),
    "double": ("minInclusive", "minExclusive", "maxInclusive", "maxExclusive"),
    **{kind: ("minInclusive", "minExclusive", "maxInclusive", "maxExclusive") for kind in INTEGER_KINDS},
    "bool": (),
    "datetime": ("pattern",),
    "binary": (),
}


def load(path: str | Path) -> Vocabulary:
    """Reads the schema file and builds the vocabulary. Raises SchemaError."""
    return _Builder(read_schema(path)).vocabulary()


class _Builder:
    def __init__(self, schema: Schema) -> None:
        self.schema = schema
        self.classes: dict[str, ModelClass] = {}
        self.nodes: dict[str, Node] = {}
        self.simple_types = {name: self._simple_type(simple) for name, simple in schema.simples.items()}
        self.used_types: set[str] = set()
        self.heads = list(dict.fromkeys(element.group for element in schema.elements.values() if element.group))
        for complex_type in schema.complexes.values():
            self._type_class(complex_type, complex_type.name, None)
        for element in schema.elements.values():
            self._element_class(element)
        for head in self.heads:
            self._group_class(head)
        self._check_names()
        self._hierarchies()
        self._tolerance()

    def vocabulary(self) -> Vocabulary:
        return Vocabulary(self._ordered(), self.schema.namespace, self.schema.prefix, self.schema.version)

    def _add(self, node: Node, cls: ModelClass) -> ModelClass:
        if cls.name in self.classes:
            raise node.fail(f"a second class {cls.name}: an anonymous type takes another name by the fact class")
        if not cls.part:
            raise node.fail("stands in no part: an annotation above must carry the fact part")
        self.classes[cls.name], self.nodes[cls.name] = cls, node
        return cls

    def _qualified(self, name: str) -> str:
        return f"{self.schema.prefix}:{name}"

    # Simple types

    def _simple_type(self, simple: Simple) -> SimpleType:
        built_in = self._built_in(simple.base)
        kind = built_in.kind
        allowed = FACETS_OF[kind]
        for facet, value in simple.facets.items():
            if facet not in allowed:
                raise simple.node.fail(f"the facet {facet} is not understood on {simple.base}")
            if facet != "pattern":
                self._check_number(simple.node, value, whole=kind != "double")
        if simple.literals and (kind != "string" or built_in.whitespace != "preserve" or simple.facets):
            raise simple.node.fail("literals are understood on xs:string alone, without other facets")
        result = replace(built_in, name=simple.name, doc=simple.doc, literals=simple.literals,
                         pattern=simple.facets.get("pattern"), min_length=self._length(simple, "minLength"),
                         max_length=self._length(simple, "maxLength"))
        for bound, place in (("minimum", 0), ("maximum", 1)):
            given = [(facet, value) for facet, value in simple.facets.items()
                     if facet in (bound[:3] + "Inclusive", bound[:3] + "Exclusive")]
            if len(given) > 1:
                raise simple.node.fail(f"two facets for the {bound}")
            for facet, value in given:
                implied = tuple(is_implied and i != place for i, is_implied in enumerate(result.implied_bounds))
                result = replace(result, **{bound: value, bound + "_exclusive": facet.endswith("Exclusive")},
                                 implied_bounds=implied)
        return result

    @staticmethod
    def _built_in(name: str) -> SimpleType:
        kind, whitespace, minimum, maximum = KINDS[name]
        integer = kind in INTEGER_KINDS
        return SimpleType(name, kind, whitespace, minimum, maximum=maximum, implied_bounds=(integer, integer),
                          bounds_tested_as_text=integer, base64=kind == "binary")

    @staticmethod
    def _length(simple: Simple, facet: str) -> int | None:
        return int(simple.facets[facet]) if facet in simple.facets else None

    @staticmethod
    def _check_number(node: Node, text: str, whole: bool) -> None:
        try:
            number = Decimal(text)
        except InvalidOperation:
            raise node.fail(f"{text} is no number") from None
        if not number.is_finite() or whole and number != number.to_integral_value():
            raise node.fail(f"{text} is no bound or length that is understood")

    def _find_simple(self, node: Node, name: str) -> SimpleType:
        if name in KINDS:
            return self._built_in(name)
        self.used_types.add(name)
        if name not in self.simple_types:
            raise node.fail(f"{name} is no simple type")
        return self.simple_types[name]

    # Classes

    def _type_class(self, source: Complex, name: str, element: str | None) -> ModelClass:
        """The class of a complex type; `element` is the element that an anonymous type belongs to."""
        form = source.content
        if form == "sequence" and any(particle.wildcard for particle in source.particles):
            form = "any"
        cls = self._add(source.node, ModelClass(name, form, source.base, part=source.part or "", doc=source.doc))
        local = element is not None or "local" in source.facts
        if local:
            cls.element = self._qualified(element or name)
        cls.named_type = not local
        cls.abstract = source.abstract
        cls.tolerant = "tolerant" in source.facts
        cls.end_checks_minimums = "minimums-at-end" in source.facts
        cls.attributes = [self._attribute(attribute) for attribute in source.attributes]
        if form == "simple":
            type_ = self._find_simple(source.node, source.body_type)
            cls.body = Body(type_, "optional-body" in source.facts, source.body_doc)
        elif "optional-body" in source.facts:
            raise source.node.fail("only simple content can have an optional body")
        if form == "choice":
            cls.options = [self._option(particle) for particle in source.particles]
        else:
            cls.members = [self._member(particle, cls.part) for particle in source.particles]
        if cls.end_checks_minimums and not any(member.repeating and member.minimum for member in cls.members):
            raise source.node.fail("no repeating minimum that could be checked at the end")
        return cls

    def _attribute(self, source: AttributeUse) -> Attribute:
        type_ = self._find_simple(source.node, source.type)
        if source.default is not None and source.default not in type_.literals:
            raise source.node.fail("a default is understood for literals alone")
        return Attribute(source.name, type_, source.required, source.default, source.doc)

    def _anonymous(self, source: Particle, part: str) -> str | None:
        """Makes the class of a child's anonymous type, or of a nillable child, and gives its name."""
        if source.anonymous:
            name = source.anonymous.facts.get("class", source.name)
            cls = self._type_class(source.anonymous, name, source.name)
            cls.nillable = source.nillable
        elif source.nillable:
            name, element = source.name, self._qualified(source.name)
            if source.type in self.schema.complexes:
                cls = ModelClass(name, "element", source.type, element, doc=source.doc, part=part)
            else:
                cls = ModelClass(name, "simple", None, element, doc=source.doc, part=part)
                cls.body = Body(self._find_simple(source.node, source.type), False, source.doc)
            cls.nillable, cls.attributes_when_nil = True, "attributes-when-nil" in source.facts
            self._add(source.node, cls)
        else:
            return None
        return name

    def _child(self, source: Particle, part: str) -> tuple[str, SimpleType | None, str | None]:
        """Kind, simple type and class name of a child or option."""
        if source.wildcard:
            return "any", None, None
        if source.reference:
            if source.name not in self.schema.elements:
                raise source.node.fail(f"{source.name} is no global element")
            if source.name in self.heads:
                return "group", None, "sg_" + source.name
            if self.schema.elements[source.name].abstract:
                raise source.node.fail("an abstract element needs a substitution group")
            return "complex", None, source.name
        own = self._anonymous(source, part)
        if own:
            return "complex", None, own
        if source.type in self.schema.complexes:
            local = self.schema.complexes[source.type].facts.get("local")
            if local is not None and (source.name != source.type or source.type in self.used_types):
                raise source.node.fail(f"{source.type} is the type of one element of its name and of no other")
            self.used_types.add(source.type)
            return "complex", None, source.type
        return "simple", self._find_simple(source.node, source.type), None

    def _member(self, source: Particle, part: str) -> Member:
        kind, type_, class_name = self._child(source, part)
        facts = source.facts
        if "setter-skips-minimum" in facts:
            type_ = self._without_minimum(source, type_)
        if "by-pointer" in facts and (source.repeating or not class_name):
            raise source.node.fail("only a single child with a class can be held by pointer")
        written = "always-written" in facts
        if written and (source.minimum or source.repeating):
            raise source.node.fail("only an optional child can be written always")
        if "attributes-when-nil" in facts and not source.nillable:
            raise source.node.fail("this child is never nil")
        code = facts.get("unread-code")
        if code is not None and (kind != "simple" or not code.isdigit()):
            raise source.node.fail("only a simple child has a code, a number, for a text that can't be read")
        return Member(source.name or "any", kind, type_, class_name, source.minimum, source.repeating,
                      by_pointer="by-pointer" in facts, counts_for_occurs=not written,
                      has_isset=not source.minimum and not source.repeating and not written, always_written=written,
                      simple_type_error=int(code) if code else None, doc=source.doc)

    def _option(self, source: Particle) -> Option:
        if source.reference or source.anonymous:
            raise source.node.fail("an option has a named type")
        _, type_, class_name = self._child(source, part="")
        if "setter-skips-minimum" in source.facts:
            type_ = self._without_minimum(source, type_)
        return Option(source.name, type_, class_name, source.doc)

    @staticmethod
    def _without_minimum(source: Particle, type_: SimpleType | None) -> SimpleType:
        if type_ is None or type_.minimum is None or source.repeating:
            raise source.node.fail("there is no minimum that the setter could leave out")
        return replace(type_, setter_checks_minimum=False)

    def _element_class(self, source: GlobalElement) -> None:
        if source.anonymous:
            cls = self._type_class(source.anonymous, source.name, source.name)
            cls.named_type, cls.doc = True, cls.doc or source.doc
        elif source.type in self.schema.complexes:
            doc = source.doc or self.schema.complexes[source.type].doc
            cls = self._add(source.node, ModelClass(source.name, "element", source.type, doc=doc,
                                                    part=source.part or ""))
        else:
            raise source.node.fail(f"{source.type} is no complex type")
        cls.element, cls.global_element = self._qualified(source.name), True
        cls.nillable, cls.document = source.nillable, "document" in source.facts
        cls.has_entry_points = not source.abstract and "no-entry-points" not in source.facts

    def _group_class(self, head: str) -> None:
        if head not in self.schema.elements:
            raise SchemaError(f"a substitution group of {head}, which is no global element")
        source = self.schema.elements[head]
        if source.type is None:
            raise source.node.fail("the head of a substitution group needs a named type")
        type_abstract = self.schema.complexes[source.type].abstract
        if not type_abstract or source.group:
            raise source.node.fail("the head of a substitution group has an abstract type and is in no other group")
        cls = self._add(source.node, ModelClass("sg_" + head, "group", part=source.part or "", doc=source.doc))
        if not source.abstract:
            cls.group.append(GroupMember(head, source.type, head, True))
        for element in self.schema.elements.values():
            if element.group == head:
                if element.abstract or element.type not in self.schema.complexes:
                    raise element.node.fail("a member of a substitution group has a named type and isn't abstract")
                if source.type not in self._bases(element.type):
                    raise element.node.fail(f"its type doesn't extend {source.type}")
                cls.group.append(GroupMember(element.name, element.type, element.name, False))

    # What only the whole schema tells

    def _bases(self, name: str) -> list[str]:
        """A class's bases, the nearest first."""
        bases: list[str] = []
        while (base := self.classes[name].base) is not None:
            if base not in self.classes or base in bases:
                raise self.nodes[name].fail(f"{base} is no type that can be a base")
            bases.append(base)
            name = base
        return bases

    def _check_names(self) -> None:
        for name, cls in self.classes.items():
            self._bases(name)
            own = [member.name for member in cls.members] + [attribute.name for attribute in cls.attributes]
            inherited = [member.name for base in self._bases(name)
                         for member in [*self.classes[base].members, *self.classes[base].attributes]]
            if len(set(own)) != len(own) or set(own) & set(inherited):
                raise self.nodes[name].fail("two members of one name")
        bases = {cls.base for cls in self.classes.values()}
        for declared in [*self.schema.simples.values(), *self.schema.complexes.values()]:
            if declared.name not in self.used_types and declared.name not in bases:
                raise declared.node.fail("a type that nothing uses")
        if sum(cls.document for cls in self.classes.values()) != 1:
            raise SchemaError("one global element must carry the fact document")

    def _hierarchies(self) -> None:
        extended = {source.base for source in self.schema.complexes.values() if source.base}
        roots = {name for name in extended if self.classes[name].base is None}
        for name, cls in self.classes.items():
            cls.root = next((each for each in [name, *self._bases(name)] if each in roots), None)
            cls.polymorphic = cls.root is not None
            if name in extended:
                self.classes[name].factory_names = [
                    each for each in self._branch(name) if each != cls.root]

    def _branch(self, name: str) -> list[str]:
        """A type and the types below it, each followed by its own branch; groups keep their members' order."""
        below = [source.name for source in self.schema.complexes.values() if source.base == name]
        return [name] + [each for child in below for each in self._branch(child)]

    def _tolerance(self) -> None:
        for name, cls in self.classes.items():
            if cls.form not in ("sequence", "any"):
                continue
            lineage = [self.classes[each] for each in [name, *self._bases(name)]]
            mandatory = any(member.minimum for each in lineage for member in each.members)
            if cls.tolerant and not mandatory:
                raise self.nodes[name].fail("tolerant without the fact, since nothing in it is mandatory")
            cls.tolerant = cls.tolerant or not mandatory
        for cls in self.classes.values():
            if cls.form == "element":
                cls.tolerant = self.classes[cls.base].tolerant

    def _ordered(self) -> dict[str, ModelClass]:
        result: dict[str, ModelClass] = {}
        pending: list[str] = []

        def visit(name: str) -> None:
            if name in result:
                return
            if name in pending:
                raise self.nodes[name].fail("contains itself by value: " + " in ".join(pending))
            pending.append(name)
            cls = self.classes[name]
            by_value = [member.class_name for member in cls.members
                        if member.class_name and not member.repeating and not member.by_pointer]
            for needed in [*([cls.base] if cls.base else []), *by_value]:
                visit(needed)
            result[pending.pop()] = cls

        for name in self.classes:
            visit(name)
        return result
