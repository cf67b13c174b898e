using System;
using HqfV2;

// What several tests build.
static class Documents {
    internal static readonly DateTimeOffset When = new DateTimeOffset(2025, 1, 31, 12, 0, 0, TimeSpan.FromHours(1));

    /// <summary>A complete document: one palette of one set, with colours of CIELAB values.</summary>
    internal static Hqf Palette(int colors) {
        var document = new Hqf();
        Header header = document.Preamble.Header;
        header.Creator = "tests";
        header.CreatorVersion = "1";
        header.Purpose = "to be read again";
        header.ChangeHistories.Add(When);
        PaletteType palette = document.Palettes.Add();
        palette.PaletteName = "Palette";
        palette.ChangeHistories.Add(When);
        ColorSetType set = palette.ColorSets.Add();
        set.ColorSetName = "Set";
        set.ChangeHistories.Add(When);
        for (int i = 0; i < colors; ++i)
            Fill(set.Colors.Add(), "Color " + i, i % 100);
        return document;
    }

    internal static void Fill(ColorType color, string name, double lightness) {
        color.ColorName = name;
        color.ChangeHistories.Add(When);
        ColorSpaceCIELabType lab = color.ColorSpaces.Add().ChooseColorSpaceCIELab();
        lab.ChangeHistories.Add(When);
        lab.ColorSpaceSpecificationSpectrumTristimulus.SetNil();
        lab.L = lightness;
        lab.A = -1.5;
        lab.B = 2.25;
    }

    internal static ColorSetType FirstSet(Hqf document) => document.Palettes[0].ColorSets[0];
}
