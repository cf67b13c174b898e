#pragma once

// File attributes as the hosts of a ZIP header keep them (APPNOTE 4.4.2.2, 4.4.15). Internal.

#include <cstdint>

namespace hqf {

/// The host systems with a conversion.
enum zip_host : std::uint8_t { host_fat = 0, host_unix = 3, host_hpfs = 6, host_macintosh = 7, host_ntfs = 10 };

bool is_supported_host(std::uint8_t host);

/// The external attributes of a header of that host, for the platform's DOS bits. Cause 117 for an unsupported host.
std::uint32_t to_external_attributes(std::uint8_t host, std::uint32_t attributes);

/// The DOS bits for the external attributes of a header. Cause 117 for an unsupported host.
std::uint32_t from_external_attributes(std::uint8_t host, std::uint32_t external);

} // namespace hqf
