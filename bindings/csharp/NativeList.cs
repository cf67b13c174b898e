// The lists behind repeating members. A list is a view: it holds the object that the items lie in, and the functions
// of its member, which the generated class keeps once for all its objects.

using System;
using System.Collections;
using System.Collections.Generic;
using System.Runtime.InteropServices;

namespace HqfV2 {
delegate uint SizeFunction(HandleRef self);
delegate void ClearFunction(HandleRef self);
delegate void DeleteFunction(HandleRef self, uint index);
delegate int AppendObjectFunction(HandleRef self);
delegate int InsertObjectFunction(HandleRef self, uint index);
delegate IntPtr AssignFunction(HandleRef self, uint index, HandleRef value);

class ListFunctions<T> {
    internal string Member;
    internal SizeFunction Size;
    internal ClearFunction Clear;
    internal DeleteFunction Delete;
    internal Func<NativeObject, uint, T> Get;
}

sealed class ObjectListFunctions<T> : ListFunctions<T> {
    internal AppendObjectFunction Append;
    internal InsertObjectFunction Insert;
    internal AssignFunction Assign;
}

sealed class ValueListFunctions<T> : ListFunctions<T> {
    internal Func<NativeObject, T, int> Append;
    internal Func<NativeObject, uint, T, int> Insert;
    internal Func<NativeObject, uint, T, int> Set;
}

/// <summary>What all lists have. An index outside throws ArgumentOutOfRangeException.</summary>
public abstract class NativeList<T> : IReadOnlyList<T> {
    static readonly bool holdsParts = typeof(NativeObject).IsAssignableFrom(typeof(T));

    internal readonly NativeObject parent;
    readonly ListFunctions<T> functions;

    internal NativeList(NativeObject parent, ListFunctions<T> functions) {
        this.parent = parent;
        this.functions = functions;
    }

    /// <summary>The number of items.</summary>
    public int Count => (int)Call.Done(functions.Size(parent.Self));

    /// <summary>Deletes an item.</summary>
    public void RemoveAt(int index) {
        uint checkedIndex = Checked(index, Count);
        if (holdsParts) ((NativeObject)(object)At(index)).ForgetThis();
        functions.Delete(parent.Self, checkedIndex);
        Call.Done();
    }

    /// <summary>Deletes all items.</summary>
    public void Clear() {
        if (holdsParts)
            foreach (T item in this)
                ((NativeObject)(object)item).ForgetThis();
        functions.Clear(parent.Self);
        Call.Done();
    }

    /// <summary>The items in order; items that are added meanwhile come, too.</summary>
    public IEnumerator<T> GetEnumerator() {
        for (int i = 0; i < Count; ++i)
            yield return At(i);
    }

    IEnumerator IEnumerable.GetEnumerator() => GetEnumerator();

    T IReadOnlyList<T>.this[int index] => Item(index);

    internal T Item(int index) {
        Checked(index, Count);
        return At(index);
    }

    internal uint Checked(int index, int limit) {
        if (index < 0 || index >= limit)
            throw new ArgumentOutOfRangeException(nameof(index), index, functions.Member + " has " + Count);
        return (uint)index;
    }

    T At(int index) => functions.Get(parent, (uint)index);
}

/// <summary>Objects that lie in the list's object. What is given is copied; what comes out is the part itself.
/// </summary>
public sealed class ObjectList<T> : NativeList<T>
    where T : NativeObject {
    readonly ObjectListFunctions<T> functions;

    internal ObjectList(NativeObject parent, ObjectListFunctions<T> functions)
        : base(parent, functions) {
        this.functions = functions;
    }

    /// <summary>The item; storing copies into it.</summary>
    public T this[int index] {
        get => Item(index);
        set => parent.Assigned(functions.Assign(parent.Self, Checked(index, Count), NativeObject.Ref(value)));
    }

    /// <summary>Adds a default object at the end and gives it.</summary>
    public T Add() {
        Call.Must(functions.Append(parent.Self), functions.Member);
        return Item(Count - 1);
    }

    /// <summary>Adds a copy at the end and gives it.</summary>
    public T Add(T value) { return Copied(Count, value); }

    /// <summary>Puts a default object before the item, or at the end for Count, and gives it.</summary>
    public T Insert(int index) {
        Call.Must(functions.Insert(parent.Self, Checked(index, Count + 1)), functions.Member);
        return Item(index);
    }

    /// <summary>Puts a copy before the item, or at the end for Count, and gives it.</summary>
    public T Insert(int index, T value) {
        Checked(index, Count + 1);
        return Copied(index, value);
    }

    T Copied(int index, T value) {
        if (value == null) throw new ArgumentNullException(nameof(value));
        T item = Insert(index);
        functions.Assign(parent.Self, (uint)index, value.Self);
        Call.Done();
        return item;
    }
}

/// <summary>Texts or dates. A date that comes out is the one in the list: changing it changes the list.</summary>
public sealed class ValueList<T> : NativeList<T> {
    readonly ValueListFunctions<T> functions;

    internal ValueList(NativeObject parent, ValueListFunctions<T> functions)
        : base(parent, functions) {
        this.functions = functions;
    }

    /// <summary>The item.</summary>
    public T this[int index] {
        get => Item(index);
        set => Call.Must(functions.Set(parent, Checked(index, Count), value), functions.Member);
    }

    /// <summary>Adds at the end.</summary>
    public void Add(T value) { Call.Must(functions.Append(parent, value), functions.Member); }

    /// <summary>Puts a value before the item, or at the end for Count.</summary>
    public void Insert(int index, T value) {
        Call.Must(functions.Insert(parent, Checked(index, Count + 1), value), functions.Member);
    }
}
}
