#pragma once

/// The one way in which the archive layer reports a failure.

#include "hqf/platform/api.h"

#include <exception>
#include <string>

/// A failure of an archive operation. Thrown by value.
///
/// There is no text for a cause: `what()` is that of `std::exception`. A failed operation of the system has its
/// `errno` value as cause, always between 1 and 99: one above, which would read as a cause of the archive, is raised as
/// ENOSPC (EDQUOT) or EIO (all others).
class HQF_API CZipException : public std::exception {
public:
    enum ECause : int {
        generic = 100, ///< unspecified, or raised by a caller
        badZipFile =
            101,      ///< damaged: short read, bad signature, records that contradict each other, stream not at its end
        badCrc = 102, ///< the CRC-32 of an entry is another one
        noCallback = 103,    ///< an archive of several volumes
        tooLongData = 110,   ///< name, comment or extra field of 65,536 bytes or more
        badPassword = 112,   ///< an encrypted entry
        internalError = 114, ///< inconsistent state
        noAttributes = 117,  ///< no conversion of attributes for a host system
        noEndRecord = 118,   ///< end of central directory record not found
        needsZip64 = 120,    ///< the archive, or a size to write, is beyond 32 bits
        zlibError = 500,     ///< 500 to 507: results of zlib, Z_STREAM_END (1) down to Z_VERSION_ERROR (-6)
        bzip2Error = 600,    ///< 600 to 608: results of bzip2, BZ_SEQUENCE_ERROR (-1) down to BZ_CONFIG_ERROR (-9)
        bzip2Internal = 609  ///< bzip2 found a fault in itself
    };

    explicit CZipException(int cause, const std::wstring& fileName = std::wstring());
    ~CZipException() override;

    int GetCause() const noexcept { return cause_; }

    /// The path of the file that failed, or empty.
    const std::wstring& GetFileName() const noexcept { return file_name_; }

private:
    std::wstring file_name_;
    int cause_;
};
