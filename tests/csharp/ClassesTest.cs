using System;
using System.Linq;
using System.Reflection;
using HqfV2;
using static Runner;

// Every class: a fresh object, and each of its members by what the property's type promises.
static class ClassesTest {
    internal static void Run() {
        Type[] classes =
            typeof(Hqf).Assembly.GetExportedTypes().Where(t => t.GetMethod("IsOccursOk") != null).ToArray();
        Equal("classes", 205, classes.Length);
        foreach (Type type in classes) {
            using (var fresh = (NativeObject)Activator.CreateInstance(type)) {
                foreach (PropertyInfo property in type.GetProperties(BindingFlags.Public | BindingFlags.Instance))
                    Member(fresh, property, type.Name + "." + property.Name);
                type.GetMethod("Reset").Invoke(fresh, null);
                Equal(type.Name + " copied", type, Activator.CreateInstance(type, fresh).GetType());
            }
        }
    }

    static void Member(NativeObject holder, PropertyInfo property, string name) {
        Type holderType = holder.GetType(), type = property.PropertyType;
        MethodInfo make = holderType.GetMethod("Make" + property.Name);
        MethodInfo choose = holderType.GetMethod("Choose" + property.Name);
        object before = property.GetValue(holder);
        if (make != null || choose != null) {
            Equal(name + " is absent", null, before);
            object part = (make ?? choose).Invoke(holder, null);
            Equal(name + " is there, the same object", part, property.GetValue(holder));
            if (choose != null)
                Equal(name + " is chosen", property.Name, holderType.GetProperty("Chosen").GetValue(holder).ToString());
            else
                Absent(holder, property, name);
        } else if (type.Name == "ObjectList`1") {
            typeof(ClassesTest)
                .GetMethod("List", BindingFlags.Static | BindingFlags.NonPublic)
                .MakeGenericMethod(type.GetGenericArguments())
                .Invoke(null, new[] { before, name });
        } else if (type.IsEnum && property.CanWrite) {
            PropertyInfo text = holderType.GetProperty(property.Name.Replace("AsEnum", ""));
            foreach (object literal in Enum.GetValues(type)) {
                if ((int)literal == 0) continue;
                property.SetValue(holder, literal);
                Equal(name + " by number", literal, property.GetValue(holder));
                var written = ((string)text.GetValue(holder)).Select(c => char.IsLetterOrDigit(c) ? c : '_').ToArray();
                Equal(name + " as text", literal.ToString().TrimStart('_'), new string(written));
            }
        } else if (type == typeof(double) || type == typeof(double?)) {
            property.SetValue(holder, 0.25); // within the bounds of every number of the model
            Equal(name, 0.25, property.GetValue(holder));
            if (type == typeof(double?) && holderType.GetNestedType("Choice") == null) Absent(holder, property, name);
        }
    }

    static void Absent(NativeObject holder, PropertyInfo property, string name) {
        property.SetValue(holder, null);
        Equal(name + " is taken out", null, property.GetValue(holder));
    }

    static void List<T>(ObjectList<T> list, string name)
        where T : NativeObject {
        T first = list.Add(), second = list.Insert(0);
        Equal(name + ": inserted before", first, list[1]);
        list.RemoveAt(0);
        Equal(name + ": what follows moves up", first, list[0]);
        Throws<ObjectDisposedException>(name + ": what was removed", () => list.Add(second));
        list.Clear();
        Equal(name + ": cleared", 0, list.Count);
    }
}
