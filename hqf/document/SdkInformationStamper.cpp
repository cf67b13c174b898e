#include "hqf/document/SdkInformationStamper.h"

#include "hqf/model/Hqf.h"

namespace hqf_v2 {

namespace {

SDKType identity() {
    SDKVersion version;
    version.set_SDKVersion(L"1.0");
    SDKType sdk;
    sdk.set_SDKName(L"Hqf2-LMX-3.7.6");
    sdk.assign_SDKVersion(version);
    return sdk;
}

} // namespace

void SdkInformationStamper::stampRead(Hqf& document) const {
    document.get_Preamble().get_Header().assign_ReadSDKInformation(identity());
}

void SdkInformationStamper::stampWrite(Hqf& document) const {
    document.get_Preamble().get_Header().assign_WriteSDKInformation(identity());
}

} // namespace hqf_v2
