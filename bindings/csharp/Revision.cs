// Foreign XML: the one member whose items have no class of the model and cross in parts.

using System;
using System.Collections;
using System.Collections.Generic;

namespace HqfV2 {
public partial class Revision {
    /// <summary>Elements of any name and namespace, kept and written back unchanged.</summary>
    public WildcardList Any => new WildcardList(this);
}

/// <summary>The foreign elements of a revision. Items that come out are copies.</summary>
public sealed class WildcardList : IReadOnlyList<c_any_info> {
    readonly Revision parent;

    internal WildcardList(Revision parent) { this.parent = parent; }

    /// <summary>The number of elements.</summary>
    public int Count => (int)Call.Done(Native.CSharp_Revision_size_any(parent.Self));

    /// <summary>A copy of the element, with namespace and name where it was read from a document.</summary>
    public c_any_info this[int index] {
        get {
            uint at = Checked(index, Count);
            return new c_any_info(NativeText.FromNarrow(Native.hqf_Revision_any_namespace(parent.Self, at)),
                                  NativeText.FromNarrow(Native.hqf_Revision_any_name(parent.Self, at)),
                                  NativeText.FromNarrow(Native.hqf_Revision_any_value(parent.Self, at)));
        }
    }

    /// <summary>Adds an element, as XML text, at the end.</summary>
    public void Add(string xml) {
        Call.Must(Native.CSharp_Revision_append_any(parent.Self, NativeText.ToNarrow(xml)), "Revision.Any");
    }

    /// <summary>Puts an element before another, or at the end for Count.</summary>
    public void Insert(int index, string xml) {
        uint at = Checked(index, Count + 1);
        Call.Must(Native.CSharp_Revision_insert_any(parent.Self, at, NativeText.ToNarrow(xml)), "Revision.Any");
    }

    /// <summary>Deletes an element.</summary>
    public void RemoveAt(int index) {
        Native.CSharp_Revision_delete_any(parent.Self, Checked(index, Count));
        Call.Done();
    }

    /// <summary>Deletes all elements.</summary>
    public void Clear() {
        Native.CSharp_Revision_clear_any(parent.Self);
        Call.Done();
    }

    /// <summary>The elements in order.</summary>
    public IEnumerator<c_any_info> GetEnumerator() {
        for (int i = 0; i < Count; ++i)
            yield return this[i];
    }

    IEnumerator IEnumerable.GetEnumerator() => GetEnumerator();

    static uint Checked(int index, int limit) {
        if (index >= 0 && index < limit) return (uint)index;
        throw new ArgumentOutOfRangeException(nameof(index), index, "Revision.Any");
    }
}
}
