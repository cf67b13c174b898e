// The tests of Hqf.dll: each prints a line for a check that failed, and the exit code tells whether any did.
//
// usage: mono csharp_test.exe EXPORTS.txt

using System;
using System.IO;
using HqfV2;

static class Runner {
    static int checks, failures;

    internal static string ExportsPath;

    static int Main(string[] arguments) {
        ExportsPath = arguments[0];
        foreach (Action test in new Action[] { ExportsTest.Run, TextTest.Run, MembersTest.Run, ClassesTest.Run,
                                               ListsTest.Run, ValuesTest.Run, LifetimeTest.Run, DocumentTest.Run }) {
            try {
                test();
            } catch (Exception exception) {
                Fail(test.Method.DeclaringType.Name, "stopped by " + exception);
            }
        }
        Console.WriteLine("{0} checks, {1} failed", checks, failures);
        return failures == 0 ? 0 : 1;
    }

    internal static void Equal(string why, object expected, object actual) {
        ++checks;
        if (!Equals(expected, actual)) Fail(why, "expected " + Shown(expected) + ", got " + Shown(actual));
    }

    internal static void True(string why, bool holds) => Equal(why, true, holds);

    /// <summary>The action must throw exactly this class, with the text in its message.</summary>
    internal static void Throws<T>(string why, Action action, string text = "")
        where T : Exception {
        ++checks;
        try {
            action();
            Fail(why, "nothing was thrown");
        } catch (Exception exception) {
            if (exception.GetType() != typeof(T) || !exception.Message.Contains(text))
                Fail(why, "expected " + typeof(T).Name + " with \"" + text + "\", got " + exception);
        }
    }

    internal static void Refuses(string why, int code, Action action) {
        Throws<HqfException>(why, action, "(" + code + ")");
    }

    static void Fail(string why, string what) {
        ++failures;
        Console.WriteLine("FAILED: {0}: {1}", why, what);
    }

    static string Shown(object value) => value == null ? "null" : "\"" + value + "\"";
}
