"""Emits the bodies of the classes, a file for each topic: every one of them a line or two that hands on to hqf/frame."""

from __future__ import annotations

from cpp_names import (NOTICE, argument_type, literals_name, made_on_first_use, rows_name, rules_pointer)
from vocabulary import Body, Member, ModelClass, SimpleType, Vocabulary

ERROR = "lmx::elmx_error"
READER = "lmx::c_xml_reader& reader"
WRITER = "lmx::c_xml_writer& writer"


def class_bodies(vocabulary: Vocabulary, part: str) -> str:
    classes = [cls for cls in vocabulary.classes.values() if cls.part == part]
    head = ['#include "hqf/frame/access.h"', '#include "hqf/frame/entry.h"', '#include "hqf/frame/objects.h"',
            '#include "hqf/frame/read.h"', '#include "hqf/frame/write.h"', '#include "hqf/model/classes.h"',
            '#include "hqf/model/tables.h"']
    if any(cls.document for cls in classes):
        head.append('#include "hqf/document/SdkInformationStamper.h"')
    bodies = [_Bodies(vocabulary, cls) for cls in classes]
    text = NOTICE + "\n".join(sorted(head)) + "\n\nnamespace hqf_v2 {\n\nnamespace frame = hqf::frame;\nusing namespace hqf::model;\n"
    text += "".join(body.text() for body in bodies)
    text += "\n} // namespace hqf_v2\n\nnamespace hqf {\n\n"
    for cls in classes:
        text += (f"bool equal(const hqf_v2::{cls.name}& a, const hqf_v2::{cls.name}& b) {{ "
                 f"return frame::equal_members(model::{rows_name(vocabulary, cls)}, &a, &b); }}\n")
    return text + "\n} // namespace hqf\n"


