using System;
using System.Text;
using HqfV2;
using static Runner;

// Text goes in and comes out as it is, wide and narrow, or is refused.
static class TextTest {
    internal static void Run() {
        Hqf document = Documents.Palette(1);
        Header header = document.Preamble.Header;
        var texts = new(string Why, string Text)[] {
            ("the empty text", ""),
            ("characters of one unit", "Rot Zürich Ω 色 \uFFFD"),
            ("surrogate pairs, up to the last character", "😀\U0010FFFF"),
            ("what XML escapes, and white space that is preserved", " <&>\"' \t"),
            ("a long text", new string('x', 100000) + "é"),
        };
        foreach (var row in texts) {
            header.Creator = row.Text;
            Equal(row.Why + ", kept", row.Text, header.Creator);
            var again = new Hqf();
            again.LoadString(document.WriteString());
            Equal(row.Why + ", written and read", row.Text, again.Preamble.Header.Creator);
            Equal(row.Why + ", narrow", row.Text, new c_any_info(row.Text).Value);
            Equal(row.Why + ", its characters", Encoding.UTF32.GetByteCount(row.Text) / 4, (int)Lmx.Length(row.Text));
        }

        header.Creator = "before";
        var refused = new(string Why, string Text)[] {
            ("U+0000 would end the text", "a\0b"),          ("a high surrogate at the end", "\uD83D"),
            ("a high surrogate and no low one", "\uD83Dx"), ("a low surrogate alone", "x\uDE00"),
            ("a pair the wrong way round", "\uDE00\uD83D"),
        };
        foreach (var row in refused) {
            Throws<ArgumentException>(row.Why + ", wide", () => header.Creator = row.Text, "no document");
            Throws<ArgumentException>(row.Why + ", narrow", () => new c_any_info(row.Text), "no document");
        }
        Throws<ArgumentNullException>("null for a mandatory text", () => header.Creator = null);
        Equal("what was refused left the value", "before", header.Creator);
    }
}
