"""Reads hqf-v2.xsd: the few constructs of XML Schema that the vocabulary is written in, and the generator's facts.

Strict on purpose. Whatever stands in the schema and isn't understood here would otherwise be missing from the
classes without anyone noticing, so each attribute, element, facet, type and fact that this file doesn't know ends
in a SchemaError with file and line. What the declarations mean for the classes is the business of vocabulary.py.
"""

from __future__ import annotations

from dataclasses import dataclass, field
from pathlib import Path
from xml.parsers import expat

XS = "http://www.w3.org/2001/XMLSchema"
GENERATOR = "http://hqf.example/generator"

BUILT_IN_TYPES = ("string", "token", "double", "int", "unsignedInt", "unsignedByte", "boolean", "dateTime",
                  "base64Binary")

FACETS = ("minInclusive", "minExclusive", "maxInclusive", "maxExclusive", "minLength", "maxLength", "pattern",
          "enumeration")

FACTS = {
    # name: (where it may stand, whether it has a text)
    "part": (("section",), True),
    "document": (("global element",), False),
    "no-entry-points": (("global element",), False),
    "class": (("anonymous type",), True),
    "local": (("named type",), False),
    "tolerant": (("named type", "anonymous type"), False),
    "optional-body": (("named type", "anonymous type"), False),
    "minimums-at-end": (("named type", "anonymous type"), False),
    "by-pointer": (("child",), False),
    "always-written": (("child",), False),
    "attributes-when-nil": (("child",), False),
    "unread-code": (("child",), True),
    "setter-skips-minimum": (("child", "option"), False),
}
"""The facts; the schema's own first annotation tells what each means."""


class SchemaError(Exception):
    """The schema says something that the generator doesn't understand, or contradicts itself."""


@dataclass
class Node:
    """One XML element with its line, because the standard library's trees keep none."""

    file: str
    line: int
    namespace: str
    name: str
    attributes: dict[str, str]
    children: list[Node] = field(default_factory=list)
    text: str = ""

    def fail(self, message: str) -> SchemaError:
        label = " ".join([self.name] + [f'{key}="{value}"' for key, value in self.attributes.items()][:2])
        return SchemaError(f"{self.file}:{self.line}: <{label}>: {message}")


@dataclass
class Simple:
    """A named simple type: a restriction of a built-in type."""

    node: Node
    name: str
    base: str
    facets: dict[str, str]
    literals: tuple[str, ...]
    doc: str


@dataclass
class AttributeUse:
    node: Node
    name: str
    type: str
    required: bool
    default: str | None
    doc: str


@dataclass
class Particle:
    """A child element or an option: declared here (`type` or `anonymous`) or a reference to a global element.

    A wildcard has an empty name and no type.
    """

    node: Node
    name: str
    type: str | None
    anonymous: Complex | None
    reference: bool
    minimum: int
    repeating: bool
    nillable: bool
    facts: dict[str, str]
    doc: str

    @property
    def wildcard(self) -> bool:
        return not self.name


@dataclass
class Complex:
    """A complex type. `content` is 'sequence', 'choice' or 'simple'; `base` a complex type that it extends."""

    node: Node
    name: str | None
    abstract: bool
    facts: dict[str, str]
    doc: str
    part: str | None
    content: str = "sequence"
    base: str | None = None
    body_type: str | None = None
    body_doc: str = ""
    particles: list[Particle] = field(default_factory=list)
    attributes: list[AttributeUse] = field(default_factory=list)


@dataclass
class GlobalElement:
    node: Node
    name: str
    type: str | None
    anonymous: Complex | None
    abstract: bool
    nillable: bool
    group: str | None
    facts: dict[str, str]
    doc: str
    part: str | None


@dataclass
class Schema:
    """The declarations, each kind in the order of the file. Types of XML Schema itself are named with "xs:"."""

    namespace: str
    prefix: str
    version: str
    simples: dict[str, Simple] = field(default_factory=dict)
    complexes: dict[str, Complex] = field(default_factory=dict)
    elements: dict[str, GlobalElement] = field(default_factory=dict)


