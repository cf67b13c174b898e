// What the tests of documents share.
#pragma once

#include <string>

#include "hqf/hqf.h"
#include "tests/support/files.h"

namespace document_test {

using support::bytes_of, support::folder, support::make_file, support::wide;

/// Writes without a stamp.
inline std::string written(hqf_v2::Hqf& document) {
    std::string text;
    const int code = document.marshal(&text);
    return code == 0 ? text : "code " + std::to_string(code);
}

/// What a document needs to be written.
inline void fill_header(hqf_v2::Hqf& document) {
    auto& header = document.get_Preamble().get_Header();
    header.set_Creator(L"tests");
    header.set_CreatorVersion(L"1");
    header.set_Purpose(L"");
    header.append_ChangeHistory(lmx::c_datetime("2024-05-01T09:00:00Z"));
}

} // namespace document_test
