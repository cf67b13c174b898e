// What every class of the assembly stands on: a native object that is owned or lies in a parent, and how it is found
// out that it is gone.
//
// A managed object that was made by a constructor, Clone or a factory owns its native object: Dispose or, failing
// that, the garbage collector frees it. One that a property or list gave lies in its parent, which it keeps alive.
//
// Native parts go away while managed objects still stand for them: an item is removed, another option is chosen, the
// document is disposed. Each such event is a tick of one clock. An object remembers at which tick it was last known to
// be alive, so that usually one comparison tells that it still is; after a tick it asks its parents and the notes that
// the outermost object keeps about parts gone.

using System;
using System.Collections.Generic;
using System.Runtime.InteropServices;
using System.Threading;

namespace HqfV2 {
/// <summary>An object of the library. One thread at a time may use a document and what lies in it.</summary>
public abstract class NativeObject : IDisposable {
    static long clock;
    static long owned;

    readonly IntPtr pointer;
    NativeObject parent;
    Ownership ownership;
    bool disposed;
    long aliveAt;

    // Kept by the outermost object: addresses, and when the part there, or all parts of the object there, went.
    Dictionary<IntPtr, long> gone;
    Dictionary<IntPtr, long> emptied;

    /// <summary>How many native objects managed ones own at this moment; parts of others don't count.</summary>
    public static long OwnedCount => Interlocked.Read(ref owned);

    internal NativeObject(IntPtr pointer, NativeObject parent) {
        Call.Done();
        if (pointer == IntPtr.Zero) throw new OutOfMemoryException();
        this.pointer = pointer;
        this.parent = parent;
        aliveAt = Volatile.Read(ref clock);
        if (parent != null) return;
        Interlocked.Increment(ref owned);
        ownership = new Ownership(this);
    }

    /// <summary>Frees the native object now. Nothing happens to a part of another object, nor a second time.
    /// </summary>
    public void Dispose() {
        Ownership mine = Interlocked.Exchange(ref ownership, null);
        if (mine == null) return;
        GC.SuppressFinalize(mine);
        disposed = true;
        Tick();
        Free();
    }

    /// <summary>Whether both stand for the same native object; what is in it isn't compared.</summary>
    public override bool Equals(object other) {
        return other is NativeObject that && that.pointer == pointer && that.GetType() == GetType() &&
               that.parent == null == (parent == null) && that.disposed == disposed;
    }

    /// <summary>Goes with Equals.</summary>
    public override int GetHashCode() => pointer.GetHashCode();

    /// <summary>The pointer for a native call, which keeps this object from the collector until it is over.
    /// Throws ObjectDisposedException for an object that is gone.</summary>
    internal HandleRef Self {
        get {
            if (aliveAt != Volatile.Read(ref clock)) CheckAlive();
            return new HandleRef(this, pointer);
        }
    }

    /// <summary>The pointer of an argument; null goes through, and the library refuses it.</summary>
    internal static HandleRef Ref(NativeObject argument) {
        return argument == null ? new HandleRef(null, IntPtr.Zero) : argument.Self;
    }

    internal abstract void Delete(IntPtr pointer);

    /// <summary>To be called before this part of another object goes away.</summary>
    internal void ForgetThis() => Note(ref Outermost.gone, pointer);

    /// <summary>To be called before what lies in this object may go away.</summary>
    internal void ForgetParts() => Note(ref Outermost.emptied, pointer);

    internal void ForgetPartsWith(NativeObject other) {
        ForgetParts();
        if (other != null) other.ForgetParts();
    }

    /// <summary>Ends a copy into the part with this address: what lay in it before is gone.</summary>
    internal void Assigned(IntPtr part) {
        Call.Done();
        Note(ref Outermost.emptied, part);
    }

    /// <summary>For an operation that takes over an object: refuses one that isn't owned here.</summary>
    internal void CheckTaking(NativeObject taken) {
        if (taken == null) throw new ArgumentNullException(nameof(taken));
        if (taken.Self.Handle == Outermost.pointer) throw new ArgumentException("An object can't lie in itself.");
        if (taken.ownership == null) throw new ArgumentException("The object is a part of another one.");
    }

    /// <summary>Ends the taking: the object has become a part.</summary>
    internal void Take(NativeObject taken) {
        GC.SuppressFinalize(taken.ownership);
        taken.ownership = null;
        Interlocked.Decrement(ref owned);
        NativeObject outermost = Outermost;
        Join(ref outermost.gone, taken.gone);
        Join(ref outermost.emptied, taken.emptied);
        taken.parent = this;
        taken.aliveAt = Tick();
    }

    NativeObject Outermost {
        get {
            NativeObject at = this;
            while (at.parent != null)
                at = at.parent;
            return at;
        }
    }

    void CheckAlive() {
        long now = Volatile.Read(ref clock);
        NativeObject outermost = Outermost;
        bool alive = !outermost.disposed;
        for (NativeObject at = this; alive && at.parent != null; at = at.parent)
            alive = !at.WentAway(outermost.gone, at.pointer) && !at.WentAway(outermost.emptied, at.parent.pointer);
        if (!alive) throw new ObjectDisposedException(GetType().Name, "The object, or what it lay in, is gone.");
        for (NativeObject at = this; at != null; at = at.parent)
            at.aliveAt = now;
    }

    bool WentAway(Dictionary<IntPtr, long> notes, IntPtr address) {
        return notes != null && notes.TryGetValue(address, out long when) && when > aliveAt;
    }

    static long Tick() => Interlocked.Increment(ref clock);

    static void Note(ref Dictionary<IntPtr, long> notes, IntPtr address) {
        if (notes == null) notes = new Dictionary<IntPtr, long>();
        notes[address] = Tick();
    }

    static void Join(ref Dictionary<IntPtr, long> notes, Dictionary<IntPtr, long> more) {
        if (more == null) return;
        if (notes == null) notes = new Dictionary<IntPtr, long>();
        foreach (KeyValuePair<IntPtr, long> note in more)
            if (!notes.TryGetValue(note.Key, out long when) || when < note.Value) notes[note.Key] = note.Value;
    }

    void Free() {
        Delete(pointer);
        Interlocked.Decrement(ref owned);
    }

    // Only owners need the finaliser, and it would make every part many times as dear: hence an object of its own.
    sealed class Ownership {
        readonly NativeObject of;

        internal Ownership(NativeObject of) { this.of = of; }

        ~Ownership() { of.Free(); }
    }
}
}
