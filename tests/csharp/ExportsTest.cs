using System;
using System.IO;
using System.Linq;
using System.Reflection;
using System.Runtime.InteropServices;
using HqfV2;
using static Runner;

// The declarations are those of the library: each export has one, and the library has each.
static class ExportsTest {
    internal static void Run() {
        MethodInfo[] declared = typeof(Hqf)
                                    .Assembly.GetType("HqfV2.Native")
                                    .GetMethods(BindingFlags.Static | BindingFlags.NonPublic)
                                    .Where(method => method.Attributes.HasFlag(MethodAttributes.PinvokeImpl))
                                    .ToArray();
        foreach (MethodInfo method in declared)
            Marshal.Prelink(method); // throws where the library lacks it
        string[] exported = File.ReadLines(ExportsPath).Select(line => line.Split(' ')[1]).ToArray();
        string[] names = declared.Select(method => method.Name).ToArray();
        Equal("exports without a declaration", "", string.Join(" ", exported.Except(names)));
        Equal("declarations without an export", "", string.Join(" ", names.Except(exported)));

        var codes = (ErrorCode[])Enum.GetValues(typeof(ErrorCode));
        Equal("codes with a sentence", 56, codes.Count(code => Lmx.GetErrorDescription(code) != ""));
        Equal("codes", 56, codes.Length);
        Equal("a code that doesn't exist", "", Lmx.GetErrorDescription((ErrorCode)999));
    }
}
