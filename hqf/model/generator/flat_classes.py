"""The exports of the model classes. What a class declares itself is exported for it; what it inherits is reached
through the export that gives its base, but for the operations that belong to every class (the life cycle, clone,
getid, has_id), which each class has under its own name.

The order is that of the class's header. An operation with several forms carries the number of the form among them;
get_X of a member with a class is the first of two.
"""

from __future__ import annotations

from cpp_names import enumerations
from emit_headers import enumerator
from flat_model import BOOL, CODE, NOTHING, UNSIGNED, Argument, Export, Result
from typed_model import ModelClass, SimpleType, Vocabulary

INDEX = Argument("index", "unsigned")

VALUE_KINDS = {
    "string": "wide", "double": "double", "int": "int", "unsigned int": "unsigned", "unsigned char": "byte",
    "bool": "bool",
}

VALUE_CLASSES = {"datetime": "lmx::tc_datetime", "binary": "lmx::tc_binary"}

OWNED = "The caller owns it and frees it with CSharp_delete_{}."
CHECKED = "Gives 0, or the code of the rule that the value breaks; then nothing is stored."


def class_exports(vocabulary: Vocabulary) -> list[Export]:
    exports = [export for cls in vocabulary.classes.values() for export in _Class(vocabulary, cls).exports()]
    return exports + _document_result()


def value_argument(type_: SimpleType) -> Argument:
    if type_.kind in VALUE_CLASSES:
        return Argument("value", "const_reference", VALUE_CLASSES[type_.kind])
    return Argument("value", VALUE_KINDS[type_.kind])


def value_result(type_: SimpleType) -> Result:
    if type_.kind in VALUE_CLASSES:
        return Result("object", VALUE_CLASSES[type_.kind])
    return Result(VALUE_KINDS[type_.kind])


