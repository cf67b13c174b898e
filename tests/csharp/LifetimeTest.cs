using System;
using System.Runtime.CompilerServices;
using System.Runtime.InteropServices;
using System.Threading;
using HqfV2;
using static Runner;

// Who owns what, who keeps whom alive, and that everything is freed in the end.
static class LifetimeTest {
    internal static void Run() {
        UseAfterTheEnd();
        UnderLoad();
    }

    static void UseAfterTheEnd() {
        var rows = new(string Why, Action<Hqf> End)[] {
            ("the document is disposed", d => d.Dispose()),
            ("it is reset", d => d.Reset()),
            ("it is swapped", d => d.Swap(new Hqf())),
            ("another is swapped with it", d => new Hqf().Swap(d)),
            ("the palette is removed", d => d.Palettes.RemoveAt(0)),
            ("all palettes are", d => d.Palettes.Clear()),
            ("the palette is overwritten", d => d.Palettes[0] = new PaletteType()),
            ("the set's colours are cleared", d => Documents.FirstSet(d).Colors.Clear()),
            ("another form is chosen", d => Documents.FirstSet(d).Colors[0].ColorSpaces[0].ChooseColorSpaceSRGB()),
        };
        foreach (var row in rows) {
            Hqf document = Documents.Palette(2);
            ColorSpaceCIELabType lab = Documents.FirstSet(document).Colors[0].ColorSpaces[0].ColorSpaceCIELab;
            Equal("before " + row.Why, 0.0, lab.L);
            row.End.Invoke(document);
            Throws<ObjectDisposedException>("a part is read after " + row.Why, () => GC.KeepAlive(lab.L));
            Throws<ObjectDisposedException>("and asked for a part", () => lab.ChangeHistories.Clear());
            Throws<ObjectDisposedException>("and given away", () => new ColorSpaceCIELabType(lab));
        }

        using (Hqf document = Documents.Palette(2)) {
            ColorType second = Documents.FirstSet(document).Colors[1];
            Documents.FirstSet(document).Colors.RemoveAt(0);
            new Hqf().Dispose();
            second.Dispose();
            Equal("siblings of a removed item, parts disposed and other documents change nothing", "Color 1",
                  second.ColorName);
            ColorType fresh = Documents.FirstSet(document).Colors.Insert(0);
            new Hqf().Dispose();
            fresh.ColorName = "new";
            Equal("an item that lies where the old one lay is another", "new", fresh.ColorName);
        }
    }

    // Native memory in use is the measure of what is left behind; the managed count alone could be wrong in the same
    // way as the code. When everything has run once, it is exact but for a few blocks of 16 KB that come and go. One
    // document of all, or 25 bytes of each round, can't hide in that.
    static void UnderLoad() {
        const int colors = 200, documents = 300, rounds = 6000, noise = 150000;
        long one = 0;
        OnAThread(() => one = SizeOfOne(colors));
        True("a document is larger than what the measure misses", one > 2 * noise);
        LeavesNothing("documents of " + one + " bytes", noise, () => Abandon(colors, documents));
        LeavesNothing("rounds of small objects", noise, () => Small(rounds));
    }

    static void LeavesNothing(string why, long noise, Action load) {
        OnAThread(load);
        Collect();
        long countBefore = NativeObject.OwnedCount, bytesBefore = NativeBytes();
        OnAThread(load);
        Collect();
        Equal("objects owned after " + why, countBefore, NativeObject.OwnedCount);
        long left = NativeBytes() - bytesBefore;
        Console.WriteLine("{0} native bytes left after {1}", left, why);
        True(left + " native bytes left after " + why, left < noise);
    }

    [MethodImpl(MethodImplOptions.NoInlining)]
    static long SizeOfOne(int colors) {
        long before = NativeBytes();
        using (Documents.Palette(colors)) return NativeBytes() - before;
    }

    // Half of them loaded from text, and none disposed.
    [MethodImpl(MethodImplOptions.NoInlining)]
    static void Abandon(int colors, int rounds) {
        string text;
        using (Hqf document = Documents.Palette(colors)) text = document.WriteString();
        for (int i = 0; i < rounds; ++i) {
            Hqf document = i % 2 == 0 ? Documents.Palette(colors) : new Hqf();
            if (i % 2 == 1) document.LoadString(text);
            if (Documents.FirstSet(document).Colors.Count != colors) throw new InvalidOperationException();
        }
    }

    // Every way to come to own an object, with its text.
    [MethodImpl(MethodImplOptions.NoInlining)]
    static void Small(int rounds) {
        var text = new string('x', 500);
        for (int i = 0; i < rounds; ++i) {
            var color = new ColorType { ColorName = text };
            var copy = new ColorType(color);
            var clone = new FunctionDE94Type { Result = 1 }.Clone();
            var made = (FunctionGenericType)FunctionType.Factory(1000, "FunctionGenericType");
            made.Name = text;
            new sg_Function().TakeFunction(made);
            color.ChangeHistories.Add(Documents.When);
            c_binary bytes = new byte[500];
            GC.KeepAlive(new c_any_info(text).Value + copy.ColorName + clone.Result + bytes.GetSize());
        }
    }

    // It has ended when the collector comes: what the finaliser's thread frees goes back to the allocator at once then,
    // and not to the pools of a thread that may want it again.
    static void OnAThread(Action action) {
        var thread = new Thread(() => action());
        thread.Start();
        thread.Join();
    }

    static void Collect() {
        for (int i = 0; i < 3; ++i) {
            GC.Collect();
            GC.WaitForPendingFinalizers();
        }
    }

    // The allocator's own count of bytes in use, all its arenas together.
    static long NativeBytes() => (long)mallinfo2().InUse;

    [StructLayout(LayoutKind.Sequential)]
    struct Statistics {
        internal UIntPtr Arena, FreeChunks, FastChunks, Mapped, MappedBytes, Unused, FastBytes, InUse, Free, Top;
    }

    [DllImport("libc.so.6")]
    static extern Statistics mallinfo2();
}
