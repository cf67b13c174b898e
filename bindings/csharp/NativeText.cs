// How text crosses. Wide text is an array of 32-bit units with one UTF-16 unit in each, and a zero behind it; narrow
// text is UTF-8. Both end at the first zero, and no XML document can hold half a surrogate pair: text with either is
// refused here, because the library would silently drop what follows.

using System;
using System.Runtime.InteropServices;
using System.Text;

namespace HqfV2 {
static class NativeText {
    static readonly Encoding utf8 = new UTF8Encoding(false, false);

    internal static int[] ToWide(string text) {
        if (text == null) throw new ArgumentNullException(nameof(text));
        var units = new int[text.Length + 1];
        for (int i = 0; i < text.Length; ++i) {
            char unit = text[i];
            if (unit == 0 || char.IsSurrogate(unit)) Check(text, i);
            units[i] = unit;
        }
        return units;
    }

    /// <summary>Null stays null, which the library refuses where it must.</summary>
    internal static byte[] ToNarrow(string text) {
        if (text == null) return null;
        for (int i = 0; i < text.Length; ++i)
            if (text[i] == 0 || char.IsSurrogate(text[i])) Check(text, i);
        var bytes = new byte[utf8.GetByteCount(text) + 1];
        utf8.GetBytes(text, 0, text.Length, bytes, 0);
        return bytes;
    }

    /// <summary>Takes over a wide string of the platform.</summary>
    internal static unsafe string FromWide(IntPtr text) {
        Call.Done();
        if (text == IntPtr.Zero) return null;
        try {
            var units = new char[Native.SysStringLen(text)];
            int* from = (int*)text;
            for (int i = 0; i < units.Length; ++i)
                units[i] = (char)from[i];
            return new string(units);
        } finally {
            Native.SysFreeString(text);
        }
    }

    /// <summary>Takes over a narrow string of the platform.</summary>
    internal static string FromNarrow(IntPtr text) {
        Call.Done();
        if (text == IntPtr.Zero) return null;
        try {
            return Decode(text, (int)Native.SysStringByteLen(text));
        } finally {
            Native.SysFreeString(text);
        }
    }

    /// <summary>A copy of text that the library keeps.</summary>
    internal static string FromRaw(IntPtr text) {
        if (text == IntPtr.Zero) return null;
        int size = 0;
        while (Marshal.ReadByte(text, size) != 0)
            ++size;
        return Decode(text, size);
    }

    static string Decode(IntPtr text, int size) {
        var bytes = new byte[size];
        Marshal.Copy(text, bytes, 0, size);
        return utf8.GetString(bytes);
    }

    static void Check(string text, int at) {
        char unit = text[at];
        if (unit == 0) throw new ArgumentException("U+0000 at " + at + ": no document can hold it.");
        bool paired = char.IsHighSurrogate(unit) ? at + 1 < text.Length && char.IsLowSurrogate(text[at + 1])
                                                 : at > 0 && char.IsHighSurrogate(text[at - 1]);
        if (!paired) throw new ArgumentException("Half a surrogate pair at " + at + ": no document can hold it.");
    }
}
}
