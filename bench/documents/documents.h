/// The documents that every peer is given: four kinds, of any size, the same bytes in every run.
#pragma once

#include <memory>
#include <string>

#include "hqf/hqf.h"

namespace hqf_bench {

enum class kind {
    palettes,        ///< Colours with CIELAB, sRGB and CMYK.
    spectra,         ///< Reflectance at 36 and 81 wavelengths.
    quality_control, ///< Standards, their measurements and colour differences.
    mix,             ///< All 27 forms of a colour and everything that can stand around them.
};

constexpr kind all_kinds[] = {kind::palettes, kind::spectra, kind::quality_control, kind::mix};

/// As it stands in the names of benchmarks: "palettes", "spectra", "quality_control", "mix".
const char* name_of(kind which);

/// A document of `megabytes` million bytes and a few thousand more, in UTF-8, as the library writes it.
///
/// Made at the first call and kept until the program ends, so that all peers read the same bytes at the same place.
/// Throws `std::runtime_error` if the library doesn't take its own document back.
const std::string& document_text(kind which, unsigned int megabytes);

/// Writes documents of one kind: each call makes the document longer by one colour or record.
class author {
public:
    virtual ~author() = default;
    virtual void add_to(hqf_v2::Hqf& document) = 0;
};

std::unique_ptr<author> palette_author();
std::unique_ptr<author> spectrum_author();
std::unique_ptr<author> quality_control_author();
std::unique_ptr<author> mix_author();

} // namespace hqf_bench