def read_schema(path: str | Path) -> Schema:
    """Reads a schema file. Raises SchemaError for all that it doesn't know."""
    return _Reader(*_parse(Path(path))).schema


def _parse(path: Path) -> tuple[Node, dict[str, str]]:
    """The document's root, and the prefixes that it declares."""
    parser = expat.ParserCreate(namespace_separator="}")
    open_nodes: list[Node] = []
    roots: list[Node] = []
    prefixes: dict[str, str] = {}

    def start(name: str, attributes: dict[str, str]) -> None:
        namespace, _, local = name.rpartition("}")
        node = Node(path.name, parser.CurrentLineNumber, namespace, local, attributes)
        (open_nodes[-1].children if open_nodes else roots).append(node)
        open_nodes.append(node)

    def end(_name: str) -> None:
        node = open_nodes.pop()
        if node.children and node.text.strip():
            raise node.fail("text between elements")

    def text(data: str) -> None:
        open_nodes[-1].text += data

    def declare(prefix: str | None, uri: str) -> None:
        if open_nodes:
            raise open_nodes[-1].fail(f"the prefix {prefix} is declared below the root")
        prefixes[prefix or ""] = uri

    def doctype(*_: object) -> None:
        raise SchemaError(f"{path.name}:{parser.CurrentLineNumber}: a document type declaration")

    parser.StartElementHandler, parser.EndElementHandler, parser.CharacterDataHandler = start, end, text
    parser.StartNamespaceDeclHandler, parser.StartDoctypeDeclHandler = declare, doctype
    try:
        parser.Parse(path.read_bytes(), True)
    except expat.ExpatError as error:
        raise SchemaError(f"{path.name}: {error}") from error
    return roots[0], prefixes