class _Bodies:
    def __init__(self, vocabulary: Vocabulary, cls: ModelClass) -> None:
        self.vocabulary, self.cls = vocabulary, cls
        self.rows = rows_name(vocabulary, cls)
        self.lines: list[str] = []

    def define(self, result: str, signature: str, body: str, const: bool = False) -> None:
        result = result + " " if result else ""
        self.lines.append(f"{result}{self.cls.name}::{signature}{' const' if const else ''} {{ {body} }}")

    def text(self) -> str:
        cls = self.cls
        self.life_cycle()
        if cls.polymorphic and cls.form != "element":
            self.identity()
        for attribute in cls.attributes:
            self.value(attribute.name, f"{attribute.name}_", attribute.type, not attribute.required, attribute.default)
        if cls.body:
            self.body(cls.body)
        if cls.nillable:
            self.define("bool", f"isnil_{cls.name}()", "return nil_;", const=True)
            self.define("void", f"setnil_{cls.name}()", "nil_ = true;")
        for member in cls.members:
            self.member(member)
        if cls.form == "choice":
            self.choice()
        if cls.form == "group":
            self.group()
        self.marshalling()
        return f"\n// {cls.name}\n\n" + "\n".join(self.lines) + "\n"

    # Life cycle

    def life_cycle(self) -> None:
        cls, name = self.cls, self.cls.name
        defaults = " ".join(self.default(f"{a.name}_", a.type, a.default)
                            for a in cls.attributes if a.default is not None)
        if cls.document:
            self.define("", f"{name}()", "SdkInformationStamper().stampRead(*this);")
        elif defaults:
            self.define("", f"{name}()", defaults)
        else:
            self.lines.append(f"{name}::{name}() = default;")
        if cls.form == "element" and not cls.nillable:
            self.lines.append(f"{name}::{name}(const {name}& other) : {cls.base}(other) {{}}")
        else:
            self.lines.append(f"{name}::{name}(const {name}& other) : {name}() {{ "
                              f"frame::copy_members({self.rows}, this, &other); }}")
        if cls.has_entry_points:
            for arguments, call in (("const char* file_name", "file_name"),
                                    ("const char* buffer, unsigned int size", "buffer, size"),
                                    ("const std::string& text", "text")):
                self.lines.append(f"{name}::{name}({arguments}, {ERROR}* error) : {name}() {{ "
                                  f"*error = lmx::err_undefined_error; *error = unmarshal({call}); }}")
        self.define(f"{name}&", f"operator=(const {name}& other)", f"{name} copy(other); swap(copy); return *this;")
        if cls.form == "choice":
            self.define("", f"~{name}()", f"frame::release_choice({self.rows}, this);")
        else:
            self.lines.append(f"{name}::~{name}() = default;")
        self.define("void", f"swap({name}& other)", f"frame::swap_members({self.rows}, this, &other);")
        self.define("void", "reset()", f"{name} fresh; swap(fresh);")
        self.define("bool", "is_occurs_ok()", f"return frame::is_occurs_ok({self.rows}, this);", const=True)

    @staticmethod
    def default(member: str, type_: SimpleType, literal: str) -> str:
        return f"{member}.value.set_number({type_.literals.index(literal) + 1});"

    def identity(self) -> None:
        cls, name = self.cls, self.cls.name
        self.define(f"{name}*", "clone()", f"return new {name}(*this);", const=True)
        self.define("const char*", "getid()", "return id;", const=True)
        bases = f" || {cls.base}::has_id(identity)" if cls.base else ""
        self.define("bool", "has_id(const char* identity)", f"return identity == id{bases};", const=True)
        self.lines.append(f"const char* {name}::id = \"{name}\";")
        if cls.factory_names:
            self.define(f"{name}*", "factory(int namespace_id, const std::string& type_name)",
                        f"return static_cast<{name}*>(frame::make_by_name({name}_factory, namespace_id, type_name));")

    # Members

    def value(self, name: str, member: str, type_: SimpleType, optional: bool, default: str | None = None,
              nil: str = "") -> None:
        text = f".text({literals_name(type_)})" if type_.literals else ""
        self.define(argument_type(type_), f"get_{name}()", f"return {member}.value{text};", const=True)
        rules = rules_pointer(type_)
        tail = "" if rules == "nullptr" else ", " + rules
        self.define(ERROR, f"set_{name}({argument_type(type_)} value)",
                    f"return frame::store({member}, {nil}value{tail});")
        if optional:
            restore = f" {self.default(member, type_, default)}" if default is not None else ""
            self.define("bool", f"isset_{name}()", f"return {member}.set;", const=True)
            self.define("void", f"unset_{name}()", f"{member}.set = false;{restore}")
        self.enumeration(name, type_, f"{member}.value.number()")

    def enumeration(self, name: str, type_: SimpleType, stored_number: str) -> None:
        if not type_.literals:
            return
        texts = literals_name(type_)
        enumeration = f"Eenum_{name}"
        self.lines.append(f"{self.cls.name}::{enumeration} {self.cls.name}::getenum_{name}() const {{ "
                          f"return static_cast<{enumeration}>({stored_number}); }}")
        self.define("bool", f"setenum_{name}({enumeration} number)",
                    f"return frame::store_literal({texts}, number, "
                    f"[this](const std::wstring& text) {{ return set_{name}(text); }});")

    def body(self, body: Body) -> None:
        self.value(self.cls.name, "body_", body.type, body.optional, nil="nil_, " if self.cls.nillable else "")

    def member(self, member: Member) -> None:
        if member.kind == "any":
            self.wildcard()
        elif member.repeating:
            self.list_accessors(member)
        elif member.kind == "simple":
            self.value(member.name, f"{member.name}_", member.type, not member.minimum)
        elif made_on_first_use(self.vocabulary, member):
            self.pointer_accessors(member)
        else:
            self.child_accessors(member)

    def list_accessors(self, member: Member) -> None:
        name, stored = member.name, f"{member.name}_"
        if member.kind == "simple":
            argument = argument_type(member.type)
            self.define(argument, f"get_{name}(unsigned int index)", f"return {stored}[index];", const=True)
            self.define(ERROR, f"set_{name}(unsigned int index, {argument} value)",
                        f"{stored}.replace(index, value); return lmx::err_no_error;")
            self.define(ERROR, f"append_{name}({argument} value)", f"{stored}.add(value); return lmx::err_no_error;")
            self.define(ERROR, f"insert_{name}(unsigned int index, {argument} value)",
                        f"{stored}.insert_new(index, value); return lmx::err_no_error;")
        else:
            item = member.class_name
            self.define(f"{item}&", f"get_{name}(unsigned int index)", f"return {stored}.at_or_add(index);")
            self.define(f"const {item}&", f"get_{name}(unsigned int index)", f"return {stored}[index];", const=True)
            self.define(f"{item}&", f"assign_{name}(unsigned int index, const {item}& value)",
                        f"return get_{name}(index) = value;")
            self.define(ERROR, f"append_{name}()", f"{stored}.add(); return lmx::err_no_error;")
            self.define(ERROR, f"insert_{name}(unsigned int index)",
                        f"{stored}.insert_new(index); return lmx::err_no_error;")
            self.define(f"{item}&", f"back_{name}()", f"return {stored}.back();")
        self.list_tail(name, stored)

    def list_tail(self, name: str, stored: str) -> None:
        self.define("void", f"delete_{name}(unsigned int index)", f"{stored}.remove(index);")
        self.define("void", f"clear_{name}()", f"{stored}.clear();")
        self.define("unsigned int", f"size_{name}()", f"return {stored}.size();", const=True)

    def wildcard(self) -> None:
        self.define(ERROR, "append_any(const std::string& value)", "any_.add(value); return lmx::err_no_error;")
        self.define(ERROR, "insert_any(unsigned int index, const std::string& value)",
                    "any_.insert_new(index, value); return lmx::err_no_error;")
        self.list_tail("any", "any_")
        self.define("void", "get_any(unsigned int index, std::string* ns, std::string* name, std::string* value)",
                    "frame::copy_any(any_[index], ns, name, value);", const=True)

    def child_accessors(self, member: Member) -> None:
        name, item, stored = member.name, member.class_name, f"{member.name}_"
        self.define(f"{item}&", f"get_{name}()", f"{stored}.present = true; return {stored}.object;")
        self.define(f"const {item}&", f"get_{name}()", f"return {stored}.object;", const=True)
        self.child_tail(member, stored)

    def pointer_accessors(self, member: Member) -> None:
        name, item, stored = member.name, member.class_name, f"{member.name}_"
        make_nil = f", &{item}::setnil_{item}" if self.vocabulary.classes[item].nillable else ""
        self.define(f"{item}&", f"get_{name}()", f"return frame::made({stored}{make_nil});")
        self.define(f"const {item}&", f"get_{name}()", f"return frame::made_to_look_at({stored}{make_nil});",
                    const=True)
        self.child_tail(member, stored)

    def child_tail(self, member: Member, stored: str) -> None:
        name, item = member.name, member.class_name
        self.define(f"{item}&", f"assign_{name}(const {item}& value)", f"return get_{name}() = value;")
        if member.has_isset:
            self.define("bool", f"isset_{name}()", f"return {stored}.present;", const=True)
            self.define("void", f"unset_{name}()", f"{stored}.present = false;")

    # Choices and groups

    def chosen_accessor(self) -> None:
        name = self.cls.name
        self.lines.append(f"{name}::elmx_chosen {name}::getchosen() const {{ "
                          "return static_cast<elmx_chosen>(slot_.chosen); }")

    def choice(self) -> None:
        self.chosen_accessor()
        for option in self.cls.options:
            name, chosen = option.name, f"chosen_{option.name}"
            if option.type is not None:
                argument = argument_type(option.type)
                self.define(argument, f"get_{name}()",
                            f"return frame::option_value<{argument.removeprefix('const ').removesuffix('&')}>(slot_, {chosen});",
                            const=True)
                self.define(ERROR, f"set_{name}({argument} value)",
                            f"return frame::store_option({self.rows}, this, slot_, {chosen}, value);")
                self.enumeration(name, option.type, f"{literals_name(option.type)}.number_of(get_{name}())")
            else:
                item = option.class_name
                self.define(f"{item}&", f"get_{name}()",
                            f"frame::choose_option({self.rows}, this, {chosen}); "
                            f"return *static_cast<{item}*>(slot_.object);")
                self.define(f"const {item}&", f"get_{name}()",
                            f"return frame::option_value<{item}>(slot_, {chosen});", const=True)
                self.assign_chosen(name, item)

    def assign_chosen(self, name: str, item: str) -> None:
        self.define(f"{item}&", f"assign_{name}(const {item}& value)",
                    f"{item} copy(value); return frame::swapped(get_{name}(), copy);")

    def group(self) -> None:
        self.chosen_accessor()
        for entry in self.cls.group:
            name, item, chosen = entry.element, entry.type_class, f"chosen_{entry.element}"
            self.define(f"{item}&", f"get_{name}()",
                        f"return *static_cast<{item}*>(frame::choose_member({self.rows}, this, {chosen}));")
            self.define(f"const {item}&", f"get_{name}()",
                        f"return frame::member_object<{item}>(slot_, {chosen});", const=True)
            self.assign_chosen(name, item)
            if entry.needs_xsi_type:
                self.define(f"{item}&", f"assign_{name}({item}* object)",
                            f"slot_.hold({chosen}, object); return frame::object_or_spare(object);")
        self.define("bool", f"is_member({READER}, const std::string&)",
                    f"return frame::is_member({self.rows}, reader);")

    # Reading and writing

    def marshalling(self) -> None:
        cls, rows = self.cls, self.rows
        if cls.has_entry_points:
            name = f'"{cls.element}"'
            text_size = ", &text_size_" if cls.document else ""
            self.define(ERROR, "marshal(const char* file_name)",
                        f"return frame::marshal_to_file(*this, {name}, file_name);")
            self.define(ERROR, "marshal(std::string* out)",
                        f"return frame::marshal_to_string(*this, {name}, out{text_size});")
            self.define(ERROR, "marshal(std::ostream& stream)",
                        f"return frame::marshal_to_stream(*this, {name}, stream);")
            self.define(ERROR, "unmarshal(const char* file_name)", "return frame::unmarshal_file(*this, file_name);")
            self.define(ERROR, "unmarshal(const char* buffer, unsigned int size)",
                        "return frame::unmarshal_memory(*this, buffer, size);")
            self.define(ERROR, "unmarshal(const std::string& text)",
                        "return frame::unmarshal_text(*this, text);")
            self.define(ERROR, f"unmarshal({READER})",
                        f"return frame::unmarshal_document(*this, reader, \"{cls.name}\"{text_size});")
        if cls.form == "group":
            self.define(ERROR, f"marshal({WRITER}, const char*)", f"return frame::write_group({rows}, this, writer);")
            self.define("bool", f"unmarshal({READER}, std::string* name, {ERROR}* error)",
                        f"return frame::read_group({rows}, this, reader, name, error);")
            self.define(ERROR, f"marshal_child_elements({WRITER})",
                        f"return frame::write_group({rows}, this, writer);")
            return
        # An element class has the writer know its namespaces, then is its type: also where that refuses.
        is_type_alone = cls.form == "element" and not cls.nillable
        select = "writer.conditionally_select_ns_map(frame::namespace_map); " if is_type_alone else ""
        self.define(ERROR, f"marshal({WRITER}, const char* name)",
                    f"{select}return frame::write_element({rows}, this, writer, name);")
        self.define(ERROR, f"unmarshal({READER}, const std::string& name)",
                    f"return frame::read_element({rows}, this, reader, name);")
        if is_type_alone:
            return
        self.define("void", f"marshal_attributes({WRITER})", f"frame::write_attributes({rows}, this, writer);",
                    const=True)
        self.define(ERROR, f"marshal_child_elements({WRITER})",
                    f"return frame::write_content({rows}, this, writer);")
        self.define("bool", f"unmarshal_attributes({READER}, const std::string& attribute, {ERROR}* error)",
                    f"return frame::read_attribute({rows}, this, reader, attribute, error);")
        self.define(ERROR, f"unmarshal_attributes_check({READER})",
                    f"return frame::check_attributes({rows}, this, reader);")
        if self.vocabulary.body(cls):
            self.define("bool", f"unmarshal_body({READER}, std::string* name, {ERROR}* error, bool has_body)",
                        f"return frame::read_simple_body({rows}, this, reader, name, error, has_body);")
        else:
            self.define("bool", f"unmarshal_body({READER}, std::string* name, {ERROR}* error)",
                        f"return frame::read_body({rows}, this, reader, name, error);")
