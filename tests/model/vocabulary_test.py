"""What the generator makes of hqf-v2.xsd: sizes, rules of values, and that nothing unknown slips through.

Rules of values stand a second time in tests/data/model/vocabulary.txt, names and orders in everything.hqf, which holds
each child and each attribute of every class.
"""

import pathlib
import sys
import tempfile
import unittest

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "hqf" / "model" / "generator"))
sys.dont_write_bytecode = True

import vocabulary  # noqa: E402
from xsd import SchemaError  # noqa: E402

SCHEMA = ROOT / "hqf" / "model" / "hqf-v2.xsd"
TABLES = ROOT / "tests" / "data" / "model" / "vocabulary.txt"

COUNTS = {
    "classes": 205, "with members": 138, "element classes without members": 63, "group classes": 4,
    "with entry points": 68, "nillable classes": 12, "tolerant classes": 36,
    "child elements": 580, "repeating child elements": 159, "attributes": 140, "options": 18, "group members": 128,
    "types by xsi:type": 17, "nilled elements": 80, "literals by place": 262, "literals": 90, "enumerations": 19,
    "lower bounds": 86, "upper bounds": 66,
}

MANDATORY_CHILDREN = 195

REQUIRED_ATTRIBUTES = ("AveragingValue AxisNominalMax AxisNominalMin ColorName ColorSetName CompensationValue "
                       "DensityFilter DensityStatus Direction Name Name PaletteName Wavelength Wavelength")

STD_DEV = ["FunctionStdDev" + channel for channel in "XYZLABCH"] + ["FunctionAverageStdDev" + c for c in "LAB"]

LEAVES = [branch + leaf for branch in ("Spectrum", "Emissive") for leaf in ("Generic", "Tristimulus", "Spectral")]

TOLERANT = set(
    "CollectionColorSpaceSpecificationType ColorAndFinish CustomAttributes DeviceSettings OwnerType Parameters "
    "ParentColorSpace Person Process ProfileType_Parameters Recipe Revision Version FunctionType FunctionDEType "
    "FunctionMeanDEType SubstrateType SubstratePaperType SubstrateMetalType SubstratePlasticType SubstrateWoodType "
    "SubstrateVinylType SubstrateTileType SubstrateFilmType SubstrateTextileType".split()
    + [name + "Type" for name in STD_DEV])

NILLABLE = {"SDKVersion", "DevicePolarization", "DeviceFilter", "Density", "ParentColorSpace", "Standard"} | {
    "ColorSpaceSpecification" + leaf for leaf in LEAVES}

def table(heading):
    """The rows under a heading of vocabulary.txt."""
    section = TABLES.read_text(encoding="utf-8").split(f"\n[{heading}]\n")[1].split("\n\n")[0]
    return [row for row in section.splitlines() if not row.startswith("#")]


def child(entry):
    """A member or option in the notation of the tables."""
    occurrence = ""
    if hasattr(entry, "minimum"):
        occurrence = {(0, False): "?", (1, False): "", (0, True): "*", (1, True): "+"}[entry.minimum, entry.repeating]
    return entry.name + (":" + entry.class_name if entry.class_name else "") + occurrence


def rule(type_):
    """A simple type in the notation of VALUES."""
    text = type_.kind + (" C" if type_.whitespace == "collapse" else "")
    if type_.min_length is not None:
        text += f" length {type_.min_length}..{'' if type_.max_length is None else type_.max_length}"
    if type_.minimum is not None or type_.maximum is not None:
        text += " {}{}, {}{}".format("(" if type_.minimum_exclusive else "[", type_.minimum, type_.maximum or "",
                                     ")" if type_.maximum_exclusive or type_.maximum is None else "]")
    text += " text" if type_.bounds_tested_as_text else ""
    text += "" if type_.setter_checks_minimum else ", setter without minimum"
    return text + (" base64" if type_.base64 else "")


