// The library's main job from C#: loads the measured colours of a rendition chart, prints them, adds a colour, changes
// the header, writes the document plain and as an archive, loads both again and tells what changed.
//
// usage: mono chart_csharp.exe CHART.hqf NEW          writes NEW.hqf and NEW.hqfz

using System;
using System.Globalization;
using System.IO;
using System.Text;
using HqfV2;

static class Chart {
    static int Main(string[] arguments) {
        if (arguments.Length != 2) {
            Console.Error.WriteLine("usage: mono chart_csharp.exe CHART.hqf NEW");
            return 2;
        }
        CultureInfo.CurrentCulture = CultureInfo.InvariantCulture; // numbers as in the document
        Console.OutputEncoding = new UTF8Encoding(false);
        try {
            Run(arguments[0], arguments[1]);
            return 0;
        } catch (HqfException error) // a value, a file or a document that the library refused
        {
            Console.Error.WriteLine(error.Message);
            return 1;
        }
    }

    static void Run(string chartPath, string newName) {
        using (var document = new Hqf()) {
            document.LoadFile(chartPath);
            foreach (PaletteType palette in document.Palettes)
                Print(palette);

            using (var original = new Hqf(document)) // a deep copy, to compare with
            {
                Edit(document);
                PrintChanges(original, document);
            }

            // The archive first: it is packed from the plain file of its name, which goes away with that.
            document.WriteFile(newName + ".hqfz");
            document.WriteFile(newName + ".hqf");
            Compare(document, newName + ".hqf");
            Compare(document, newName + ".hqfz");
        }
    }

    static void Edit(Hqf document) {
        Header header = document.Preamble.Header;
        header.Name = "Colour rendition chart with a leaf";
        header.Purpose = "Demonstration";
        header.ChangeHistories.Add(DateTimeOffset.UtcNow);
        ColorType leaf = document.Palettes[0].ColorSets[0].Colors.Add();
        Leaf.Fill(leaf);
        try {
            leaf.ColorSpaces[0].ColorSpaceCIELab.L = 151;
        } catch (HqfException error) {
            Console.WriteLine("\nL* of 151 is refused: " + error.Message);
        }
    }

    static void Print(PaletteType palette) {
        Console.WriteLine(palette.PaletteName);
        foreach (ColorSetType set in palette.ColorSets) {
            Console.WriteLine("\n" + set.ColorSetName);
            foreach (ColorType color in set.Colors)
                Print(color);
        }
    }

    static void Print(ColorType color) {
        string values = "", points = "";
        foreach (sg_ColorSpace form in color.ColorSpaces) {
            // One of the two is there, or neither: a colour may have values in 25 more forms.
            if (form.ColorSpaceCIELab is ColorSpaceCIELabType lab)
                values = string.Format("{0,8:F2}{1,8:F2}{2,8:F2}", lab.L, lab.A, lab.B);
            if (form.ColorSpaceSpectral is ColorSpaceSpectralType spectrum)
                points = spectrum.ReflectancePoints.Count + " points";
        }
        Console.WriteLine("{0,2}  {1,-18}{2}  {3}", color.ColorNumber, color.ColorName, values, points);
    }

    static void PrintChanges(Hqf before, Hqf after) {
        Header was = before.Preamble.Header, now = after.Preamble.Header;
        ColorSetType oldSet = before.Palettes[0].ColorSets[0], newSet = after.Palettes[0].ColorSets[0];
        Console.WriteLine("\nWhat changed\n");
        Console.WriteLine("  Name: {0}  ->  {1}", was.Name, now.Name);
        Console.WriteLine("  Purpose: {0}  ->  {1}", was.Purpose, now.Purpose);
        Console.WriteLine("  ChangeHistory: {0}  ->  {1} entries", was.ChangeHistories.Count,
                          now.ChangeHistories.Count);
        Console.WriteLine("  {0}: {1}  ->  {2} colours", newSet.ColorSetName, oldSet.Colors.Count, newSet.Colors.Count);
        for (int i = oldSet.Colors.Count; i < newSet.Colors.Count; ++i)
            Print(newSet.Colors[i]);
    }

    static void Compare(Hqf document, string path) {
        using (var again = new Hqf()) {
            again.LoadFile(path);
            Console.WriteLine("  {0}, {1} bytes: {2}", path, new FileInfo(path).Length,
                              again.ContentEquals(document) ? "equals the document in memory" : "DIFFERS");
        }
    }
}
