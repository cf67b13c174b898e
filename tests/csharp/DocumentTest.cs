using System;
using System.IO;
using System.Text;
using HqfV2;
using static Runner;

// A palette from nothing, written, read, edited, compared; and what a load refuses.
static class DocumentTest {
    internal static void Run() {
        RoundTrips();
        Elements();
        Refused();
    }

    static void RoundTrips() {
        foreach (string path in new[] { "csharp-test.hqfz", "csharp-test-😀.hqf" }) {
            using (Hqf document = Documents.Palette(3)) {
                Documents.FirstSet(document).Colors[0].ColorName = "Farbe 色 😀";
                True("what was built is complete", document.IsOccursOk());
                document.WriteFile(path);
                using (var again = new Hqf()) {
                    again.LoadFile(path);
                    True(path + " holds the document", again.ContentEquals(document));
                    ColorType color = Documents.FirstSet(again).Colors[0];
                    Equal(path + ", a name", "Farbe 色 😀", color.ColorName);
                    ColorSpaceCIELabType lab = color.ColorSpaces[0].ColorSpaceCIELab;
                    Equal(path + ", values", "0 -1.5 2.25", lab.L + " " + lab.A + " " + lab.B);
                    lab.A = 3;
                    True(path + ", edited, differs", !again.ContentEquals(document));
                    Documents.FirstSet(document).Colors[0].ColorSpaces[0].ColorSpaceCIELab.A = 3;
                    True(path + ", edited likewise, equals", again.ContentEquals(document));
                    again.LoadString(document.WriteString());
                    Equal("a second load adds", 2, again.Palettes.Count);
                }
                byte[] start = new byte[2];
                using (FileStream stream = File.OpenRead(path)) stream.Read(start, 0, 2);
                Equal(path + " is of its kind", path.EndsWith("z") ? "PK" : "<?", Encoding.ASCII.GetString(start));
                File.Delete(path);
            }
        }
    }

    static void Elements() {
        var lab = new ColorSpaceCIELab { L = 1, A = 2, B = 3 };
        lab.ChangeHistories.Add(Documents.When);
        lab.ColorSpaceSpecificationSpectrumTristimulus.SetNil();
        lab.Marshal("csharp-test.xml");
        var again = new ColorSpaceCIELab();
        again.Unmarshal("csharp-test.xml");
        Equal("an element from a file", 3.0, again.B);
        again.Reset();
        again.Unmarshal(File.ReadAllBytes("csharp-test.xml"));
        Equal("an element from memory", 3.0, again.B);
        File.Delete("csharp-test.xml");
        Refuses("no bytes", 34, () => again.Unmarshal(new byte[0]));
    }

    static void Refused() {
        var empty = new Hqf();
        var rows = new(string Why, int Code, Action Act)[] {
            ("a missing file", 1, () => empty.LoadFile("no-such-file.hqf")),
            ("a missing archive", 1000, () => empty.LoadFile("no-such-file.hqfz")),
            ("an empty path", 1, () => empty.LoadFile("")),
            ("a path that is neither", 1001, () => Documents.Palette(1).WriteFile("a.txt")),
            ("a document that is incomplete", 46, () => new Hqf().WriteString()),
            ("text that is no XML", 34, () => empty.LoadString("palette")),
        };
        foreach (var row in rows)
            Refuses(row.Why, row.Code, row.Act);
        Throws<HqfException>("the message names the file", () => empty.LoadFile("no-such-file.hqf"),
                             "Hqf.LoadFile(\"no-such-file.hqf\"): Unable to open file");
    }
}
