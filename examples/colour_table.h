/// Prints colours as a table for people: a line a colour with its number, name, CIELAB values, sRGB swatch, Munsell
/// notation and reflectance curve. Used by rendition_chart.cpp; reads a document and never changes it.
#pragma once

#include <ostream>
#include <string>

#include "hqf/hqf.h"

/// UTF-8 of the library's wide text.
std::string narrow(const std::wstring& text);

/// What a palette says about the conditions of all its values: illuminant, observer and geometry of the CIELAB values.
std::string conditions(const hqf_v2::PaletteType& palette);

class colour_table {
public:
    /// \param in_colour draw swatches with 24-bit terminal colours; the hexadecimal form stands there in any case
    colour_table(std::ostream& out, bool in_colour)
        : out_(out)
        , in_colour_(in_colour) {}

    void heading();
    void colour_set(const hqf_v2::ColorSetType& set);
    void row(const hqf_v2::ColorType& color);

private:
    std::ostream& out_;
    bool in_colour_;
};
