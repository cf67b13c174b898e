// What the root class has besides its members.

using System;
using System.Runtime.InteropServices;

namespace HqfV2 {
public partial class Hqf {
    /// <summary>Reads a document: an archive if the path ends in ".hqfz", else XML. What it states is added to
    /// what is there already; a load that fails leaves what it read so far.</summary>
    public void LoadFile(string path) {
        ForgetParts();
        Call.Must(Native.CSharp_Hqf_loadFile(Self, NativeText.ToWide(path)), "Hqf.LoadFile(\"" + path + "\")");
    }

    /// <summary>Reads a document from text, in the same way.</summary>
    public void LoadString(string xml) {
        ForgetParts();
        Call.Must(Native.CSharp_Hqf_loadString(Self, NativeText.ToWide(xml)), "Hqf.LoadString");
    }

    /// <summary>Writes XML to a path in ".hqf", an archive to one in ".hqfz"; other paths are refused.</summary>
    public void WriteFile(string path) {
        Call.Must(Native.CSharp_Hqf_writeFile(Self, NativeText.ToWide(path)), "Hqf.WriteFile(\"" + path + "\")");
    }

    /// <summary>The document as text.</summary>
    public string WriteString() {
        using (var result = new XMLDocumentResult(Native.CSharp_Hqf_writeString(Self), null)) {
            Call.Must((int)result.GetElmxError(), "Hqf.WriteString");
            return result.GetXmlDocument();
        }
    }

    /// <summary>Whether the same is set in both documents, and to the same values.</summary>
    public bool ContentEquals(Hqf other) => Call.Done(Native.hqf_Hqf_equal(Self, Ref(other)));
}
}
