// Objects that a base class stands for get the managed class of what they really are, found by their identity's text.

using System;
using System.Collections.Generic;
using System.Runtime.InteropServices;

namespace HqfV2 {
static class Polymorphic {
    internal delegate IntPtr IdentityFunction(HandleRef self);

    /// <summary>The managed object of the derived class that the native one has; null where none is known.
    /// </summary>
    internal static T Make<T>(Dictionary<string, Func<IntPtr, NativeObject, T>> derived, IntPtr pointer,
                              NativeObject parent, IdentityFunction identity)
        where T : NativeObject {
        Call.Done();
        if (pointer == IntPtr.Zero) return null;
        string name = NativeText.FromRaw(identity(new HandleRef(parent, pointer)));
        return name != null && derived.TryGetValue(name, out Func<IntPtr, NativeObject, T> make) ? make(pointer, parent)
                                                                                                 : null;
    }

    /// <summary>For factories, which give null for a name that they don't know.</summary>
    internal static T OrNull<T>(IntPtr pointer, Func<IntPtr, NativeObject, T> make)
        where T : NativeObject {
        Call.Done();
        return pointer == IntPtr.Zero ? null : make(pointer, null);
    }
}
}
