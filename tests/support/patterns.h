// Documents of any size, from a line of text each.
#pragma once

#include <algorithm>
#include <string>

namespace support {

/// Makes a text of a pattern: what stands in braces is repeated n times with the number of its turn, from 0, for '@'
/// and the next number for '^'; '$' is n.
inline std::string expanded(const std::string& pattern, unsigned int n) {
    std::string text;
    const auto put = [&](std::size_t begin, std::size_t end, unsigned int turn) {
        for (; begin < end; ++begin) {
            const char c = pattern[begin];
            if (c == '@' || c == '^' || c == '$')
                text += std::to_string(c == '$' ? n : turn + (c == '^'));
            else
                text += c;
        }
    };
    for (std::size_t at = 0; at < pattern.size();) {
        const std::size_t open = std::min(pattern.find('{', at), pattern.size());
        const std::size_t close = std::min(pattern.find('}', open), pattern.size());
        put(at, open, 0);
        for (unsigned int turn = 0; open < close && turn < n; ++turn)
            put(open + 1, close, turn);
        at = close + 1;
    }
    return text;
}

inline std::string element(const std::string& name, const std::string& content, const std::string& attributes = "") {
    return "<Hqf:" + name + attributes + ">" + content + "</Hqf:" + name + ">";
}
inline const std::string date = element("ChangeHistory", "2024-05-01T09:00:00Z");
inline std::string space(const std::string& name, const std::string& conditions, const std::string& content) {
    return element("ColorSpace" + name,
                   date + "<Hqf:ColorSpaceSpecificationSpectrum" + conditions + " xsi:nil=\"true\"/>" + content);
}
inline const std::string notation = space("NCS", "Generic", element("ColorName", "n"));

/// n colour spaces in one another, each the parent of the one around it.
inline std::string nested(const std::string& attributes = "") {
    const std::string begin = "<Hqf:ColorSpaceNCS" + attributes + "><Hqf:ParentColorSpace>";
    return "{" + begin + "}" + notation + "{</Hqf:ParentColorSpace>" + notation.substr(notation.find('>') + 1) + "}";
}
/// n parameter entities, each of which names the one before.
inline std::string parameters(const std::string& innermost) {
    return "<!ENTITY % e0 \"" + innermost + "\">{<!ENTITY % e^ '&#37;e@; '>}%e$;";
}
inline const std::string general_entities = "<!ENTITY e0 'v'>{<!ENTITY e^ '&e@;.'>}";

/// The places of a document that a pattern can fill.
struct parts {
    std::string subset = {};    ///< of the document type
    std::string root = {};      ///< attributes
    std::string header = {};    ///< its end
    std::string owner = {};     ///< its begin
    std::string colour = {};    ///< attributes of the first colour
    std::string in_colour = {}; ///< content, behind the first date
    std::string palette = {};   ///< colours in a set
};

/// With so much text, or what else there is, in the owner's first company.
inline parts company(const std::string& content) {
    return {.owner = element("Company", content)};
}

/// A document that has its parts n times.
inline std::string patterned_document(const parts& p, unsigned int n) {
    const std::string pattern =
        "<!DOCTYPE Hqf:Hqf [" + p.subset + "]><Hqf:Hqf xmlns:Hqf=\"http://hqf.example/v2\"" +
        " xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\"" + p.root + ">" +
        element("Preamble", element("Header", element("Creator", "c") + element("CreatorVersion", "1") + date +
                                                  element("Purpose", "p") + p.header) +
                                element("Owner", p.owner + element("Company", "c"))) +
        element("Color", date + p.in_colour + notation, " ColorName=\"c\"" + p.colour) +
        element("Palette",
                date + element("ColorSet", date + element("Color", date + notation, " ColorName=\"c\"") + p.palette,
                               " ColorSetName=\"s\""),
                " PaletteName=\"p\"") +
        "</Hqf:Hqf>";
    return expanded(pattern, n);
}

} // namespace support
