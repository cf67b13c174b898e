#pragma once

#include <string>
#include <utility>

#include "hqf/errors/elmx_error.h"
#include "hqf/platform/api.h"

namespace hqf_v2 {

/// What Hqf::writeString() gives: the document's text, which is empty unless the code is 0, and the code.
class HQF_API XMLDocumentResult {
public:
    XMLDocumentResult(std::wstring text, lmx::elmx_error code)
        : text_(std::move(text))
        , code_(code) {}

    /// The document as UTF-16 units. It begins with a declaration of UTF-8, the encoding that the text has in a file.
    std::wstring getXmlDocument() const { return text_; }
    lmx::elmx_error getElmxError() const { return code_; }

private:
    std::wstring text_;
    lmx::elmx_error code_;
};

} // namespace hqf_v2