class _Class:
    def __init__(self, vocabulary: Vocabulary, cls: ModelClass) -> None:
        self.vocabulary, self.cls = vocabulary, cls
        self.qualified = "hqf_v2::" + cls.name
        self.list: list[Export] = []

    def exports(self) -> list[Export]:
        cls = self.cls
        self.life_cycle()
        if cls.polymorphic:
            self.identity()
        for attribute in cls.attributes:
            self.value(attribute.name, attribute.type, attribute.doc, not attribute.required)
        if cls.body:
            self.value(cls.name, cls.body.type, cls.body.doc, cls.body.optional)
        if cls.nillable:
            self.accessor("isnil", cls.name, "nil", (), BOOL, "Whether the element is nil.")
            self.accessor("setnil", cls.name, "nil", (), NOTHING, "Makes the element nil; its values stay.")
        for member in cls.members:
            if member.kind == "any":
                self.wildcard(member.doc)
            elif member.repeating and member.type:
                self.values(member.name, member.type, member.doc)
            elif member.repeating:
                self.objects(member.name, member.class_name, member.doc)
            elif member.type:
                self.value(member.name, member.type, member.doc, not member.minimum)
            else:
                self.object(member.name, member.class_name, member.doc, member.has_isset, "object")
        if cls.form in ("choice", "group"):
            self.choice()
        self.entry_points()
        return self.list

    def add(self, name: str, shape: str, operation: str, arguments: tuple[Argument, ...], result: Result, doc: str,
            **accessor: str) -> None:
        if shape == "method":
            arguments = (Argument("self", "self", self.qualified), *arguments)
        self.list.append(Export(f"CSharp_{name}", "model", self.cls.part, self.qualified, shape, operation, arguments,
                                result, doc, **accessor))

    def method(self, operation: str, arguments: tuple[Argument, ...], result: Result, doc: str, suffix: str = "",
               **accessor: str) -> None:
        self.add(f"{self.cls.name}_{operation}{suffix}", "method", operation, arguments, result, doc, **accessor)

    def accessor(self, role: str, member: str, form: str, arguments: tuple[Argument, ...], result: Result, doc: str,
                 suffix: str = "") -> None:
        self.method(f"{role}_{member}", arguments, result, doc, suffix, role=role, member=member, form=form)

    # Every class

    def life_cycle(self) -> None:
        cls, name = self.cls, self.cls.name
        new = Result("object", self.qualified, owned=True)
        summary = cls.doc.split(". ")[0].rstrip(".") if cls.doc else name
        self.add(f"new_{name}__SWIG_0", "new", "", (), new, f"{summary}. A new object; null where memory is out. "
                 + OWNED.format(name))
        self.add(f"new_{name}__SWIG_1", "new", "", (Argument("other", "const_reference", self.qualified),), new,
                 "A deep copy. " + OWNED.format(name))
        self.add(f"delete_{name}", "delete", "", (Argument("self", "self", self.qualified),), NOTHING,
                 "Deletes the object; null is allowed.")
        if cls.base:
            self.add(f"{name}Upcast", "upcast", "", (Argument("self", "self", self.qualified),),
                     Result("object", "hqf_v2::" + cls.base), f"The same object as {cls.base}.")
        self.method("swap", (Argument("other", "reference", self.qualified),), NOTHING, "Exchanges all contents.")
        self.method("reset", (), NOTHING, "Back to the state of a new object.")
        self.method("is_occurs_ok", (), BOOL, "Whether nothing mandatory is missing.")

    def identity(self) -> None:
        cls, name = self.cls, self.cls.name
        type_class = cls if cls.form != "element" else self.vocabulary.classes[cls.base]
        self.method("clone", (), Result("object", "hqf_v2::" + type_class.name, owned=True),
                    "A deep copy of the object's own type class. " + OWNED.format(type_class.name))
        self.method("getid", (), Result("raw_text"), "The class identity, compared as a pointer; the library keeps it.")
        self.method("has_id", (Argument("identity", "narrow"),), BOOL,
                    "Whether it is the identity of the object's class or of a base, compared as a pointer.")
        if cls is not type_class:
            return
        self.add(f"{name}_id_get", "id_get", "id", (), Result("raw_text"),
                 "The identity of the class, compared as a pointer; the library keeps it.")
        self.add(f"{name}_id_set", "id_set", "id", (Argument("identity", "narrow_or_null"),), NOTHING,
                 "Makes a copy of the text the identity of the class, which then has none of those given before.")
        if cls.factory_names:
            self.add(f"{name}_factory", "static", "factory",
                     (Argument("namespace_id", "int"), Argument("type_name", "narrow")),
                     Result("object", self.qualified, owned=True),
                     "A new object of the type with this name in namespace 1000, else null. " + OWNED.format(name))

    # Members

    def value(self, name: str, type_: SimpleType, doc: str, optional: bool, form: str = "value") -> None:
        self.accessor("get", name, form, (), value_result(type_), doc)
        self.accessor("set", name, form, (value_argument(type_),), CODE, CHECKED if form == "value" else
                      "Chooses this option, then checks the value: gives 0, or the code of the rule that it breaks.")
        if optional:
            self.presence(name, form)
        self.enumeration(name, type_, form)

    def presence(self, name: str, form: str) -> None:
        self.accessor("isset", name, form, (), BOOL, f"Whether {name} is there.")
        self.accessor("unset", name, form, (), NOTHING, f"Takes {name} out of the document.")

    def enumeration(self, name: str, type_: SimpleType, form: str) -> None:
        if not type_.literals:
            return
        cls = f"{self.qualified}::Eenum_{name}"
        self.accessor("getenum", name, form, (), Result("enum", cls), "The number of its literal, 0 for none.")
        self.accessor("setenum", name, form, (Argument("number", "enum", cls),), BOOL,
                      "Stores the literal of a number; 0 for a number that has none.")

    def values(self, name: str, type_: SimpleType, doc: str) -> None:
        form, value = "values", value_argument(type_)
        self.accessor("get", name, form, (INDEX,), value_result(type_), f"{doc} The index must be below the size.")
        self.accessor("set", name, form, (INDEX, value), CODE,
                      "Replaces an item, or appends from the size on. Gives 0.")
        self.accessor("append", name, form, (value,), CODE, "Adds an item at the end. Gives 0.")
        self.accessor("insert", name, form, (INDEX, value), CODE,
                      "Inserts before an item, or appends from the size on. Gives 0.")
        self.list_tail(name, form)

    def objects(self, name: str, item: str, doc: str) -> None:
        form, result = "objects", Result("object", "hqf_v2::" + item)
        self.accessor("get", name, form, (INDEX,), result,
                      f"{doc} Appends default objects until the index is valid.", "__SWIG_0")
        self.accessor("assign", name, form, (INDEX, Argument("value", "const_reference", result.cls)), result,
                      "Copies into the item and gives it.")
        self.accessor("append", name, form, (), CODE, "Adds a default object at the end. Gives 0.")
        self.accessor("insert", name, form, (INDEX,), CODE,
                      "Inserts a default object before an item, or appends from the size on. Gives 0.")
        self.accessor("back", name, form, (), result, "The last item; the list must not be empty.")
        self.list_tail(name, form)

    def list_tail(self, name: str, form: str) -> None:
        self.accessor("delete", name, form, (INDEX,), NOTHING, "Deletes an item; the index must be below the size.")
        self.accessor("clear", name, form, (), NOTHING, "Deletes all items.")
        self.accessor("size", name, form, (), UNSIGNED, "The number of items.")

    def object(self, name: str, item: str, doc: str, has_isset: bool, form: str) -> None:
        result = Result("object", "hqf_v2::" + item)
        effect = "Marks it present." if form == "object" else "Chooses it."
        self.accessor("get", name, form, (), result, f"{doc} {effect}", "__SWIG_0")
        forms = [entry for entry in self.cls.group if entry.element == name and entry.needs_xsi_type]
        self.accessor("assign", name, form, (Argument("value", "const_reference", result.cls),), result,
                      "Copies into the object and gives it.", "__SWIG_0" if forms else "")
        if forms:
            self.accessor("assign", name, form, (Argument("object", "object", result.cls),), result,
                          "Takes over the object, of this class or one derived from it, and gives it.", "__SWIG_1")
        if has_isset:
            self.presence(name, form)

    def wildcard(self, doc: str) -> None:
        form, value = "wildcard", Argument("value", "narrow")
        texts = tuple(Argument(name, "narrow") for name in ("ns", "name", "value"))
        self.accessor("append", "any", form, (value,), CODE, f"{doc} Adds one at the end. Gives 0.")
        self.accessor("insert", "any", form, (INDEX, value), CODE,
                      "Inserts before an entry, or appends from the size on. Gives 0.")
        self.list_tail("any", form)
        self.accessor("get", "any", form, (INDEX, *texts), NOTHING,
                      f"Has no way to give anything back: see hqf_{self.cls.name}_any_value.")

    def choice(self) -> None:
        cls = self.cls
        self.method("getchosen", (), Result("enum", f"{self.qualified}::elmx_chosen"), "The number of what is chosen.")
        for option in cls.options:
            if option.type:
                self.value(option.name, option.type, option.doc, False, "option")
            else:
                self.object(option.name, option.class_name, option.doc, False, "option_object")
        for entry in cls.group:
            self.object(entry.element, entry.type_class, f"The member {entry.element}.", False, "option_object")

    def entry_points(self) -> None:
        if not self.cls.has_entry_points:
            return
        file_name = (Argument("file_name", "narrow"),)
        self.method("marshal", file_name, CODE, "Writes a document of this element to a file with this UTF-8 path.",
                    "__SWIG_0")
        self.method("unmarshal", file_name, CODE,
                    "Reads a document of this element from the file with this UTF-8 path.", "__SWIG_0")
        self.method("unmarshal", (Argument("buffer", "narrow"), Argument("size", "unsigned")), CODE,
                    "Reads a document of this element from memory.", "__SWIG_1")
        if self.cls.document:
            self.document()

    def document(self) -> None:
        for operation, argument, doc in (
                ("loadFile", "path", "Reads a document: an archive if the path ends in \".hqfz\", else XML."),
                ("loadString", "xml", "Reads a document from text."),
                ("writeFile", "path", "Writes XML to a path in \".hqf\", an archive to one in \".hqfz\".")):
            self.method(operation, (Argument(argument, "wide"),), CODE, doc)
        self.method("writeString", (), Result("object", "hqf_v2::XMLDocumentResult", owned=True),
                    "Writes the document to text. " + OWNED.format("XMLDocumentResult"))


