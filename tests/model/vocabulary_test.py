"""What the generator makes of hqf-v2.xsd: sizes, hand-written member tables, and that nothing unknown slips through.

The tables stand here a second time on purpose. An edit of the schema that moves a bound, an order or a literal turns
them red, whoever made it.
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

COUNTS = {
    "classes": 205, "with members": 138, "element classes without members": 63, "group classes": 4,
    "with entry points": 68, "nillable classes": 12, "tolerant classes": 36,
    "child elements": 580, "repeating child elements": 159, "attributes": 140, "options": 18, "group members": 128,
    "types by xsi:type": 17, "nilled elements": 80, "literals by place": 262, "literals": 90, "enumerations": 19,
    "lower bounds": 86, "upper bounds": 66,
}

FORM = "CustomAttribute:CustomAttributeType* ParentColorSpace:ParentColorSpace? ChangeHistory+ "

SPECIFICATION = ("CustomAttribute:CustomAttributeType* Profile:ProfileType? Device:DeviceType? "
                 "DeviceFilter:DeviceFilter? DevicePolarization:DevicePolarization ChangeHistory+ ")

# Children in document order, the base's first: name, class where it isn't a simple value, and ? * + by occurrence.
CHILDREN = {
    "Hqf": "Preamble:Preamble Color:ColorType* Palette:PaletteType* ColorQualityControl:ColorQualityControlType*",
    "Preamble": "Header:Header Owner:OwnerType? Version:Version?",
    "Header": "CustomAttribute:CustomAttributeType* Creator CreatorVersion ChangeHistory+ Purpose Name? Comments? "
              "ReadSDKInformation:SDKType? WriteSDKInformation:SDKType? ReadPlatformInformation:PlatformType? "
              "WritePlatformInformation:PlatformType? Revision:Revision*",
    "SDKType": "SDKName SDKVersion:SDKVersion",
    "OwnerType": "CustomAttribute:CustomAttributeType* Person:Person* Copyright* Company*",
    "Person": "Name ContactInfo?",
    "Version": "CustomAttribute:CustomAttributeType* Version Predecessor*",
    "Revision": "any+",
    "CustomAttributeType": "Name ValueChoice:CustomAttributeType_ValueChoice",
    "CustomAttributes": "CustomAttribute:CustomAttributeType",
    "PaletteType": "CustomAttribute:CustomAttributeType* ChangeHistory+ Owner:OwnerType? SemanticAssociation* "
                   "CollectionColorSpaceSpecification:CollectionColorSpaceSpecificationType? ColorSet:ColorSetType*",
    "ColorSetType": "CustomAttribute:CustomAttributeType* ChangeHistory+ Owner:OwnerType? SemanticAssociation* "
                    "CollectionColorSpaceSpecification:CollectionColorSpaceSpecificationType? Color:ColorType* "
                    "Substrate:sg_Substrate?",
    "ColorType": "CustomAttribute:CustomAttributeType* ChangeHistory+ Owner:OwnerType? SemanticAssociation* "
                 "ColorSpace:sg_ColorSpace+ Substrate:sg_Substrate?",
    "CollectionColorSpaceSpecificationType":
        "ColorSpaceSpecificationSpectrumGeneric:ColorSpaceSpecificationSpectrumGenericType? "
        "ColorSpaceSpecificationSpectrumSpectral:ColorSpaceSpecificationSpectrumSpectralType? "
        "ColorSpaceSpecificationSpectrumTristimulus:ColorSpaceSpecificationSpectrumTristimulusType? "
        "ColorSpaceSpecificationEmissiveGeneric:ColorSpaceSpecificationEmissiveGenericType? "
        "ColorSpaceSpecificationEmissiveSpectral:ColorSpaceSpecificationEmissiveSpectralType? "
        "ColorSpaceSpecificationEmissiveTristimulus:ColorSpaceSpecificationEmissiveTristimulusType?",
    "ParentColorSpace": "ColorSpace:sg_ColorSpace",
    "ColorSpaceRecipe":
        FORM + "ColorSpaceSpecificationSpectrumGeneric:ColorSpaceSpecificationSpectrumGeneric "
        "ColorantElement:ColorantElementType+ BaseElement:BaseElementType?",
    "ColorSpaceCMYK":
        FORM + "ColorSpaceSpecificationSpectrumGeneric:ColorSpaceSpecificationSpectrumGeneric "
        "Cyan Magenta Yellow Black SpotColor:SpotColorType*",
    "ColorSpaceTINTREFSextetType":
        FORM + "ColorSpaceSpecificationSpectrumGeneric:ColorSpaceSpecificationSpectrumGeneric "
        "Cyan Magenta Yellow Black Orange Green SpotColor:SpotColorType*",
    **{f"ColorSpace{form}Type":
        FORM + "ColorSpaceSpecificationSpectrumTristimulus:ColorSpaceSpecificationSpectrumTristimulus "
        "Red Green Blue Alpha? ColorDepth" for form in ("RGB", "SRGB", "AdobeRGB", "AdobeWideGamutRGB")},
    "ColorSpaceTINTREFType":
        FORM + "FamilyName ColorName:ColorName Page Gamut Recipe:Recipe? ColorAndFinish:ColorAndFinish*",
    "Recipe": "ColorantElement:ColorantElement+",
    "ColorAndFinish": "Finish ColorSpaceSpectral:ColorSpaceSpectralType",
    "ColorantElementType": "Colorant:ColorantElementType_Colorant Contribution",
    "ColorantElement": "Colorant:Colorant Contribution",
    "ColorantElementType_Colorant":
        "CustomAttribute:CustomAttributeType* Name Manufacturer PartNumber Density:Density",
    "Colorant": "CustomAttributes:CustomAttributes* Name Manufacturer? PartNumber? Density?",
    "Base": "CustomAttribute:CustomAttributeType* Name Manufacturer PartNumber Density?",
    **{name: SPECIFICATION + own for name, own in {
        "ColorSpaceSpecificationSpectrumGeneric":
            "Spectrum:SpectrumType GeometryChoice:GeometryChoiceType? IlluminationOptions:IlluminationOptionsType? "
            "FieldOfView? ASTM_Table? Gamma? DensityStatus?",
        "ColorSpaceSpecificationSpectrumTristimulus":
            "Spectrum:SpectrumType IlluminationOptions:IlluminationOptionsType FieldOfView "
            "GeometryChoice:GeometryChoiceType? ASTM_Table? Gamma?",
        "ColorSpaceSpecificationSpectrumSpectralType":
            "Spectrum:SpectrumType GeometryChoice:GeometryChoiceType ASTM_Table?",
        "ColorSpaceSpecificationEmissiveGenericType":
            "EmissiveType EmissiveMode GeometryChoice:GeometryChoiceType? IlluminationOptions:IlluminationOptionsType? "
            "FieldOfView? ASTM_Table? Gamma? DensityStatus?",
        "ColorSpaceSpecificationEmissiveTristimulus":
            "EmissiveType EmissiveMode IlluminationOptions:IlluminationOptionsType FieldOfView "
            "GeometryChoice:GeometryChoiceType? ASTM_Table? Gamma?",
        "ColorSpaceSpecificationEmissiveSpectral":
            "EmissiveType EmissiveMode GeometryChoice:GeometryChoiceType ASTM_Table?"}.items()},
    "SampleTarget": "CustomAttribute:CustomAttributeType* Substrate:sg_Substrate Backing? Manufacturer? "
                    "ProductionDate? SerialNumber? Comment? Target",
    "PhysicalSampleType": "CustomAttribute:CustomAttributeType* Coating? Process:Process? Sample:sg_Sample",
    "SubstratePaper": "CustomAttribute:CustomAttributeType* PartNumber? Color:ColorType? PaperThickness? PaperType?",
    "Process": "Name Thickness?",
    "DeviceType": "CustomAttribute:CustomAttributeType* Manufacturer Model SerialNumber DeviceClass? FirmwareVersion? "
                  "BootFirmwareVersion? CalibrationState:CalibrationStateType? DeviceSettings:DeviceSettings?",
    "DeviceSettings": "CustomAttribute:CustomAttributeType* Aperture? LensPosition? GlassCompensation? "
                      "GlossCompensation:GlossCompensation? Averaging:Averaging? RemoteTuner?",
    "ProfileType": "ProfileChoice:ProfileChoice Parameters:ProfileType_Parameters* Created?",
    "ColorQualityControlType": "CustomAttribute:CustomAttributeType* ChangeHistory+ "
                               "StandardAndMeasurement:StandardAndMeasurementType+ PhysicalSample:PhysicalSampleType "
                               "Tolerance:ToleranceType*",
    "StandardAndMeasurementType": "CustomAttribute:CustomAttributeType* Measurement:Measurement* Standard:Standard",
    "Standard": "CustomAttribute:CustomAttributeType* Device:DeviceType Color:ColorType Tolerance:ToleranceType*",
    "LimitsType": "CustomAttribute:CustomAttributeType* HighTolerance LowTolerance?",
    "Measurement": "CustomAttribute:CustomAttributeType* Device:DeviceType Color:ColorType Function:sg_Function*",
    "ToleranceType": "CustomAttribute:CustomAttributeType* Function:sg_Function Limits:LimitsType? PrimaryIlluminant? "
                     "SecondaryIlluminant? TertiaryIlluminant? FieldOfView?",
    "FunctionGeneric": "CustomAttribute:CustomAttributeType* Result? Name Parameters:Parameters*",
    "FunctionDECMC": "CustomAttribute:CustomAttributeType* Result? Param_l Param_c",
}

# Attributes in writing order, the base's first; ! is required.
ATTRIBUTES = {
    "PaletteType": "PaletteName! PalettePartNumber PaletteVersion UniqueID Comments",
    "ColorType": "ColorName! UniqueID ColorNumber Comments",
    "ColorSpaceGeneric": "Comments UniqueID Name!",
    "ColorSpaceEmissiveGeneric": "Comments UniqueID Name!",
    "ColorSpaceCIELabType": "Comments UniqueID Name",
    "ColorSpaceSpecificationSpectrumGeneric": "Comments UniqueID",
    "DensityType": "DensityStatus! DensityFilter!",
    "FloatingPointValueType": "AxisNominalMax! AxisNominalMin! AxisNominalScale",
    "IlluminationOptionsType": "Description",
    "DeviceFilter": "CustomOrPartial",
    "Averaging": "AveragingValue!",
    "GlossCompensation": "CompensationValue!",
    "ReflectancePointType": "Wavelength!",
    "EmissiveSpectralPointType": "Wavelength!",
    "ProfileType": "Direction!",
    "ColorSetType": "ColorSetName! UniqueID PartNumber Comments",
}

# Kind and rule of values; "" names the body. C collapses white space.
VALUES = """
Header.ChangeHistory datetime C; Version.Predecessor string C; Version.Version string
ProfileChoice.ProfileURI string C; CustomAttributeType.Name string length 1..
ProfileType_Parameters.Name string length 1..1; Parameters.Name string; FunctionGenericType.Name string C length 1..
ColorSpaceMunsellType.ColorName string length 1..; ColorSpaceNCSType.ColorName string
ColorSpaceCIELabType.L double C [0, 150]; ColorSpaceCIELabType.B double C [-150, 150]
ColorSpaceCIELChType.L double C [0, 100]; ColorSpaceCIELChType.C double C [0, 150]
ColorSpaceCIELChType.H double C [0, 360); ColorSpaceHSVType.Hue double C [0, 360)
ColorSpaceCIEXYZType.Z double C [0, 1]; ColorSpaceEmissiveCIEXYZType.Z double C [0, )
ColorSpaceCIExyYType.CapY double C [0, 1]; ColorSpaceEmissiveCIExyYType.CapY double C [0, )
ColorSpaceEmissiveCIExyYType.Y double C [0, 1]; ColorSpaceCIELuvType.U double C [-134, 220]
ColorSpaceCIELuvType.V double C [-140, 122]; ColorSpaceYUVType.U double C [-0.436, 0.436]
ColorSpaceYUVType.V double C [-0.615, 0.615]; ColorSpaceYIQType.I double C [-0.5957, 0.5957]
ColorSpaceYIQType.Q double C [-0.5226, 0.5226]; ColorSpaceYBRType.R double C [0, 1]
ColorSpaceCMYKType.Black double C [0, 100]; SpotColorType.Percentage double C [0, 100]
ReflectancePointType. double C (-1, 10); ReflectancePointType.Wavelength double C (0, )
EmissiveSpectralPointType. double C; Density. double C (0, ); Colorant.Density double C (0, )
ColorantElementType.Contribution double C [0, 1]; ColorantElement.Contribution double C [0, )
BaseElementType.Contribution double C [0, ); Process.Thickness double C [0, )
FunctionDE2000Type.Param_h double C [0, ); FunctionType.Result double C
WhitePointChromaticity.CoordinateY double C [0, 1]
IlluminationOptionsType.ColorTemperature unsigned int C (0, 2147483647] text, setter without minimum
DeviceSettings.Aperture unsigned int C (0, 2147483647] text, setter without minimum
DeviceSettings.LensPosition int C [-2147483648, 2147483647] text
CustomAttributeType_ValueChoice.IntegerValue int C [-2147483648, 2147483647] text
Averaging.AveragingValue unsigned char C [2, 99] text; Averaging. bool C; DevicePolarization. bool C
ProfileFile. binary C base64; SDKVersion. string; CalibrationStateType.CalibrationDateTime datetime C
"""

LITERALS = """
ColorSpaceAdobeRGBType.ColorDepth 4 1=ColorDepth_Infinite 2=ColorDepth_8 4=ColorDepth_32
DensityType.DensityFilter 10 1=Filter_Visual 5=Filter_Black 9=Filter_A 10=Filter_B
DensityType.DensityStatus 12 5=Status_SpectralX 9=Status_Txp 12=Status_DIN-NB
FloatingPointValueType.AxisNominalScale 3 1=Scale_Linear 3=Scale_Other
SpectrumType. 4 2=Spectrum_Transmittance 3=Spectrum_TotalTransmittance
ColorSpaceSpecificationEmissiveType.EmissiveType 3 2=Emissive_SpotAmbient
ColorSpaceSpecificationEmissiveType.EmissiveMode 2 1=EmissiveMode_Diffuser
ToleranceType.FieldOfView 2 1=FieldOfView_2_Degree
ColorSpaceSpecificationSpectrumSpectralType.ASTM_Table 2 2=E308_Table6
GeometryChoiceType.SphereGeometry 2 1=Sphere_Included
Illuminant. 15 4=Illuminant_D50 8=Illuminant_E 11=Illuminant_F7 14=Illuminant_9300
ToleranceType.TertiaryIlluminant 15 1=Illuminant_A 15=Illuminant_Custom
SampleType.Backing 4 3=Backing_Self
SampleTargetType.Target 6 1=Target_IT8.7/1 5=Target_ECI2002
DeviceType.DeviceClass 3 2=DeviceClass_Scanning
CalibrationStateType. 3 1=CalibrationState_NotCalibrated
DeviceFilter. 5 2=Filter_UVExcluded 3=Filter_UVD65
ProfileType.Direction 3 3=Profile_Both
ColorSpaceTINTREFType.Gamut 4 2=Gamut_sRGB
ColorAndFinish.Finish 3 3=Finish_Matte
"""

OPTIONS = {
    "ValueChoice": "Double String",
    "CustomAttributeType_ValueChoice": "DoubleValue IntegerValue StringValue",
    "ProfileType_Parameters_ValueChoice": "DoubleValue IntegerValue StringValue",
    "AxisValueChoice": "AxisFloatingPointValue:FloatingPointValueType AxisStringValue",
    "ProfileChoice": "ProfileFile:ProfileFile ProfileURI",
    "GeometryChoiceType": "SphereGeometry Angle UnknownGeometry",
    "IlluminationOptionsType": "Illuminant:Illuminant WhitePointChromaticity:WhitePointChromaticity ColorTemperature",
}

STD_DEV = ["FunctionStdDev" + channel for channel in "XYZLABCH"] + ["FunctionAverageStdDev" + c for c in "LAB"]

GROUPS = {
    "sg_ColorSpace": ["ColorSpace" + form for form in (
        "Recipe TINTREF Generic EmissiveGeneric Density RGB SRGB AdobeRGB AdobeWideGamutRGB Spectral EmissiveSpectral "
        "CIELab CIELCh CIEXYZ EmissiveCIEXYZ CIExyY EmissiveCIExyY CIELuv HSL HSV CMYK TINTREFSextet YUV YIQ YBR NCS "
        "Munsell").split()],
    "sg_Substrate": ["Substrate" + kind for kind in
                     "Paper Generic Metal Plastic Wood Vinyl Tile Film Textile".split()],
    "sg_Sample": ["SampleSpot", "SampleTarget"],
    "sg_Function": "Function FunctionGeneric FunctionDE FunctionMeanDE FunctionDE94 FunctionDE2000 "
                   "FunctionDECMC".split() + STD_DEV,
}

LEAVES = [branch + leaf for branch in ("Spectrum", "Emissive") for leaf in ("Generic", "Tristimulus", "Spectral")]

TOLERANT = set(
    "CollectionColorSpaceSpecificationType ColorAndFinish CustomAttributes DeviceSettings OwnerType Parameters "
    "ParentColorSpace Person Process ProfileType_Parameters Recipe Revision Version FunctionType FunctionDEType "
    "FunctionMeanDEType SubstrateType SubstratePaperType SubstrateMetalType SubstratePlasticType SubstrateWoodType "
    "SubstrateVinylType SubstrateTileType SubstrateFilmType SubstrateTextileType".split()
    + [name + "Type" for name in STD_DEV])

NILLABLE = {"SDKVersion", "DevicePolarization", "DeviceFilter", "Density", "ParentColorSpace", "Standard"} | {
    "ColorSpaceSpecification" + leaf for leaf in LEAVES}

# An edit of the schema, and a piece of the message that must stop the generator.
BROKEN = [
    ("<g:tolerant/>", "<g:indulgent/>", "a fact that the generator doesn't know"),
    ("<g:unread-code>29</g:unread-code>", "<g:unread-code/>", "needs a text"),
    ("<g:unread-code>29</g:unread-code>", "<g:unread-code>many</g:unread-code>", "a number"),
    ("<g:setter-skips-minimum/>", "<g:setter-skips-minimum/><g:setter-skips-minimum/>", "given twice"),
    ("<g:minimums-at-end/>", "<g:by-pointer/>", "can't be about a named type"),
    ('<xs:element name="Page" type="xs:string">',
     '<xs:element name="Page" type="xs:string"><xs:annotation><xs:appinfo><g:by-pointer/></xs:appinfo>'
     "</xs:annotation></xs:element><xs:element name='Leaf' type='xs:string'>", "held by pointer"),
    ("<g:class>CustomAttributeType_ValueChoice</g:class>", "", "a second class ValueChoice"),
    ("<g:document/>", "", "the fact document"),
    ("<g:part>owners</g:part>", "", "stands in no part"),
    ('<xs:maxExclusive value="360"/>', '<xs:totalDigits value="3"/>', "a facet that is not understood"),
    ('<xs:maxExclusive value="360"/>', '<xs:maxExclusive value="round"/>', "no number"),
    ('<xs:maxExclusive value="360"/>', '<xs:maxExclusive value="360"/><xs:maxInclusive value="360"/>', "two facets"),
    ('<xs:maxExclusive value="360"/>', '<xs:maxLength value="3"/>', "not understood on xs:double"),
    ('type="Hqf:hueAngle"', 'type="Hqf:from0To150"', "a type that nothing uses"),
    ('<xs:element name="Creator" type="xs:string"', '<xs:element name="Creator" type="xs:string" fixed="x"', "fixed"),
    ('<xs:element name="Creator" type="xs:string"', '<xs:element name="Creator" type="xs:anyURI"', "xs:anyURI"),
    ('<xs:element name="Creator" type="xs:string"', '<xs:element name="Creator" type="Hqf:Nobody"', "Nobody"),
    ('<xs:element name="Creator" type="xs:string"', '<xs:element name="Creator" type="xs:string" maxOccurs="9"',
     "1 or unbounded"),
    ('<xs:element name="LowTolerance" type="xs:double"', '<xs:element name="LowTolerance" type="Hqf:LimitsType"',
     "contains itself by value"),
    ('type="Hqf:OwnerType" minOccurs="0"', 'type="Hqf:Version" minOccurs="0"', "of one element of its name"),
    ('<xs:any namespace="##any"', '<xs:any namespace="##other"', "wildcard"),
    ('default="Scale_Linear"', 'default="Scale_Round"', "a default"),
    ('<xs:element name="SampleSpot" type="Hqf:SampleSpotType"', '<xs:element name="SampleSpot" type="Hqf:DeviceType"',
     "doesn't extend SampleType"),
    ("xs:choice>", "xs:all>", "not understood in complexType"),
    ("</xs:schema>", '<xs:group name="Extra"/></xs:schema>', "not understood here"),
]


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

    def test_format(self):
        self.assertEqual((self.vocabulary.prefix, self.vocabulary.version), ("Hqf", "2"))
        self.assertTrue(self.vocabulary.namespace_uri.endswith("/v2"))

    def test_children(self):
        for name, expected in CHILDREN.items():
            with self.subTest(name):
                members = self.vocabulary.all_members(self.classes[name])
                self.assertEqual(" ".join(map(child, members)), expected)

    def test_attributes(self):
        for name, expected in ATTRIBUTES.items():
            with self.subTest(name):
                attributes = self.vocabulary.all_attributes(self.classes[name])
                self.assertEqual(" ".join(a.name + "!" * a.required for a in attributes), expected)
        defaults = {a.name: a.default for cls in self.classes.values() for a in cls.attributes if a.default}
        self.assertEqual(defaults, {"AxisNominalScale": "Scale_Linear"})

    def test_values(self):
        for row in VALUES.replace(";", "\n").strip().splitlines():
            place, _, expected = row.strip().partition(" ")
            with self.subTest(place):
                self.assertEqual(rule(self.type_of(place)), expected)

    def test_date_pattern(self):
        types = [a.type for cls in self.classes.values() for a in cls.members + cls.attributes if a.type]
        patterns = {type_.pattern for type_ in types if type_.kind == "datetime"}
        self.assertEqual(patterns, {r".+T.+(Z|[+\-].+)"})

    def test_literals(self):
        for row in LITERALS.strip().splitlines():
            place, count, *numbered = row.split()
            with self.subTest(place):
                literals = self.type_of(place).literals
                self.assertEqual(len(literals), int(count))
                for number, literal in (each.split("=") for each in numbered):
                    self.assertEqual(literals[int(number) - 1], literal)

    def test_choices(self):
        choices = {name: " ".join(map(child, cls.options))
                   for name, cls in self.classes.items() if cls.form == "choice"}
        self.assertEqual(choices, OPTIONS)

    def test_groups(self):
        for name, elements in GROUPS.items():
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
                    for name, elements in GROUPS.items()}
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

    def test_order(self):
        """C++ can define the classes one after the other."""
        defined = set()
        for name, cls in self.classes.items():
            by_value = {m.class_name for m in cls.members if m.class_name and not m.repeating and not m.by_pointer}
            self.assertLessEqual(by_value | ({cls.base} if cls.base else set()), defined, name)
            defined.add(name)

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
            for old, new, message in BROKEN:
                with self.subTest(f"{old} -> {new}"):
                    self.assertIn(old, text)
                    path.write_text(text.replace(old, new), encoding="utf-8")
                    with self.assertRaisesRegex(SchemaError, message) as caught:
                        vocabulary.load(path)
                    if message not in ("the fact document",):
                        self.assertRegex(str(caught.exception), r"^broken\.xsd:")


if __name__ == "__main__":
    unittest.main()
