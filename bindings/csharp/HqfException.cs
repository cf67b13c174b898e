using System;

namespace HqfV2 {
/// <summary>An operation that the library refused: a value that breaks a rule, a file that can't be read or
/// written, a document that is at fault.</summary>
public class HqfException : Exception {
    internal HqfException(ErrorCode code, string member)
        : this(code, member, Lmx.GetErrorDescription(code)) {}

    internal HqfException(ErrorCode code, string member, string description)
        : base((member == null ? "" : member + ": ") + description + " (" + (int)code + ")") {
        Code = code;
        Member = member;
        Description = description;
    }

    /// <summary>The code that the operation gave.</summary>
    public ErrorCode Code { get; }

    /// <summary>Class and member, such as "ColorSpaceCIELabType.L", or the operation with the file's name; null
    /// where the library raised an exception of its own.</summary>
    public string Member { get; }

    /// <summary>The code's sentence, or the text of the library's exception.</summary>
    public string Description { get; }
}
}