class VocabularyTest(unittest.TestCase):
    maxDiff = None

    @classmethod
    def setUpClass(cls):
        cls.vocabulary = vocabulary.load(SCHEMA)
        cls.classes = cls.vocabulary.classes

    def names(self, predicate):
        return {name for name, cls in self.classes.items() if predicate(cls)}

    def type_of(self, place):
        name, _, member = place.partition(".")
        cls = self.classes[name]
        if not member:
            return self.vocabulary.body(cls).type
        places = self.vocabulary.all_members(cls) + self.vocabulary.all_attributes(cls) + cls.options
        return next(each.type for each in places if each.name == member)

    def test_counts(self):
        self.assertEqual(self.vocabulary.counts(), COUNTS)
        children, attributes = ([place for cls in self.classes.values() for place in getattr(cls, kind)]
                                for kind in ("members", "attributes"))
        self.assertEqual(sum(child.minimum for child in children), MANDATORY_CHILDREN)
        self.assertEqual(sorted(a.name for a in attributes if a.required), REQUIRED_ATTRIBUTES.split())
        self.assertEqual({a.name: a.default for a in attributes if a.default}, {"AxisNominalScale": "Scale_Linear"})

    def test_values(self):
        for row in table("values"):
            place, _, expected = row.partition(" ")
            with self.subTest(place):
                self.assertEqual(rule(self.type_of(place)), expected)

    def test_literals(self):
        for row in table("literals"):
            place, count, *numbered = row.split()
            with self.subTest(place):
                literals = self.type_of(place).literals
                self.assertEqual(len(literals), int(count))
                for number, literal in (each.split("=") for each in numbered):
                    self.assertEqual(literals[int(number) - 1], literal)

    def test_choices(self):
        choices = {name: " ".join(map(child, cls.options))
                   for name, cls in self.classes.items() if cls.form == "choice"}
        self.assertEqual(choices, dict(row.split(" ", 1) for row in table("options")))

    def test_groups(self):
        for name, *elements in map(str.split, table("groups")):
            with self.subTest(name):
                group = self.classes[name].group
                self.assertEqual([entry.element for entry in group], elements)
                for entry in group:
                    type_class = entry.element.replace("DECMC", "DEcmc") + "Type"
                    self.assertEqual((entry.type_class, entry.element_class), (type_class, entry.element))
                    self.assertEqual(self.classes[entry.element].base, type_class)
                    self.assertEqual(entry.needs_xsi_type, entry.element == "Function")

    def test_factories(self):
        specification = ["Spectrum"] + LEAVES[:3] + ["Emissive"] + LEAVES[3:]
        expected = {name.replace("sg_", "") + "Type": [element.replace("DECMC", "DEcmc") + "Type"
                                                       for element in elements if element != "Function"]
                    for name, *elements in map(str.split, table("groups"))}
        expected["ColorSpaceSpecificationType"] = [f"ColorSpaceSpecification{name}Type" for name in specification]
        for branch, names in (("Spectrum", specification[:4]), ("Emissive", specification[4:])):
            expected[f"ColorSpaceSpecification{branch}Type"] = [f"ColorSpaceSpecification{n}Type" for n in names]
        factories = {name: cls.factory_names for name, cls in self.classes.items() if cls.factory_names}
        self.assertEqual(factories, expected)

    def test_sets_of_classes(self):
        """Classes that are told apart by one property each."""
        polymorphic_roots = {cls.root for cls in self.classes.values() if cls.polymorphic}
        rows = [
            ("nillable", NILLABLE, self.names(lambda c: c.nillable)),
            ("tolerant", TOLERANT, self.names(lambda c: c.tolerant and c.form != "element")),
            ("tolerant like its type", True, self.classes["FunctionDE"].tolerant),
            ("roots", {"ColorSpaceType", "SubstrateType", "SampleType", "FunctionType", "ColorSpaceSpecificationType"},
             polymorphic_roots),
            ("no entry points", {"ColorSpace", "Substrate", "Sample", "ColorSpaceSpecification"},
             self.names(lambda c: c.global_element and not c.has_entry_points)),
            ("entry points on global elements alone", set(),
             self.names(lambda c: c.has_entry_points and not c.global_element)),
            ("namespace steps of its own", set(),
             self.names(lambda c: c.named_type and not c.name.endswith("Type"))
             ^ {"Hqf", "Standard", "Measurement"}),
            ("a type without namespace steps", set(),
             self.names(lambda c: c.name.endswith("Type") and not c.named_type)),
            ("optional body", {"GlossCompensation", "Averaging"}, self.names(lambda c: c.body and c.body.optional)),
            ("keeps attributes when nil", {"DeviceFilter"}, self.names(lambda c: c.attributes_when_nil)),
            ("minimums at the end", {"ColorType"}, self.names(lambda c: c.end_checks_minimums)),
            ("root of documents", {"Hqf"}, self.names(lambda c: c.document)),
        ]
        for why, expected, found in rows:
            with self.subTest(why):
                self.assertEqual(found, expected)

    def test_sets_of_members(self):
        """Members that are told apart by one property each."""
        rows = [
            ("by pointer", "ColorType.Substrate SubstrateType.Color ParentColorSpace.ColorSpace",
             lambda m: m.by_pointer),
            ("always written", "ColorSpaceSpecificationType.DeviceFilter", lambda m: m.always_written),
            ("not counted", "ColorSpaceSpecificationType.DeviceFilter", lambda m: not m.counts_for_occurs),
            ("optional without isset_", "ColorSpaceSpecificationType.DeviceFilter",
             lambda m: not m.minimum and not m.repeating and not m.has_isset),
            ("mandatory or repeating with isset_", "", lambda m: m.has_isset and (m.minimum or m.repeating)),
            ("own code for a text", "Header.ChangeHistory", lambda m: m.simple_type_error is not None),
        ]
        for why, expected, predicate in rows:
            with self.subTest(why):
                found = {f"{name}.{m.name}" for name, cls in self.classes.items() for m in cls.members if predicate(m)}
                self.assertEqual(found, set(expected.split()))
        self.assertEqual(self.classes["Header"].members[3].simple_type_error, 29)

    def test_items(self):
        """The name of a class in reports about it."""
        for name, item in (("ColorType", "Hqf:ColorType"), ("Revision", "Hqf:Revision"),
                           ("CustomAttributeType_ValueChoice", "Hqf:ValueChoice"), ("Preamble", "Hqf:Preamble"),
                           ("ColorantElementType_Colorant", "Hqf:Colorant"), ("FunctionDECMC", "Hqf:FunctionDECMC")):
            self.assertEqual(self.vocabulary.item(self.classes[name]), item)

    def test_documentation(self):
        """Whatever gets an accessor has a sentence for its comment, and every class stands in a part."""
        for name, cls in self.classes.items():
            places = [*cls.members, *cls.attributes, *cls.options, *([cls.body] if cls.body else [])]
            for doc in [cls.doc] + [place.doc for place in places]:
                self.assertRegex(doc, r"^[A-Z].*\.$", name)
            self.assertIn(cls.part, "document owners palettes spaces recipes specifications substrates devices "
                                    "functions".split())

    def test_strictness(self):
        text = SCHEMA.read_text(encoding="utf-8")
        with tempfile.TemporaryDirectory() as folder:
            path = pathlib.Path(folder) / "broken.xsd"
            for old, new, message in (row.split("\t") for row in table("broken")):
                with self.subTest(f"{old} -> {new}"):
                    self.assertIn(old, text)
                    path.write_text(text.replace(old, new), encoding="utf-8")
                    with self.assertRaisesRegex(SchemaError, message) as caught:
                        vocabulary.load(path)
                    if message not in ("the fact document",):
                        self.assertRegex(str(caught.exception), r"^broken\.xsd:")


if __name__ == "__main__":
    unittest.main()
