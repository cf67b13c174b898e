"""Emits the C# classes of the model: a property for each member, a list for each repeating one.

A member that may be absent is null while it is, and storing null takes it out. An option of a choice is null unless it
is chosen. Storing an object copies it. A member that bears its class's name is called Value, since C# allows no other.
"""

from __future__ import annotations

from cpp_names import bounds_text
from csharp_names import doc_comment, identifier, passed, plural, public_type, received
from flat_model import Export, bare
from typed_model import ModelClass, SimpleType, Vocabulary


def model_class(vocabulary: Vocabulary, cls: ModelClass, exports: list[Export]) -> str:
    return _Class(vocabulary, cls, exports).text()


class _Class:
    def __init__(self, vocabulary: Vocabulary, cls: ModelClass, exports: list[Export]) -> None:
        self.vocabulary, self.cls, self.exports = vocabulary, cls, exports
        self.lines: list[str] = []

    def text(self) -> str:
        cls = self.cls
        self.life_cycle()
        members: dict[tuple[str, str], dict[str, Export]] = {}
        for export in self.exports:
            if export.role:
                members.setdefault((export.member, export.form), {})[_role(export)] = export
        for (name, form), roles in members.items():
            if form != "wildcard":
                getattr(self, form)(name, roles)
        if cls.form in ("choice", "group"):
            self.chosen()
        if cls.polymorphic and cls.form != "element":
            self.identity()
        if cls.has_entry_points:
            self.entry_points()
        summary = cls.doc or f"The element {cls.element or cls.name} as an object of its own."
        head = f"public partial class {cls.name} : {cls.base or 'NativeObject'}"
        body = "".join(f"    {line}\n" if line else "\n" for line in self.lines)
        return f"{doc_comment(summary)}{head}\n{{\n{body.rstrip()}\n}}\n"

    # Pieces

    def add(self, doc: str, *lines: str) -> None:
        self.lines += [*doc_comment(doc).splitlines(), *lines, ""]

    def native(self, name: str, *arguments: str) -> str:
        return f"Native.{name}({', '.join(arguments)})"

    def call(self, export: Export, *arguments: str) -> str:
        return self.native(export.name, "Self", *arguments)

    def member_name(self, name: str) -> str:
        return "Value" if name == self.cls.name else name

    def quoted(self, name: str) -> str:
        return f'"{self.cls.name}.{self.member_name(name)}"'

    def property(self, doc: str, type_: str, name: str, getter: str, *setter: str) -> None:
        if len(setter) > 1:
            setter_lines = ["    set", "    {", *(f"        {line}" for line in setter), "    }"]
        else:
            setter_lines = [f"    set => {setter[0]}"]
        self.add(doc, f"public {type_} {name}", "{", f"    get => {getter};", *setter_lines, "}")

    # Every class

    def life_cycle(self) -> None:
        name, base = self.cls.name, self.cls.base
        again = "override" if base else "virtual"
        self.add("A new object.", f"public {name}() : this(Native.CSharp_new_{name}__SWIG_0(), null) {{ }}")
        self.add("A deep copy.",
                 f"public {name}({name} other) : this(Native.CSharp_new_{name}__SWIG_1(Ref(other)), null) {{ }}")
        self.lines += [f"internal {name}(IntPtr pointer, NativeObject parent) : base(pointer, parent) {{ }}", "",
                       f"internal override void Delete(IntPtr pointer) => Native.CSharp_delete_{name}(pointer);", ""]
        self.add("Exchanges all contents.", f"public void Swap({name} other)", "{", "    ForgetPartsWith(other);",
                 f"    {self.native(f'CSharp_{name}_swap', 'Self', 'Ref(other)')};", "    Call.Done();", "}")
        self.add("Back to the state of a new object.", f"public {again} void Reset()", "{", "    ForgetParts();",
                 f"    {self.native(f'CSharp_{name}_reset', 'Self')};", "    Call.Done();", "}")
        self.add("Whether nothing mandatory is missing.", f"public {again} bool IsOccursOk() =>",
                 f"    Call.Done({self.native(f'CSharp_{name}_is_occurs_ok', 'Self')});")

    def identity(self) -> None:
        name, root = self.cls.name, self.cls.root == self.cls.name
        new = "" if root else "new "
        clone = self.native(f"CSharp_{name}_clone", "Self")
        self.add("A deep copy.", f"public {new}{name} Clone() => new {name}({clone}, null);")
        self.add("The identity of the class.",
                 f"public {new}static ClassIdentity ClassId => new ClassIdentity(Native.CSharp_{name}_id_get());")
        self.add("Gives the class a new identity; it has none of those given before then.",
                 f"public {new}static void SetClassId(string identity) =>",
                 f"    Native.CSharp_{name}_id_set(NativeText.ToNarrow(identity));")
        if root:
            self.add("The identity of the object's class.", "public ClassIdentity GetId() =>",
                     f"    new ClassIdentity({self.native(f'CSharp_{name}_getid', 'Self')});")
            self.add("Whether it is the identity of the object's class or of a base.",
                     "public bool HasId(ClassIdentity identity) =>",
                     f"    Call.Done({self.native(f'CSharp_{name}_has_id', 'Self', 'identity.Pointer')});")
        if self.cls.factory_names:
            self.factory(new)

    def factory(self, new: str) -> None:
        name, made = self.cls.name, f"Func<IntPtr, NativeObject, {self.cls.name}>"
        rows = [f'    {{ "{type_}", (pointer, parent) => new {type_}(pointer, parent) }},'
                for type_ in self.cls.factory_names]
        self.lines += [f"static readonly Dictionary<string, {made}> derived = new Dictionary<string, {made}>", "{",
                       *rows, "};", ""]
        self.lines += [f"internal {new}static {name} Of(IntPtr pointer, NativeObject parent) =>",
                       f"    Polymorphic.Make(derived, pointer, parent, Native.CSharp_{name}_getid) ??",
                       f"    new {name}(pointer, parent);", ""]
        self.add("A new object of the type with this name in namespace 1000, else null.",
                 f"public {new}static {name} Factory(int namespaceId, string typeName) =>",
                 f"    Polymorphic.OrNull(Native.CSharp_{name}_factory(namespaceId, "
                 "NativeText.ToNarrow(typeName)), Of);")

    # Members with a value

    def type_of(self, name: str) -> SimpleType | None:
        cls = self.cls
        if cls.body and name == cls.name:
            return cls.body.type
        return next((place.type for place in [*cls.attributes, *cls.members, *cls.options] if place.name == name), None)

    def rule(self, doc: str, name: str) -> str:
        type_ = self.type_of(name)
        bounds = bounds_text(type_) if type_ else ""
        return f"{doc} {bounds[:1].upper()}{bounds[1:]}{'.' if bounds else ''}".strip() or f"{name}."

    def default_of(self, name: str) -> str | None:
        return next((attribute.default for attribute in self.cls.attributes if attribute.name == name), None)

    def value(self, name: str, roles: dict[str, Export]) -> None:
        get, set_ = roles["get"], roles["set"]
        type_ = public_type(get.result)
        nullable = type_ if get.result.kind in ("wide", "object") else type_ + "?"
        stored = received(get.result, self.call(get), "this")
        member, doc = self.member_name(name), self.rule(get.doc, name)
        if "isset" not in roles:
            # The wrapper refuses null for text, the library for an object.
            self.property(doc, type_, member, stored,
                          f"Call.Must({self.call(set_, passed(set_.arguments[1], 'value'))}, {self.quoted(name)});")
            self.enumeration(name, roles, None)
            return
        isset = f"Call.Done({self.call(roles['isset'])})"
        default = self.default_of(name)
        value = "value" if nullable == type_ else "value.Value"
        self.property(f"{doc} {f'{default} unless set.' if default else 'Null while absent.'}", nullable, member,
                      stored if default else f"{isset} ? {stored} : ({nullable})null",
                      f"if (value != null) Call.Must({self.call(set_, passed(set_.arguments[1], value))}, "
                      f"{self.quoted(name)});",
                      f"else {self.call(roles['unset'])};", "Call.Done();")
        if default:
            self.add(f"Whether {member} was set.", f"public bool IsSet{member} => {isset};")
        self.enumeration(name, roles, None if default else isset)

    def enumeration(self, name: str, roles: dict[str, Export], present: str | None, before: str = "") -> None:
        if "getenum" not in roles:
            return
        member, literal = self.member_name(name), self.member_name(name) + "Literal"
        rows = [f"    {identifier(text)} = {number}," for number, text in enumerate(self.type_of(name).literals, 1)]
        self.add(f"The literals of {member}.", f"public enum {literal}", "{", *doc_rows(["None = 0", *rows]), "}")
        stored = f"({literal})Call.Done({self.call(roles['getenum'])})"
        self.property(f"{member} as a literal; None for any other text.", literal, member + "AsEnum",
                      f"{present} ? {stored} : {literal}.None" if present else stored,
                      *filter(None, [before]),
                      f"Call.MustBeLiteral({self.call(roles['setenum'], '(int)value')}, {self.quoted(name)}, value);")

    def nil(self, name: str, roles: dict[str, Export]) -> None:
        self.add("Whether the element is nil.", f"public bool IsNil => Call.Done({self.call(roles['isnil'])});")
        self.add("Makes the element nil; its values stay, and storing one ends it.", "public void SetNil()", "{",
                 f"    {self.call(roles['setnil'])};", "    Call.Done();", "}")

    def option(self, name: str, roles: dict[str, Export]) -> None:
        get, set_ = roles["get"], roles["set"]
        type_ = public_type(get.result)
        nullable = type_ if get.result.kind == "wide" else type_ + "?"
        value = "value" if nullable == type_ else "(value ?? throw new ArgumentNullException(nameof(value)))"
        chosen = f"Chosen == Choice.{name}"
        self.property(f"{self.rule(get.doc, name)} Null unless chosen. Storing chooses it, even a value that is "
                      "refused.", nullable, name, f"{chosen} ? {received(get.result, self.call(get), 'this')} : ({nullable})null",
                      f"Choosing(Choice.{name});",
                      f"Call.Must({self.call(set_, passed(set_.arguments[1], value))}, {self.quoted(name)});")
        self.enumeration(name, roles, chosen, f"Choosing(Choice.{name});")

    # Members with an object

    def object(self, name: str, roles: dict[str, Export]) -> None:
        get, assign = roles["get"], roles["assign"]
        cls, member = bare(get.result.cls), self.member_name(name)
        doc = get.doc.replace("Marks it present.", "").strip() or f"{member}."
        made = received(get.result, self.call(get), "this")
        copy = f"Assigned({self.call(assign, 'Ref(value)')});"
        if "isset" not in roles:
            self.property(f"{doc} Storing copies.", cls, member, made, copy)
            return
        self.property(f"{doc} Null while absent. Storing copies.", cls, member,
                      f"Call.Done({self.call(roles['isset'])}) ? {made} : null",
                      f"if (value != null) {copy}", f"else {self.call(roles['unset'])};", "Call.Done();")
        self.add(f"Makes {member} present and gives it.", f"public {cls} Make{member}() =>", f"    {made};")

    def option_object(self, name: str, roles: dict[str, Export]) -> None:
        get, cls = roles["get"], bare(roles["get"].result.cls)
        made = received(get.result, self.call(get), "this")
        if "take" in roles:
            made = f"{cls}.Of({self.call(get)}, this)"
        doc = get.doc.replace("Chooses it.", "").strip() or f"The object, where it is a {name}."
        self.property(f"{doc} Null unless chosen. Storing chooses it and copies.", cls, name,
                      f"Chosen == Choice.{name} ? {made} : null",
                      f"Choosing(Choice.{name});", f"Assigned({self.call(roles['assign'], 'Ref(value)')});")
        self.add(f"Chooses {name} and gives it.", f"public {cls} Choose{name}()", "{", f"    Choosing(Choice.{name});",
                 f"    return {made};", "}")
        if "take" in roles:
            self.add(f"Chooses {name} and takes over the object, which may be of a derived class and must be no part "
                     "of another.", f"public void Take{name}({cls} taken)", "{", "    CheckTaking(taken);",
                     "    ForgetParts();", f"    Call.Done({self.call(roles['take'], 'Ref(taken)')});",
                     "    Take(taken);", "}")

    def chosen(self) -> None:
        cls = self.cls
        names = [option.name for option in cls.options] or [entry.element for entry in cls.group]
        none = len(names) + (cls.form == "group")
        rows = [f"{name} = {number}" for number, name in enumerate(names)] + [f"None = {none}"]
        self.add("What can be chosen.", "public enum Choice", "{", *doc_rows(rows), "}")
        self.add("What is chosen.",
                 f"public Choice Chosen => (Choice)Call.Done({self.native(f'CSharp_{cls.name}_getchosen', 'Self')});")
        self.lines += ["void Choosing(Choice next)", "{",
                       "    if (Chosen != next && Chosen != Choice.None) ForgetParts();", "}", ""]

    # Lists

    def list_functions(self, kind: str, item: str, name: str, roles: dict[str, Export], get: str,
                       rest: list[str]) -> None:
        functions = f"{kind}ListFunctions<{item}>"
        common = [f"Member = {self.quoted(name)}", f"Size = Native.{roles['size'].name}",
                  f"Clear = Native.{roles['clear'].name}", f"Delete = Native.{roles['delete'].name}",
                  f"Get = (o, i) => {get}"]
        field = f"functionsOf{name}"
        self.lines += [f"static readonly {functions} {field} = new {functions}", "{",
                       *(f"    {row}," for row in [*common, *rest]), "};", ""]
        doc = roles["get"].doc.replace("Appends default objects until the index is valid.", "").replace(
            "The index must be below the size.", "").strip()
        self.add(doc or f"The elements {name}.", f"public {kind}List<{item}> {plural(name)} =>",
                 f"    new {kind}List<{item}>(this, {field});")

    def values(self, name: str, roles: dict[str, Export]) -> None:
        get = roles["get"]
        value = passed(roles["append"].arguments[1], "v")
        item = public_type(get.result)
        self.list_functions("Value", item, name, roles,
                            received(get.result, self.native(get.name, "o.Self", "i"), "o"),
                            [f"Append = (o, v) => {self.native(roles['append'].name, 'o.Self', value)}",
                             f"Insert = (o, i, v) => {self.native(roles['insert'].name, 'o.Self', 'i', value)}",
                             f"Set = (o, i, v) => {self.native(roles['set'].name, 'o.Self', 'i', value)}"])

    def objects(self, name: str, roles: dict[str, Export]) -> None:
        get = roles["get"]
        self.list_functions("Object", bare(get.result.cls), name, roles,
                            received(get.result, self.native(get.name, "o.Self", "i"), "o"),
                            [f"Append = Native.{roles['append'].name}", f"Insert = Native.{roles['insert'].name}",
                             f"Assign = Native.{roles['assign'].name}"])

    def entry_points(self) -> None:
        name = self.cls.name
        for operation, verb, argument in (("marshal", "Marshal", "Writes a document of this element to a file."),
                                          ("unmarshal", "Unmarshal", "Reads a document of this element from a file.")):
            forget = ["    ForgetParts();"] if verb == "Unmarshal" else []
            call = self.native(f"CSharp_{name}_{operation}__SWIG_0", "Self", "NativeText.ToNarrow(path)")
            self.add(argument, f"public void {verb}(string path)", "{", *forget,
                     f"    Call.Must({call}, \"{name}.{verb}\");", "}")
        call = self.native(f"CSharp_{name}_unmarshal__SWIG_1", "Self", "xml", "xml == null ? 0 : (uint)xml.Length")
        self.add("Reads a document of this element from memory.", "public void Unmarshal(byte[] xml)", "{",
                 "    ForgetParts();", f"    Call.Must({call}, \"{name}.Unmarshal\");", "}")


def doc_rows(rows: list[str]) -> list[str]:
    """Enumerators, each with the comment that a public name needs."""
    lines = []
    for row in rows:
        name = row.strip().rstrip(",")
        lines += [f"    /// <summary>{name.split(' = ')[0]}.</summary>", f"    {name},"]
    return lines


def _role(export: Export) -> str:
    return "take" if export.role == "assign" and export.arguments[-1].kind == "object" else export.role