def _document_result() -> list[Export]:
    name, qualified, part = "XMLDocumentResult", "hqf_v2::XMLDocumentResult", "document"
    self = Argument("self", "self", qualified)
    rows = (
        (f"new_{name}", "new", "", (Argument("text", "wide"), Argument("code", "code")),
         Result("object", qualified, owned=True), "A result of this text and code. " + OWNED.format(name)),
        (f"delete_{name}", "delete", "", (self,), NOTHING, "Deletes the object; null is allowed."),
        (f"{name}_getXmlDocument", "method", "getXmlDocument", (self,), Result("wide"), "The document's text."),
        (f"{name}_getElmxError", "method", "getElmxError", (self,), CODE, "The code of writing it."),
    )
    return [Export(f"CSharp_{export}", "model", part, qualified, shape, operation, arguments, result, doc)
            for export, shape, operation, arguments, result, doc in rows]


def enumerators(cls: ModelClass) -> list[tuple[str, list[tuple[str, int]]]]:
    """The enumerations of a class: the C++ name, and each enumerator's name and number."""
    result = [(f"Eenum_{name}", [(enumerator(cls, name, literal), number)
                                 for number, literal in enumerate(type_.literals, 1)])
              for name, type_ in enumerations(cls)]
    if cls.form in ("choice", "group"):
        names = [option.name for option in cls.options] or [entry.element for entry in cls.group]
        none = len(names) if cls.form == "choice" else len(names) + 1
        result.append(("elmx_chosen", [(f"chosen_{name}", number) for number, name in enumerate(names)]
                       + [("chosen_none", none)]))
    return result
