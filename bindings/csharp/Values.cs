// What the runtime's values have besides their exports.

using System;
using System.Globalization;

namespace HqfV2 {
public partial class c_datetime {
    /// <summary>A date with its offset, "Z" where that is zero; seconds keep three decimals.</summary>
    public static implicit operator c_datetime(DateTimeOffset when) {
        // As text, an offset of zero would mean that there is none.
        string zone = when.Offset == TimeSpan.Zero ? "Z" : "zzz";
        return new c_datetime(when.ToString(@"yyyy-MM-ddTHH\:mm\:ss.fff" + zone, CultureInfo.InvariantCulture));
    }

    /// <summary>The same moment. Throws FormatException for what a DateTimeOffset can't hold: a date without
    /// offset would be local time, a year outside 1 to 9999, an hour of 24.</summary>
    public DateTimeOffset ToDateTimeOffset() {
        return DateTimeOffset.Parse(ToString(), CultureInfo.InvariantCulture, DateTimeStyles.AssumeLocal);
    }
}

public partial class c_binary {
    /// <summary>A copy of the bytes.</summary>
    public static implicit operator c_binary(byte[] bytes) => bytes == null ? null : new c_binary(bytes);

    /// <summary>A copy of the bytes.</summary>
    public byte[] ToArray() {
        var bytes = new byte[GetSize()];
        Call.Done(Native.hqf_c_binary_get(Self, bytes, (uint)bytes.Length));
        return bytes;
    }
}

/// <summary>The identity of a class among those that share a base. Two are equal where the library's pointers are;
/// the text is for people.</summary>
public struct ClassIdentity : IEquatable<ClassIdentity> {
    internal readonly IntPtr Pointer;

    internal ClassIdentity(IntPtr pointer) { Pointer = pointer; }

    /// <summary>Whether both are the same identity.</summary>
    public bool Equals(ClassIdentity other) => Pointer == other.Pointer;

    /// <summary>Whether both are the same identity.</summary>
    public override bool Equals(object other) => other is ClassIdentity that && Equals(that);

    /// <summary>Goes with Equals.</summary>
    public override int GetHashCode() => Pointer.GetHashCode();

    /// <summary>The class's name, such as "ColorSpaceCIELabType".</summary>
    public override string ToString() => NativeText.FromRaw(Pointer) ?? "";
}
}
