using System;
using HqfV2;
using static Runner;

// What members do, each rule on one class that has it.
static class MembersTest {
    internal static void Run() {
        Values();
        Nulls();
        Options();
        Identities();
    }

    static void Values() {
        var lab = new ColorSpaceCIELabType { L = 50 };
        var light = new IlluminationOptionsType();
        var rows = new(string Why, int Code, Action Set)[] {
            ("above the maximum", 36, () => lab.L = 150.01),
            ("below the minimum", 37, () => lab.L = -0.01),
            ("no number", 37, () => lab.L = double.NaN),
            ("a text that is no literal", 38, () => new SampleType().Backing = "Backing_Green"),
            ("an empty text", 20, () => new GeometryChoiceType().UnknownGeometry = ""),
            ("an option above its maximum", 36, () => light.ColorTemperature = 0x80000000),
        };
        foreach (var row in rows)
            Refuses(row.Why, row.Code, row.Set);
        Equal("a refused value changes nothing", 50.0, lab.L);
        Equal("a refused option is chosen", IlluminationOptionsType.Choice.ColorTemperature, light.Chosen);
        try {
            lab.L = 151;
        } catch (HqfException error) {
            Equal("an exception's parts", "ValueGreaterThanSpecifiedMaximum ColorSpaceCIELabType.L",
                  error.Code + " " + error.Member);
            Equal("message", "ColorSpaceCIELabType.L: Value greater than specified maximum (36)", error.Message);
        }

        var sample = new SampleType { BackingAsEnum = SampleType.BackingLiteral.Backing_White };
        foreach (int number in new[] { -1, 0, 5 })
            Throws<ArgumentOutOfRangeException>("number " + number + " of four literals",
                                                () => sample.BackingAsEnum = (SampleType.BackingLiteral)number,
                                                "SampleType.Backing");
        Equal("a wrong number changes nothing", "Backing_White", sample.Backing);

        var axis = new FloatingPointValueType();
        True("a default is there unset", axis.AxisNominalScale == "Scale_Linear" && !axis.IsSetAxisNominalScale);
        axis.AxisNominalScale = "Scale_Log";
        True("and can be set", axis.IsSetAxisNominalScale);
        axis.AxisNominalScale = null;
        Equal("and comes back", "Scale_Linear", axis.AxisNominalScale);

        var version = new SDKVersion { Value = "1" };
        version.SetNil();
        True("nil", version.IsNil);
        version.Value = "2";
        True("a value ends nil", !version.IsNil);
    }

    static void Nulls() {
        var lab = new ColorSpaceCIELabType();
        var rows = new(string Why, string Message, Action Act)[] {
            ("copied", "hqf_v2::Hqf const & type is null", () => new Hqf(null)),
            ("swapped", "hqf_v2::ColorSpaceCIELabType & type is null", () => lab.Swap(null)),
            ("for a mandatory part", "hqf_v2::Header const & type is null", () => new Preamble().Header = null),
            ("for a date in a list", "lmx::tc_datetime const & type is null", () => lab.ChangeHistories.Add(null)),
            ("for a runtime's value", "lmx::c_decimal const & type is null", () => new c_decimal((c_decimal)null)),
            ("for narrow text", "null string", () => Lmx.Length(null)),
            ("for a type's name", "null string", () => FunctionType.Factory(1000, null)),
            ("for a file's name", "null string", () => new Hqf().Marshal(null)),
            ("for memory", "null string", () => new Hqf().Unmarshal((byte[])null)),
            ("for foreign XML", "null string", () => new Revision().Any.Add(null)),
            ("for a path", "", () => new Hqf().LoadFile(null)),
            ("for an object in a list", "", () => new Hqf().Palettes.Add(null)),
            ("for text in a list", "", () => new ColorType().SemanticAssociations.Add(null)),
            ("for an option", "", () => new CustomAttributeType_ValueChoice().DoubleValue = null),
            ("to take over", "", () => new sg_Function().TakeFunction(null)),
            ("to compare with", "", () => Lmx.Stringncompare("a", null, 0, 1)),
        };
        foreach (var row in rows)
            Throws<ArgumentNullException>("null " + row.Why, row.Act, row.Message);
        Equal("nothing is left behind for the next call", 1u, Lmx.Length("x"));
    }

    static void Options() {
        var form = new sg_ColorSpace();
        True("reading an option chooses nothing",
             form.ColorSpaceCIELab == null && form.Chosen == sg_ColorSpace.Choice.None);
        ColorSpaceCIELabType lab = form.ChooseColorSpaceCIELab();
        lab.L = 7;
        Equal("choosing again keeps the object", 7.0, form.ChooseColorSpaceCIELab().L);
        form.ColorSpaceSRGB = new ColorSpaceSRGBType { Red = 0.5 };
        Equal("storing chooses and copies", 0.5, form.ColorSpaceSRGB.Red);
        True("the other option is null", form.ColorSpaceCIELab == null);
        Throws<ObjectDisposedException>("and its object gone", () => lab.L = 8);
        var value = new CustomAttributeType_ValueChoice { IntegerValue = 3 };
        True("an option's number", value.IntegerValue == 3 && value.DoubleValue == null);
    }

    static void Identities() {
        FunctionType made = FunctionType.Factory(1000, "FunctionDE94Type");
        Equal("a factory's object has its own class", typeof(FunctionDE94Type), made.GetType());
        True("identity of its class", made.GetId().Equals(FunctionDE94Type.ClassId));
        True("and of its base", made.HasId(FunctionType.ClassId) && !made.HasId(FunctionDEType.ClassId));
        Equal("clone of an element's object", typeof(ColorSpaceCIELabType), new ColorSpaceCIELab().Clone().GetType());
        Equal("a namespace without types", null, FunctionType.Factory(1, "FunctionDE94Type"));

        var group = new sg_Function();
        CustomAttributeType removed = made.CustomAttributes.Add();
        made.CustomAttributes.Clear();
        group.TakeFunction(made);
        Throws<ObjectDisposedException>("what was gone before it was taken over", () => removed.Reset());
        Equal("an object taken over has its class", typeof(FunctionDE94Type), group.Function.GetType());
        made.Result = 2;
        Equal("and is the same object", 2.0, group.Function.Result);
        Throws<ArgumentException>("a part can't be taken", () => new sg_Function().TakeFunction(made));
        group.Dispose();
        Throws<ObjectDisposedException>("what was taken goes with its new parent", () => made.Result = 3);
    }
}
