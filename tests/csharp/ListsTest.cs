using System;
using System.Linq;
using HqfV2;
using static Runner;

static class ListsTest {
    internal static void Run() {
        ObjectList<ColorType> colors = Documents.FirstSet(Documents.Palette(3)).Colors;
        var blue = new ColorType { ColorName = "Blue" };
        colors[1] = blue;
        colors.Insert(0, blue);
        ColorType last = colors.Add(blue);
        Equal("copies replace, go before and behind", "Blue,Color 0,Blue,Color 2,Blue", Names(colors));
        last.ColorName = "Navy";
        Equal("a copy is apart from its source", "Blue Navy", blue.ColorName + " " + colors[4].ColorName);
        colors.RemoveAt(3);
        colors.RemoveAt(0);
        Equal("items removed", "Color 0,Blue,Navy", Names(colors));
        Equal("others keep their object", last, colors.Skip(2).First());
        foreach (int index in new[] { -1, 3, int.MaxValue, int.MinValue }) {
            string why = "index " + index + " of 3";
            Throws<ArgumentOutOfRangeException>(why, () => colors[index].Reset(), "ColorSetType.Color has 3");
            Throws<ArgumentOutOfRangeException>(why + ", stored", () => colors[index] = blue);
            Throws<ArgumentOutOfRangeException>(why + ", removed", () => colors.RemoveAt(index));
            if (index != 3) Throws<ArgumentOutOfRangeException>(why + ", inserted", () => colors.Insert(index));
        }
        Equal("what was refused changed nothing", "Color 0,Blue,Navy", Names(colors));

        ValueList<string> words = blue.SemanticAssociations;
        words.Add("cold");
        words.Insert(0, "deep");
        words.Insert(2, "sea");
        words[1] = "cool";
        words.RemoveAt(0);
        Equal("texts", "cool,sea", string.Join(",", words));

        ValueList<c_datetime> dates = blue.ChangeHistories;
        dates.Add(Documents.When);
        dates.Insert(0, new c_datetime("2024-02-29T01:02:03Z"));
        c_datetime first = dates[0];
        dates.RemoveAt(0);
        Throws<ObjectDisposedException>("a date that was removed", () => first.ToString());
        Equal("dates", Documents.When, dates.Single().ToDateTimeOffset());

        Hqf document = Documents.Palette(1);
        WildcardList foreign = document.Preamble.Header.Revisions.Add().Any;
        foreign.Add("<x:a xmlns:x=\"urn:x\">ä</x:a>");
        foreign.Insert(0, "<b/>");
        Equal("foreign elements", "<b/>", foreign[0].Value);
        foreign.RemoveAt(0);
        Throws<ArgumentOutOfRangeException>("beyond them", () => foreign[1].ToString());
        var again = new Hqf();
        again.LoadString(document.WriteString());
        c_any_info read = again.Preamble.Header.Revisions[0].Any.Single();
        Equal("a foreign element that was read", "urn:x a <x:a xmlns:x=\"urn:x\">ä</x:a>",
              read.Namespace + " " + read.Name + " " + read.Value);
    }

    static string Names(ObjectList<ColorType> colors) => string.Join(",", colors.Select(color => color.ColorName));
}
