using System;
using System.Linq;
using HqfV2;
using static Runner;

// The runtime's values: one row for each shape in which a value crosses.
static class ValuesTest {
    internal static void Run() {
        bool overflow;
        var decimalValue = new c_decimal("-12.345");
        var date = new c_datetime("2024-02-29T23:59:58.5+05:30");
        var duration = new c_duration("-P1Y2M3DT4H5M6.5S");
        var bytes = new byte[] { 0, 1, 254, 255 };
        c_binary binary = bytes;
        var rows = new(string Why, object Expected, object Actual)[] {
            ("text through", "-12.345", decimalValue.ToString()),
            ("a 32-bit number and a flag", -12, decimalValue.GetIntegral(out overflow)),
            ("the flag is down", false, overflow),
            ("an unsigned number", 34u, decimalValue.GetFractional(2, out overflow)),
            ("wrapped", 0, new c_big_int("4294967296").Get(out overflow)),
            ("the flag is up", true, overflow),
            ("a double", 1.5, new c_decimal(1.5).GetAsFloat()),
            ("two forms of one value", new c_decimal(1.5, 15u).ToString(), new c_decimal(1.5).ToString()),
            ("fields of a date", "2024-2-29 23:59 58.5 330",
             date.Year + "-" + date.Month + "-" + date.Day + " " + date.Hours + ":" + date.Mins + " " + date.Secs +
                 " " + date.TotalOffsetMins),
            ("a moment", new DateTimeOffset(2024, 2, 29, 23, 59, 58, 500, TimeSpan.FromHours(5.5)),
             date.ToDateTimeOffset()),
            ("from a moment", "2025-01-31T12:00:00+01:00", ((c_datetime)Documents.When).ToString()),
            ("from one of offset zero, which is UTC", "2025-01-31T11:00:00.25Z",
             ((c_datetime)Documents.When.ToUniversalTime().AddMilliseconds(250)).ToString()),
            ("a flag as a field", true, duration.IsNeg),
            ("validity of text alone", "True False", c_date.IsValid("2024-02-29") + " " + c_date.IsValid("29.2.2024")),
            ("bytes", "0,1,254,255", string.Join(",", binary.ToArray())),
            ("equal bytes", true, binary.Equal(bytes)),
            ("no bytes", 0, new c_binary().ToArray().Length),
            ("a pattern", "True False",
             new c_pattern("[0-9]+").IsMatch("42") + " " + new c_pattern("[0-9]+").IsMatch("4x")),
            ("a constant", 1, Lmx.LMX_XML_STRICT),
            ("a part of a text", 0, Lmx.Stringncompare("abcd", "bc", 1, 2)),
        };
        foreach (var row in rows)
            Equal(row.Why, row.Expected, row.Actual);
        date.Year = -44;
        date.Secs = 13.5f;
        date.SetOffset(-1, 30);
        Equal("fields that were set", "-0044-02-29T23:59:13.5-01:30", date.ToString());
        duration.IsNeg = false;
        duration.Mins = 66;
        duration.Normalize();
        Equal("and of a duration", "P1Y2M3DT5H6M6.5S", duration.ToString());
        binary.Append(7);
        Equal("one byte more", 5u, binary.GetSize());

        var file = new ProfileFile { Value = Enumerable.Range(0, 256).Select(i => (byte)i).ToArray() };
        Equal("bytes in a document", 255, (int)file.Value.ToArray()[255]);
    }
}
