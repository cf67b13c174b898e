/// A document's XML in and out of an archive of one entry: what Hqf::loadFile and Hqf::writeFile do on ".hqfz".
#pragma once

#include <string>

#include "hqf/errors/elmx_error.h"

namespace hqf_v2 {

class Hqf;

/// Reads the entry that lies first in the archive, whatever its name, and loads the document from it.
///
/// \returns the load's code; 1000 when the entry can't be read whole, when its CRC-32 doesn't hold, when it claims more
/// bytes than its packed ones can give, and when there is no entry
/// \throws CZipException from opening the archive and the entry
lmx::elmx_error load_archive(Hqf& document, const std::wstring& path);

/// Packs the XML file as the one entry of a new archive and deletes it.
///
/// \returns 0; 1000 after a failure, which leaves the XML file and an archive that no one can open
/// \throws CZipException when the archive can't be created
lmx::elmx_error pack_archive(const std::wstring& archive_path, const std::wstring& xml_path);

} // namespace hqf_v2
