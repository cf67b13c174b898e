#pragma once

/// A path in its parts, as the archive layer names them.

#include "hqf/platform/api.h"

#include <string>

/// Splits a path into prefix, drive, directory, title and extension. `/` and `\` both separate.
class HQF_API CZipPathComponent {
public:
    explicit CZipPathComponent(const std::wstring& path);
    virtual ~CZipPathComponent();

    /// `\\?\unc\`, `\\?\` or `\\` at the beginning, as the path spells it; otherwise empty.
    const std::wstring& GetPrefix() const { return prefix_; }
    /// A letter and a colon, or empty.
    const std::wstring& GetDrive() const { return drive_; }
    /// The folders, without separators at either end.
    const std::wstring& GetDirectory() const { return directory_; }
    /// The file name up to its last dot.
    const std::wstring& GetTitle() const { return title_; }
    /// What follows the last dot of the file name.
    const std::wstring& GetExtension() const { return extension_; }

    /// The title, then "." and the extension if there is one.
    std::wstring GetFileName() const;

    /// Without the separators at its end.
    static std::wstring StripSeparators(const std::wstring& path);

private:
    std::wstring prefix_, drive_, directory_, title_, extension_;
};
