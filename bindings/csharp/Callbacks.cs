// How failures come back from the library.
//
// The library tells an exception or a null argument through callbacks, in the middle of a native call. An exception
// can't be thrown from there through native frames: the callback keeps it for its thread, and the wrapper of the call
// throws it when the call is over. Every wrapper ends in one of the functions of Call.

using System;
using System.Threading;

namespace HqfV2 {
static class Callbacks {
    internal delegate void ExceptionCallback(IntPtr message);
    internal delegate void ArgumentCallback(IntPtr message, IntPtr parameterName);
    internal delegate IntPtr StringCallback(IntPtr text);

    // The library holds their native sides until the process ends, so they must never be collected.
    static readonly ExceptionCallback onException = OnException;
    static readonly ArgumentCallback onArgument = OnArgument;

    [ThreadStatic]
    static Exception pending;

    // How many threads have one: a quick look before the slow one at the thread's own.
    static int pendingCount;

    internal static bool MayHavePending => Volatile.Read(ref pendingCount) != 0;

    internal static void Register() {
        ExceptionCallback e = onException;
        ArgumentCallback a = onArgument;
        Native.SWIGRegisterExceptionCallbacks_HqfModule(e, e, e, e, e, e, e, e, e, e, e);
        Native.SWIGRegisterExceptionArgumentCallbacks_HqfModule(a, a, a);
    }

    internal static Exception TakePending() {
        Exception taken = pending;
        if (taken == null) return null;
        pending = null;
        Interlocked.Decrement(ref pendingCount);
        return taken;
    }

    static void Keep(Exception exception) {
        if (pending != null) return; // the first one is the cause
        pending = exception;
        Interlocked.Increment(ref pendingCount);
    }

    static void OnException(IntPtr message) {
        string text = NativeText.FromRaw(message);
        if (text == "std::bad_alloc")
            Keep(new OutOfMemoryException());
        else
            Keep(new HqfException(ErrorCode.UndefinedError, null, text));
    }

    static void OnArgument(IntPtr message, IntPtr parameterName) {
        Keep(new ArgumentNullException(NativeText.FromRaw(parameterName), NativeText.FromRaw(message)));
    }
}

static partial class Native {
    // Runs before the first native call, whichever it is.
    static Native() { Callbacks.Register(); }
}

/// <summary>What a wrapper does when its native call is over.</summary>
static class Call {
    internal static void Done() {
        Exception exception = Callbacks.MayHavePending ? Callbacks.TakePending() : null;
        if (exception != null) throw exception;
    }

    internal static T Done<T>(T result) {
        Done();
        return result;
    }

    /// <summary>Throws what a code stands for, in the name of a member or operation.</summary>
    internal static void Must(int code, string member) {
        Exception exception = Callbacks.MayHavePending ? Callbacks.TakePending() : null;
        if (exception is HqfException raised) throw new HqfException((ErrorCode)code, member, raised.Description);
        if (exception != null) throw exception;
        if (code != 0) throw new HqfException((ErrorCode)code, member);
    }

    /// <summary>For the setter of a literal's number, which gives false where there is none.</summary>
    internal static void MustBeLiteral(bool stored, string member, object number) {
        Done();
        if (!stored) throw new ArgumentOutOfRangeException(member, number, "No literal has this number.");
    }
}
}
