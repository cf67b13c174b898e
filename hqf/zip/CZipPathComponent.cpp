// Splitting a path: the prefix here, the rest by the platform.

#include "hqf/zip/CZipPathComponent.h"

#include "hqf/platform/file_access.h"

namespace {

std::size_t prefix_length(const std::wstring& path) {
    static constexpr wchar_t longest[] = L"\\\\?\\unc\\";
    std::size_t same = 0;
    const auto lower = [](wchar_t c) { return c >= L'A' && c <= L'Z' ? static_cast<wchar_t>(c + 32) : c; };
    while (same < 8 && same < path.size() && lower(path[same]) == longest[same])
        ++same;
    return same == 8 ? 8 : same >= 4 ? 4 : same >= 2 ? 2 : 0;
}

} // namespace

CZipPathComponent::CZipPathComponent(const std::wstring& path)
    : prefix_(path, 0, prefix_length(path)) {
    hqf::path_parts parts = hqf::split_path(path.substr(prefix_.size()));
    drive_ = std::move(parts.drive);
    title_ = std::move(parts.title);
    if (!parts.extension.empty()) extension_ = parts.extension.substr(1);
    std::size_t begin = 0;
    while (begin < parts.directory.size() && hqf::is_path_separator(parts.directory[begin]))
        ++begin;
    directory_ = StripSeparators(parts.directory.substr(begin));
}

CZipPathComponent::~CZipPathComponent() = default;

std::wstring CZipPathComponent::GetFileName() const {
    return extension_.empty() ? title_ : title_ + L"." + extension_;
}

std::wstring CZipPathComponent::StripSeparators(const std::wstring& path) {
    std::size_t end = path.size();
    while (end > 0 && hqf::is_path_separator(path[end - 1]))
        --end;
    return path.substr(0, end);
}
