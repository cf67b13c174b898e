"""Emits a header for each class: its accessors with their rules as documentation, and its storage."""

from __future__ import annotations

import textwrap

from cpp_names import (NOTICE, argument_type, bounds_text, enumerations, identifier, is_virtual, made_on_first_use,
                       storage_type, value_type)
from vocabulary import Attribute, Body, Member, ModelClass, SimpleType, Vocabulary


def class_header(vocabulary: Vocabulary, cls: ModelClass) -> str:
    return _Header(vocabulary, cls).text()


def enumerator(cls: ModelClass, member: str, literal: str) -> str:
    """e_ and the literal; members that share their literals within one class are told apart by their names."""
    for name, type_ in enumerations(cls):
        if literal in type_.literals:
            return f"e_{identifier(literal)}" if name == member else f"e_{member}_{identifier(literal)}"
    raise KeyError(literal)


class _Header:
    def __init__(self, vocabulary: Vocabulary, cls: ModelClass) -> None:
        self.vocabulary, self.cls = vocabulary, cls
        self.lines: list[str] = []
        self.storage: list[str] = []
        self.forward: set[str] = set()

    # Text

    def add(self, line: str = "") -> None:
        self.lines.append(("    " + line) if line else "")

    def doc(self, text: str, indent: str = "    ") -> None:
        if text:
            self.lines += textwrap.wrap(" ".join(text.split()), 116 - len(indent), initial_indent=indent + "/// ",
                                        subsequent_indent=indent + "/// ", break_long_words=False,
                                        break_on_hyphens=False)

    def text(self) -> str:
        cls = self.cls
        self.class_body()
        includes = ["<string>"] + [f'"hqf/model/{name}.h"' for name in self.by_value()] + [
            '"hqf/errors/elmx_error.h"', '"hqf/frame/pool.h"', '"hqf/frame/storage.h"', '"hqf/platform/api.h"']
        used = "\n".join(self.lines)
        if cls.document:
            includes.append('"hqf/document/XMLDocumentResult.h"')
        if "lmx::c_datetime" in used:
            includes.append('"hqf/values/c_datetime.h"')
        if "lmx::c_binary" in used:
            includes.append('"hqf/values/c_binary.h"')
        if "c_any_info" in used:
            includes.append('"hqf/xml_in/c_any_info.h"')
        head = ["#pragma once", ""]
        head += [f"#include {name}" for name in includes[:1]] + [""]
        head += sorted(f"#include {name}" for name in includes[1:])
        head += ["", "namespace lmx {", "class c_xml_reader;", "class c_xml_writer;", "} // namespace lmx", "",
                 "namespace hqf_v2 {", ""]
        forward = sorted(self.forward - set(self.by_value()) - {cls.name})
        head += [f"class {name};" for name in forward] + ([""] if forward else [])
        tail = ["", "} // namespace hqf_v2", "", "namespace hqf {",
                "/// The same is set in both, and to the same values. NaN equals NaN, and -0.0 differs from 0.0.",
                f"HQF_API bool equal(const hqf_v2::{cls.name}& a, const hqf_v2::{cls.name}& b);",
                "} // namespace hqf", ""]
        return NOTICE + "\n".join(head + self.lines + tail)

    def by_value(self) -> list[str]:
        cls = self.cls
        names = [cls.base] if cls.base else []
        names += [m.class_name for m in cls.members if m.class_name and not m.repeating and not m.by_pointer]
        return list(dict.fromkeys(names))

    # The class

    def class_body(self) -> None:
        cls = self.cls
        self.doc(cls.doc, "")
        if cls.doc:
            self.lines.append("///")
        self.doc(self.ownership(), "")
        base = f" : public {cls.base or 'hqf::frame::pooled'}"
        self.lines += [f"class HQF_API {cls.name}{base} {{", "public:"]
        self.enumerations()
        self.life_cycle()
        for attribute in cls.attributes:
            self.attribute(attribute)
        if cls.body:
            self.body(cls.body)
        if cls.nillable:
            self.nil()
        for member in cls.members:
            self.member(member)
        if cls.form == "choice":
            self.choice()
        if cls.form == "group":
            self.group()
        self.marshalling()
        if self.lines[-1]:
            self.add()
        self.lines.append("private:")
        self.add("template <class model_class>")
        self.add("friend struct hqf::frame::rows_of;")
        if self.storage:
            self.add()
            for line in self.storage:
                self.add(line)
        self.lines.append("};")

    def ownership(self) -> str:
        if self.cls.form == "group":
            return ("Owns the object of the chosen member. A reference to it stays valid until another member is "
                    "chosen, or this object is reset, swapped or destroyed. One thread at a time.")
        if self.cls.form == "choice":
            return ("Exactly one option is chosen in a complete object. Choosing another destroys the one held before. "
                    "One thread at a time.")
        return ("Owns its children; a reference to one stays valid until the child is deleted or this object is reset, "
                "swapped or destroyed. One thread at a time.")

    def enumerations(self) -> None:
        cls = self.cls
        for name, type_ in enumerations(cls):
            self.add(f"/// Numbers of the literals of {name}; 0 stands for any other text.")
            self.add(f"enum Eenum_{name} : int {{")
            for number, literal in enumerate(type_.literals, 1):
                self.add(f"    {enumerator(cls, name, literal)} = {number}, ///< \"{literal}\"")
            self.add("};")
        if cls.form in ("choice", "group"):
            names = [o.name for o in cls.options] or [g.element for g in cls.group]
            none = len(names) if cls.form == "choice" else len(names) + 1
            self.add("/// What is chosen.")
            self.add("enum elmx_chosen : int {")
            for number, name in enumerate(names):
                self.add(f"    chosen_{name} = {number},")
            self.add(f"    chosen_none = {none}")
            self.add("};")
        if cls.form == "group":
            self.add("using is_substitution_group = void;")

    def life_cycle(self) -> None:
        cls, name = self.cls, self.cls.name
        if self.lines[-1] != "public:":
            self.add()
        if cls.document:
            self.doc("A document that holds the library's identity in ReadSDKInformation and nothing else.")
        elif cls.form in ("choice", "group"):
            self.doc("Nothing is chosen.")
        else:
            self.doc("Nothing is set.")
        self.add(f"{name}();")
        self.doc("A deep copy. Mandatory members count as set in it"
                 + ("; of a nil object it takes nothing but that." if cls.nillable else "."))
        self.add(f"{name}(const {name}& other);")
        if cls.has_entry_points:
            self.doc("Reads a document whose root is this element, as the matching unmarshal() does, and stores the "
                     "code in `*error`.")
            self.add(f"{name}(const char* file_name, lmx::elmx_error* error);")
            self.add(f"{name}(const char* buffer, unsigned int size, lmx::elmx_error* error);")
            self.add(f"{name}(const std::string& text, lmx::elmx_error* error);")
        self.doc("As a copy and a swap: a failure leaves this object as it was.")
        self.add(f"{name}& operator=(const {name}& other);")
        if is_virtual(cls):
            if cls.form != "element":
                self.doc(f"A new deep copy of the object's type class, which the caller owns.")
                self.add(f"virtual {name}* clone() const;" if not cls.base else f"{name}* clone() const override;")
            self.add(f"virtual ~{name}();" if not cls.base else f"~{name}() override;")
            if cls.form != "element":
                self.doc("The class identity: compare it as a pointer.")
                self.add("virtual const char* getid() const;" if not cls.base else "const char* getid() const override;")
                self.doc("Whether `identity` is that of this class or of one of its bases.")
                self.add("virtual bool has_id(const char* identity) const;" if not cls.base
                         else "bool has_id(const char* identity) const override;")
            if not cls.base:
                self.marshal_to_writer("virtual ", "")
                self.unmarshal_element("virtual ", "")
        else:
            self.add(f"virtual ~{name}();" if not cls.base else f"~{name}() override;")
        self.add(f"void swap({name}& other);")
        self.doc("Back to the state of a new object.")
        self.add("void reset();")
        self.doc("Whether the object can be written: " + self.completeness())
        self.add("bool is_occurs_ok() const;")
        if is_virtual(cls) and cls.form != "element":
            self.add()
            self.doc("The identity of the class, shared with its element class.")
            self.add("static const char* id;")
            if cls.factory_names:
                self.doc("A new object of the type with this local name in namespace 1000, which the caller owns; null "
                         "for any other name or namespace.")
                self.add(f"static {name}* factory(int namespace_id, const std::string& type_name);")

    def completeness(self) -> str:
        if self.cls.form in ("choice", "group"):
            return "something is chosen."
        text = "every mandatory member is set and every list has its minimum."
        return "it is nil, or " + text if self.cls.nillable else text

    # Members

    def attribute(self, attribute: Attribute) -> None:
        presence = "Mandatory attribute." if attribute.required else "Optional attribute."
        if attribute.default is not None:
            presence = f"Attribute with the default \"{attribute.default}\", always written."
        self.value_accessors(attribute.name, attribute.type, f"{attribute.doc} {presence}", not attribute.required)
        kind = "mandatory" if attribute.required else "optional"
        self.storage.append(f"hqf::frame::{kind}<{storage_type(attribute.type)}> {attribute.name}_;")

    def body(self, body: Body) -> None:
        name = self.cls.name
        presence = "Body, optional in the model; the reader asks for it." if body.optional else "Mandatory body."
        self.value_accessors(name, body.type, f"{body.doc} {presence}", body.optional)
        self.storage.append(f"hqf::frame::{'optional' if body.optional else 'mandatory'}<{storage_type(body.type)}> body_;")

    def nil(self) -> None:
        name = self.cls.name
        self.add()
        self.doc("Whether the element is nil: written with xsi:nil and without content, whatever it holds.")
        self.add(f"bool isnil_{name}() const;")
        self.doc("Makes it nil; the values stay.")
        self.add(f"void setnil_{name}();")
        self.storage.append("bool nil_ = false;")

    def value_accessors(self, name: str, type_: SimpleType, doc: str, optional: bool) -> None:
        self.add()
        rule = bounds_text(type_)
        self.doc(doc + (f" Value: {rule}." if rule else ""))
        self.add(f"{argument_type(type_)} get_{name}() const;")
        self.doc("Returns 0, or the code of the rule that the value breaks; then nothing is stored." if rule else "")
        self.add(f"lmx::elmx_error set_{name}({argument_type(type_)} value);")
        if optional:
            self.add(f"bool isset_{name}() const;")
            self.add(f"void unset_{name}();")
        self.enumeration_accessors(name, type_)

    def enumeration_accessors(self, name: str, type_: SimpleType) -> None:
        if type_.literals:
            self.doc("The number of the stored text, 0 when it is none of the literals.")
            self.add(f"Eenum_{name} getenum_{name}() const;")
            self.doc("Stores the literal of a number; false for any number that has none.")
            self.add(f"bool setenum_{name}(Eenum_{name} number);")

    def member(self, member: Member) -> None:
        self.add()
        name = member.name
        if member.kind == "any":
            return self.wildcard(member)
        count = ("One or more." if member.minimum else "Any number.") if member.repeating else (
            "Mandatory." if member.minimum else "Optional.")
        doc = f"{member.doc} {count}"
        if member.kind == "simple" and not member.repeating:
            self.lines.pop()
            self.value_accessors(name, member.type, doc, not member.minimum)
            kind = "mandatory" if member.minimum else "optional"
            self.storage.append(f"hqf::frame::{kind}<{storage_type(member.type)}> {name}_;")
        elif member.kind == "simple":
            self.simple_list(member, doc)
        elif member.repeating:
            self.class_list(member, doc)
        else:
            self.single_class(member, doc)

    def simple_list(self, member: Member, doc: str) -> None:
        name, argument = member.name, argument_type(member.type)
        rule = bounds_text(member.type)
        self.doc(doc + (f" Value: {rule}." if rule else ""))
        self.doc(f"Precondition of get and delete: `index < size_{name}()`.")
        self.add(f"{argument} get_{name}(unsigned int index) const;")
        self.doc("Replaces an item, or appends for an index from the size up. Nothing is checked. Returns 0.")
        self.add(f"lmx::elmx_error set_{name}(unsigned int index, {argument} value);")
        self.add(f"lmx::elmx_error append_{name}({argument} value);")
        self.doc("Inserts before an item, or appends for an index from the size up. Returns 0.")
        self.add(f"lmx::elmx_error insert_{name}(unsigned int index, {argument} value);")
        self.add(f"void delete_{name}(unsigned int index);")
        self.add(f"void clear_{name}();")
        self.add(f"unsigned int size_{name}() const;")
        self.storage.append(f"hqf::frame::list<{value_type(member.type)}> {name}_;")

    def class_list(self, member: Member, doc: str) -> None:
        name, item = member.name, member.class_name
        self.forward.add(item)
        self.doc(doc)
        self.doc("Appends default objects until the index is valid.")
        self.add(f"{item}& get_{name}(unsigned int index);")
        self.doc(f"Precondition of this one and of delete: `index < size_{name}()`.")
        self.add(f"const {item}& get_{name}(unsigned int index) const;")
        self.add(f"{item}& assign_{name}(unsigned int index, const {item}& value);")
        self.doc("Appends a default object. Returns 0.")
        self.add(f"lmx::elmx_error append_{name}();")
        self.doc("Inserts a default object before an item, or appends for an index from the size up. Returns 0.")
        self.add(f"lmx::elmx_error insert_{name}(unsigned int index);")
        self.doc("Precondition: the list is not empty.")
        self.add(f"{item}& back_{name}();")
        self.add(f"void delete_{name}(unsigned int index);")
        self.add(f"void clear_{name}();")
        self.add(f"unsigned int size_{name}() const;")
        self.storage.append(f"hqf::frame::list<{item}> {name}_;")

    def single_class(self, member: Member, doc: str) -> None:
        name, item = member.name, member.class_name
        if member.by_pointer:
            self.forward.add(item)
        self.doc(doc + " This form marks it present, even when it is only read.")
        self.add(f"{item}& get_{name}();")
        self.add(f"const {item}& get_{name}() const;")
        self.add(f"{item}& assign_{name}(const {item}& value);")
        if member.has_isset:
            self.add(f"bool isset_{name}() const;")
            self.doc("Clears the flag; the object stays.")
            self.add(f"void unset_{name}();")
        kind = "child_pointer" if made_on_first_use(self.vocabulary, member) else "child"
        self.storage.append(f"hqf::frame::{kind}<{item}> {name}_;")

    def wildcard(self, member: Member) -> None:
        self.doc(f"{member.doc} One or more. Texts are UTF-8; `value` is the element as raw XML.")
        self.add("lmx::elmx_error append_any(const std::string& value);")
        self.doc("Inserts before an entry, or appends for an index from the size up. Returns 0.")
        self.add("lmx::elmx_error insert_any(unsigned int index, const std::string& value);")
        self.doc("Precondition of delete and get: `index < size_any()`.")
        self.add("void delete_any(unsigned int index);")
        self.add("void clear_any();")
        self.add("unsigned int size_any() const;")
        self.doc("Copies the parts of an entry. `ns` and `name` may be null and are then skipped.")
        self.add("void get_any(unsigned int index, std::string* ns, std::string* name, std::string* value) const;")
        self.storage.append("hqf::frame::list<lmx::c_any_info> any_;")

    # Choices and groups

    def choice(self) -> None:
        self.add()
        self.add("elmx_chosen getchosen() const;")
        for option in self.cls.options:
            self.add()
            if option.type is not None:
                rule = bounds_text(option.type)
                self.doc(f"{option.doc}" + (f" Value: {rule}." if rule else "")
                         + " An empty value while another option is chosen.")
                self.add(f"{argument_type(option.type)} get_{option.name}() const;")
                self.doc("Chooses this option first and then checks the value: after a failure it is chosen, and empty "
                         "or as before.")
                self.add(f"lmx::elmx_error set_{option.name}({argument_type(option.type)} value);")
                self.enumeration_accessors(option.name, option.type)
            else:
                self.object_accessors(option.name, option.class_name, option.doc)
        self.storage.append("hqf::frame::choice_slot slot_{chosen_none};")

    def object_accessors(self, name: str, item: str, doc: str) -> None:
        self.forward.add(item)
        self.doc(f"{doc} Chooses it if it isn't: what was held before is destroyed.")
        self.add(f"{item}& get_{name}();")
        self.doc("A default object while something else is chosen.")
        self.add(f"const {item}& get_{name}() const;")
        self.add(f"{item}& assign_{name}(const {item}& value);")

    def group(self) -> None:
        cls = self.cls
        root = self.vocabulary.classes[cls.group[0].type_class].root
        self.forward.add(root)
        self.add()
        self.add("elmx_chosen getchosen() const;")
        for entry in cls.group:
            self.add()
            self.object_accessors(entry.element, entry.type_class, f"Member \"Hqf:{entry.element}\".")
            if entry.needs_xsi_type:
                self.doc("Takes over an object of any class of the hierarchy, to be written under the group's head with "
                         "its xsi:type.")
                self.add(f"{entry.type_class}& assign_{entry.element}({entry.type_class}* object);")
        self.add()
        self.doc("Whether the reader's current element is a member; if so, its event stays.")
        self.add("static bool is_member(lmx::c_xml_reader& reader, const std::string& name);")
        self.storage.append(f"hqf::frame::group_slot<{root}> slot_{{chosen_none}};")

    # Reading and writing

    def marshalling(self) -> None:
        cls = self.cls
        self.add()
        if cls.has_entry_points:
            self.doc("Writes a document whose root is this element, in UTF-8. Returns 0; 1 if the file can't be opened; "
                     "46 where something mandatory is missing, and then leaves no file and no text.")
            self.add("lmx::elmx_error marshal(const char* file_name);")
            self.add("lmx::elmx_error marshal(std::string* out);")
            self.add("lmx::elmx_error marshal(std::ostream& stream);")
        override = " override" if is_virtual(cls) else ""
        if cls.base or not is_virtual(cls):
            self.marshal_to_writer("", override)
        if cls.has_entry_points:
            self.doc("Reads a document whose root is this element. What the document states replaces single members and "
                     "is added to lists. Returns 0; 1 if the file can't be opened; 16 for another root; or the code of "
                     "the first violation, with what was read before it kept.")
            self.add("lmx::elmx_error unmarshal(const char* file_name);")
            self.add("lmx::elmx_error unmarshal(const char* buffer, unsigned int size);")
            self.add("lmx::elmx_error unmarshal(const std::string& text);")
            self.add("lmx::elmx_error unmarshal(lmx::c_xml_reader& reader);")
        if cls.form == "group":
            self.doc("Reads one member. False with a code in `*error` when that failed.")
            self.add("bool unmarshal(lmx::c_xml_reader& reader, std::string* name, lmx::elmx_error* error);")
        elif cls.base or not is_virtual(cls):
            self.unmarshal_element("", override)
        if cls.document:
            self.document()
        if cls.form == "group":
            self.lines += ["", "protected:"]
            self.add("lmx::elmx_error marshal_child_elements(lmx::c_xml_writer& writer);")
            self.add()
        elif cls.form != "element" or cls.nillable:
            self.lines += ["", "protected:"]
            self.add("void marshal_attributes(lmx::c_xml_writer& writer) const;")
            self.add("lmx::elmx_error marshal_child_elements(lmx::c_xml_writer& writer);")
            self.add("bool unmarshal_attributes(lmx::c_xml_reader& reader, const std::string& attribute, "
                     "lmx::elmx_error* error);")
            self.add("lmx::elmx_error unmarshal_attributes_check(lmx::c_xml_reader& reader);")
            has_body = ", bool has_body" if self.vocabulary.body(cls) else ""
            self.add(f"bool unmarshal_body(lmx::c_xml_reader& reader, std::string* name, lmx::elmx_error* error{has_body});")

    def marshal_to_writer(self, before: str, behind: str) -> None:
        self.doc("Writes this object as an element of the qualified name `name`. Returns 0, or the first code.")
        self.add(f"{before}lmx::elmx_error marshal(lmx::c_xml_writer& writer, const char* name){behind};")

    def unmarshal_element(self, before: str, behind: str) -> None:
        self.doc("Reads the element whose start tag has been read up to its name; `name` is its qualified name as the "
                 "document spells it. Returns 0, or the first code.")
        self.add(f"{before}lmx::elmx_error unmarshal(lmx::c_xml_reader& reader, const std::string& name){behind};")

    def document(self) -> None:
        self.storage.append("/// Bytes of the text last read or written: about what the next write will take.")
        self.storage.append("std::size_t text_size_ = 0;")
        self.add()
        self.doc("Reads a document from a file: an archive if the name ends in \".hqfz\", else XML. As unmarshal().")
        self.add("lmx::elmx_error loadFile(const std::wstring& path);")
        self.doc("Reads a document from wide text.")
        self.add("lmx::elmx_error loadString(const std::wstring& xml);")
        self.doc("Writes the document to a file: XML for \".hqf\", an archive for \".hqfz\", 1001 for any other name. "
                 "Stamps WriteSDKInformation. Returns 1 if the file can't be opened; 46 where something mandatory is "
                 "missing; 42 if the stream failed; and then leaves no file.")
        self.add("lmx::elmx_error writeFile(const std::wstring& path);")
        self.doc("Writes the document to wide text, which is empty unless the code is 0. Stamps WriteSDKInformation.")
        self.add("XMLDocumentResult writeString();")
