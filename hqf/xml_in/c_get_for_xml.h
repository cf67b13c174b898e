#pragma once

#include "hqf/xml_in/c_get_with_entities.h"
#include "hqf/xml_in/elmx_whitespace.h"

#include <string>

namespace lmx {

class c_entity_name_reader;

/// The lexical operations of XML on the character stream: white space in values, comments, processing instructions,
/// CDATA sections, character references and the XML declaration.
class HQF_API c_get_for_xml : public c_get_with_entities {
public:
    /// \param ws_applies_to_references whether white space that a character reference gives is treated as if it stood
    /// in the text
    c_get_for_xml(c_read& input, c_error& errors, bool ws_applies_to_references)
        : c_get_with_entities(input, errors)
        , ws_applies_to_references_(ws_applies_to_references) {}
    ~c_get_for_xml() override;

    /// Chooses what happens to white space from now on, and drops a blank that is still owed.
    void set_ws_mode(elmx_whitespace mode) {
        ws_mode_ = mode;
        is_blank_pending_ = false;
    }
    /// Drops a blank that is still owed.
    void reset_ws_mode() { is_blank_pending_ = false; }
    /// Appends one character of a value as the mode asks. When collapsing, white space only owes a blank, which goes
    /// out before the next character unless `out` is empty.
    void add_char_wsp(std::string* out, int c, bool from_reference);
    /// Appends a character that the mode doesn't touch, behind a blank that is still owed.
    void add_char_verbatim(std::string* out, int c);

    /// The next character that is not white space.
    int get_non_ws() {
        int c = get();
        while (c == ' ' || (c >= 9 && c <= 13))
            c = get();
        return c;
    }
    /// Reads one character for each of `s`. Stops at the first difference, which is consumed, with false.
    bool read_specified_string_from_input(const char* s);
    /// Reads a value in quotes, after white space; nothing in it is expanded. False without a quote or at the end.
    bool get_simple_quoted_value(std::string* out);
    /// Reads on behind a comment whose `<!--` has been read. More than two hyphens at its end give warning 8.
    ///
    /// \returns false at the end of input
    bool skip_comment();
    /// Reads through the first `?>`. False at the end of input.
    bool skip_PI();
    /// Reads on from inside a start tag through its `>`, minding quotes.
    ///
    /// \param empty may be null; told whether the tag ends in `/>`
    /// \returns false at the end of input, or after report 12 for something between `/` and `>`
    bool move_to_start_tag_end(bool* empty);
    /// Appends a CDATA section whose `<![` has been read; the end of input ends it too. False after report 23 when
    /// it is none.
    bool read_cdata(std::string* out);
    /// Reads the XML declaration behind `<?xml`. Versions 1.0 and 1.1 are read alike.
    bool read_xml_decl();
    /// Appends the character of a reference, behind its `&#`. The semicolon is optional. False, without a report, for
    /// one that names no character.
    bool insert_character_entity(c_entity_name_reader& reader, std::string* out);

    /// Forgets mode and entities and goes back to the start of the document.
    void rewind();

private:
    void put_pending_blank(std::string* out);
    bool read_version();
    bool read_encoding(int* next);
    bool read_standalone(int* next);

    std::string digits_;
    elmx_whitespace ws_mode_ = preserve;
    bool is_blank_pending_ = false;
    const bool ws_applies_to_references_;
};

} // namespace lmx
