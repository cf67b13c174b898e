// What the C# classes cost: single calls, and a whole document that is loaded and then read to its last value.
//
// usage: mono bench_csharp.exe CHART.hqf

using System;
using System.Diagnostics;
using System.Linq;
using HqfV2;

static class Bench {
    static void Main(string[] arguments) {
        using (var document = new Hqf()) {
            document.LoadFile(arguments[0]);
            string xml = document.WriteString();
            ColorType color = document.Palettes[0].ColorSets[0].Colors[0];
            ColorSpaceCIELabType lab = color.ColorSpaces.Select(form => form.ColorSpaceCIELab).First(l => l != null);
            Report("get a double", 3000000, () => GC.KeepAlive(lab.L > 0));
            Report("set a double", 3000000, () => lab.L = 37.82);
            Report("get a text", 1000000, () => GC.KeepAlive(color.ColorName));
            Report("set a text", 1000000, () => color.ColorName = "Olive green leaf");
            Report("get a part", 1000000, () => GC.KeepAlive(document.Preamble));
            Report("make and dispose an object", 300000, () => new ColorSpaceCIELabType().Dispose());

            long values = 0;
            Report("load " + xml.Length + " characters", 60,
                   () => { using (var one = new Hqf()) one.LoadString(xml); });
            double read = Report("read it whole", 60, () => values = Values(document));
            Console.WriteLine("{0} values, {1:F0} ns each", values, read / values);
        }
    }

    // Every name, number and point of the spectra.
    static long Values(Hqf document) {
        long count = 0;
        foreach (ColorType color in document.Palettes.SelectMany(p => p.ColorSets).SelectMany(s => s.Colors)) {
            count += color.ColorName.Length > 0 ? 1 : 0;
            foreach (sg_ColorSpace form in color.ColorSpaces) {
                switch (form.Chosen) {
                case sg_ColorSpace.Choice.ColorSpaceCIELab:
                    ColorSpaceCIELabType lab = form.ColorSpaceCIELab;
                    count += lab.L + lab.A + lab.B > -1000 ? 3 : 0;
                    break;
                case sg_ColorSpace.Choice.ColorSpaceSRGB:
                    ColorSpaceSRGBType srgb = form.ColorSpaceSRGB;
                    count += srgb.Red + srgb.Green + srgb.Blue > -1000 ? 3 : 0;
                    break;
                case sg_ColorSpace.Choice.ColorSpaceSpectral:
                    foreach (ReflectancePointType point in form.ColorSpaceSpectral.ReflectancePoints)
                        count += point.Wavelength + point.Value > 0 ? 2 : 0;
                    break;
                }
            }
        }
        return count;
    }

    /// <summary>Nanoseconds of one call: the median of nine rounds, after one that compiles it.</summary>
    static double Report(string what, int calls, Action call) {
        call();
        double median = Enumerable.Range(0, 9)
                            .Select(
                                _ => {
                                    Stopwatch watch = Stopwatch.StartNew();
                                    for (int i = 0; i < calls / 9 + 1; ++i)
                                        call();
                                    return watch.Elapsed.TotalMilliseconds * 1e6 / (calls / 9 + 1);
                                })
                            .OrderBy(time => time)
                            .ElementAt(4);
        Console.WriteLine("{0,-28} {1,10:F0} ns", what, median);
        return median;
    }
}