class _Reader:
    def __init__(self, root: Node, prefixes: dict[str, str]) -> None:
        self.prefixes = prefixes
        self.part: str | None = None
        if (root.namespace, root.name) != (XS, "schema"):
            raise root.fail("not an XML Schema")
        self._attributes(root, "targetNamespace", "elementFormDefault", "attributeFormDefault", "version")
        forms = (root.attributes.get("elementFormDefault"), root.attributes.get("attributeFormDefault"))
        if forms != ("qualified", "unqualified"):
            raise root.fail("elements must be qualified and attributes unqualified")
        namespace = root.attributes.get("targetNamespace", "")
        prefix = next((key for key, uri in prefixes.items() if uri == namespace and key), None)
        if prefix is None or "version" not in root.attributes:
            raise root.fail("needs a targetNamespace with a prefix, and a version")
        self.schema = Schema(namespace, prefix, root.attributes["version"])
        for node in root.children:
            self._top_level(node)

    def _top_level(self, node: Node) -> None:
        kind = self._kind(node)
        if kind == "annotation":
            self.part = self._annotation(node, "section")[0].get("part")
        elif kind == "simpleType":
            self._add(self.schema.simples, self._simple(node))
        elif kind == "complexType":
            self._add(self.schema.complexes, self._complex(node, "named type"))
        elif kind == "element":
            self._add(self.schema.elements, self._global_element(node))
        else:
            raise node.fail("not understood here")

    @staticmethod
    def _add(table: dict, item: Simple | Complex | GlobalElement) -> None:
        if item.name in table:
            raise item.node.fail("declared twice")
        table[item.name] = item

    @staticmethod
    def _kind(node: Node) -> str:
        return node.name if node.namespace == XS else ""

    @staticmethod
    def _attributes(node: Node, *allowed: str) -> None:
        for name in node.attributes:
            if name not in allowed:
                raise node.fail(f"the attribute {name} is not understood")

    @staticmethod
    def _flag(node: Node, name: str) -> bool:
        value = node.attributes.get(name, "false")
        if value not in ("true", "false"):
            raise node.fail(f"{name} must be true or false")
        return value == "true"

    @staticmethod
    def _name(node: Node) -> str:
        if not node.attributes.get("name"):
            raise node.fail("needs a name")
        return node.attributes["name"]

    def _qualified(self, node: Node, value: str) -> str:
        """A QName of an attribute as "xs:name" or, for the schema's own, the bare name."""
        prefix, colon, name = value.rpartition(":")
        uri = self.prefixes.get(prefix)
        if uri == XS and name in BUILT_IN_TYPES:
            return "xs:" + name
        if uri == self.schema.namespace and colon:
            return name
        raise node.fail(f"{value} is no type or element that is understood")

    def _split(self, node: Node, place: str) -> tuple[dict[str, str], str, list[Node]]:
        """The facts and the documentation of a declaration, and its children behind the annotation."""
        if node.text.strip():
            raise node.fail("text in a declaration")
        children = list(node.children)
        facts, doc = {}, ""
        if children and self._kind(children[0]) == "annotation":
            facts, doc = self._annotation(children.pop(0), place)
        return facts, doc, children

    def _annotation(self, node: Node, place: str) -> tuple[dict[str, str], str]:
        self._attributes(node)
        facts: dict[str, str] = {}
        docs = []
        for child in node.children:
            self._attributes(child)
            if self._kind(child) == "appinfo":
                for fact in child.children:
                    self._fact(fact, place, facts)
            elif self._kind(child) == "documentation" and not child.children:
                docs.append(" ".join(child.text.split()))
            else:
                raise child.fail("not understood in an annotation")
        return facts, " ".join(docs)

    def _fact(self, node: Node, place: str, facts: dict[str, str]) -> None:
        if node.namespace != GENERATOR or node.name not in FACTS:
            raise node.fail("a fact that the generator doesn't know")
        places, has_text = FACTS[node.name]
        text = node.text.strip()
        if place not in places:
            raise node.fail(f"this fact can't be about a {place}")
        if node.attributes or node.children or bool(text) != has_text:
            raise node.fail("this fact needs a text and nothing else" if has_text else "this fact stands empty")
        if node.name in facts:
            raise node.fail("the fact is given twice")
        facts[node.name] = text

    def _simple(self, node: Node) -> Simple:
        self._attributes(node, "name")
        _, doc, children = self._split(node, "simple type")
        if len(children) != 1 or self._kind(children[0]) != "restriction":
            raise node.fail("only a restriction is understood")
        restriction = children[0]
        self._attributes(restriction, "base")
        base = self._qualified(restriction, restriction.attributes.get("base", ""))
        if not base.startswith("xs:"):
            raise restriction.fail("only a built-in type can be restricted")
        facets: dict[str, str] = {}
        literals: list[str] = []
        for facet in restriction.children:
            kind = self._kind(facet)
            self._attributes(facet, "value")
            if kind not in FACETS or "value" not in facet.attributes or facet.children:
                raise facet.fail("a facet that is not understood")
            value = facet.attributes["value"]
            if kind in facets or value in literals:
                raise facet.fail("the facet is given twice")
            if kind == "enumeration":
                literals.append(value)
            else:
                facets[kind] = value
        return Simple(node, self._name(node), base, facets, tuple(literals), doc)

    def _complex(self, node: Node, place: str) -> Complex:
        self._attributes(node, *(("name", "abstract") if place == "named type" else ()))
        facts, doc, children = self._split(node, place)
        name = self._name(node) if place == "named type" else None
        result = Complex(node, name, self._flag(node, "abstract"), facts, doc, self.part)
        if children and self._kind(children[0]) in ("complexContent", "simpleContent"):
            if len(children) != 1 or len(children[0].children) != 1:
                raise node.fail("one content with one extension is understood")
            self._attributes(children[0])
            self._extension(children[0].children[0], self._kind(children[0]) == "simpleContent", result)
        else:
            self._content(node, children, result)
        return result

    def _extension(self, node: Node, simple: bool, result: Complex) -> None:
        if self._kind(node) != "extension":
            raise node.fail("only an extension is understood")
        self._attributes(node, "base")
        base = self._qualified(node, node.attributes.get("base", ""))
        _, doc, children = self._split(node, "extension")
        if simple:
            result.content, result.body_type, result.body_doc = "simple", base, doc
            if any(self._kind(child) != "attribute" for child in children):
                raise node.fail("simple content has attributes alone")
        else:
            result.base = base
        self._content(node, children, result)

    def _content(self, node: Node, children: list[Node], result: Complex) -> None:
        """The compositor, if any, and the attributes behind it."""
        if children and self._kind(children[0]) in ("sequence", "choice"):
            compositor = children.pop(0)
            self._attributes(compositor)
            result.content = self._kind(compositor)
            if result.content == "choice" and result.base:
                raise compositor.fail("a choice can't extend a type")
            place = "option" if result.content == "choice" else "child"
            result.particles = [self._particle(child, place) for child in compositor.children]
            if not result.particles or len(result.particles) > 1 and any(p.wildcard for p in result.particles):
                raise compositor.fail("a compositor has children, and a wildcard stands alone")
        for child in children:
            if self._kind(child) != "attribute":
                raise child.fail(f"not understood in {node.name}")
            result.attributes.append(self._attribute(child))
        for names in ([p.name for p in result.particles], [a.name for a in result.attributes]):
            if len(set(names)) != len(names):
                raise node.fail("two members of one name")

    def _attribute(self, node: Node) -> AttributeUse:
        self._attributes(node, "name", "type", "use", "default")
        _, doc, children = self._split(node, "attribute")
        use = node.attributes.get("use", "optional")
        default = node.attributes.get("default")
        if children or use not in ("required", "optional") or (use == "required" and default is not None):
            raise node.fail("an attribute has a type and is required, optional or has a default")
        type_name = self._qualified(node, node.attributes.get("type", ""))
        return AttributeUse(node, self._name(node), type_name, use == "required", default, doc)

    def _particle(self, node: Node, place: str) -> Particle:
        if self._kind(node) == "any" and place == "child":
            wildcard = {"namespace": "##any", "processContents": "skip", "maxOccurs": "unbounded"}
            facts, doc, children = self._split(node, "wildcard")
            if node.attributes != wildcard or children:
                raise node.fail("only a wildcard for one or more elements of any kind is understood")
            return Particle(node, "", None, None, False, 1, True, False, facts, doc)
        if self._kind(node) != "element":
            raise node.fail("not understood in a compositor")
        occurrence = ("minOccurs", "maxOccurs", "nillable") if place == "child" else ()
        reference = "ref" in node.attributes
        self._attributes(node, *occurrence, *(("ref",) if reference else ("name", "type")))
        facts, doc, anonymous = self._declared(node, place)
        minimum, maximum = node.attributes.get("minOccurs", "1"), node.attributes.get("maxOccurs", "1")
        if minimum not in ("0", "1") or maximum not in ("1", "unbounded"):
            raise node.fail("occurs 0 or 1 to 1 or unbounded times, and no others")
        type_name = self._qualified(node, node.attributes["type"]) if "type" in node.attributes else None
        if (type_name is not None) + (anonymous is not None) + reference != 1:
            raise node.fail("needs a type, an anonymous complex type or a reference, and one of them")
        name = self._qualified(node, node.attributes["ref"]) if reference else self._name(node)
        nillable = self._flag(node, "nillable")
        if reference and nillable:
            raise node.fail("a reference can't be nillable, the element that it names can")
        return Particle(node, name, type_name, anonymous, reference, int(minimum), maximum == "unbounded", nillable,
                        facts, doc)

    def _declared(self, node: Node, place: str) -> tuple[dict[str, str], str, Complex | None]:
        facts, doc, children = self._split(node, place)
        if len(children) > 1 or children and self._kind(children[0]) != "complexType":
            raise node.fail("only one anonymous complex type is understood here")
        return facts, doc, self._complex(children[0], "anonymous type") if children else None

    def _global_element(self, node: Node) -> GlobalElement:
        self._attributes(node, "name", "type", "abstract", "nillable", "substitutionGroup")
        facts, doc, anonymous = self._declared(node, "global element")
        type_name = self._qualified(node, node.attributes["type"]) if "type" in node.attributes else None
        if (type_name is None) == (anonymous is None):
            raise node.fail("needs a type or an anonymous complex type")
        head = node.attributes.get("substitutionGroup")
        return GlobalElement(node, self._name(node), type_name, anonymous, self._flag(node, "abstract"),
                             self._flag(node, "nillable"), self._qualified(node, head) if head else None, facts, doc,
                             self.part)
