#pragma once

#include "hqf/platform/api.h"

namespace hqf_v2 {

class Hqf;

/// Writes the library's identity into a document's header. Holds nothing; lives for one stamp.
class HQF_API SdkInformationStamper {
public:
    /// Assigns ReadSDKInformation; marks Preamble and Header present.
    void stampRead(Hqf& document) const;
    /// Assigns WriteSDKInformation; marks Preamble and Header present.
    void stampWrite(Hqf& document) const;
};

} // namespace hqf_v2
