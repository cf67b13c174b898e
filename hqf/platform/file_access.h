#pragma once

/// What the archive layer takes from its platform and Linux does not have in that shape: files opened by a wide path
/// with a sharing mode, DOS attributes, code pages, and the splitting of a path.
///
/// The choices made for Linux:
/// - A wide string holds one UTF-16 unit an element. A wide path is handed to the system as UTF-8.
/// - Sharing is an advisory lock (`flock`) that is asked for without waiting. It never makes an open fail: other
///   programs that ask for a lock see it, all others are free, as is usual on this system.
/// - A file has the archive bit, a folder the folder bit. What its owner may not write is read-only. Nothing is hidden.
/// - Both system code pages, 0 (ANSI) and 1 (OEM), are UTF-8, and so is 65001. Any other code page keeps ASCII alone.
/// - `/` and `\` both split a path.

#include <cstddef>
#include <cstdint>
#include <ctime>
#include <string>
#include <string_view>

namespace hqf {

/// Who else may use a file while it is open.
enum class sharing { deny_all, deny_writers, deny_readers, deny_none };

/// How a file is opened.
struct open_mode {
    bool read = false;
    bool write = false;
    bool create = false;   ///< makes the file if there is none, readable and writable for whom the umask allows
    bool truncate = false; ///< of effect only with `write`
    sharing share = sharing::deny_none;
};

/// Opens a file for binary access. A pipe without a peer does not block: it opens, and its first seek is refused.
///
/// \returns a descriptor, or -1 with `errno`; a folder gives EISDIR however it is opened.
int open_descriptor(const std::wstring& path, open_mode mode);

/// Reads until `size` bytes are there or the file ends.
///
/// \returns the bytes read, or -1 with `errno`.
std::int64_t read_descriptor(int descriptor, void* buffer, std::size_t size);

/// Writes all `size` bytes, unless the system takes no more.
///
/// \returns the bytes written, or -1 with `errno`.
std::int64_t write_descriptor(int descriptor, const void* buffer, std::size_t size);

/// Moves the position; `origin` is SEEK_SET, SEEK_CUR or SEEK_END.
///
/// \returns the new position, or -1 with `errno`; a position above 2,147,483,647 gives EOVERFLOW.
std::int64_t seek_descriptor(int descriptor, std::int64_t offset, int origin);

/// Waits until what was written has reached the disk. What cannot be synchronised (a device) is taken as it is.
///
/// \returns 0, or -1 with `errno`.
int commit_descriptor(int descriptor);

/// Cuts or extends a file; the position stays. \returns 0, or -1 with `errno`.
int set_descriptor_length(int descriptor, std::uint64_t length);

/// Closes a descriptor, which is gone whatever the result. \returns 0, or -1 with `errno`.
int close_descriptor(int descriptor);

/// The DOS attribute bits that a file can have here.
enum file_attribute : std::uint32_t {
    attribute_read_only = 0x01,
    attribute_hidden = 0x02,
    attribute_folder = 0x10,
    attribute_archive = 0x20
};

struct file_status {
    std::uint32_t attributes = 0;
    std::int64_t modified = 0; ///< seconds since 1970-01-01, UTC
    std::uint64_t size = 0;    ///< bytes; 0 for a folder
};

/// \returns false when there is nothing at that path, or nothing that may be looked at.
bool get_file_status(const std::wstring& path, file_status& status);

/// Makes a file read-only or writable by `attributes`; the other bits have no counterpart. \returns false on failure.
bool set_file_attributes(const std::wstring& path, std::uint32_t attributes);

/// Sets the time of the last modification. \returns false on failure.
bool set_file_time(const std::wstring& path, std::int64_t modified);

/// \returns false for a time whose year no `tm` can hold.
bool to_local_time(std::int64_t time, std::tm& local);

/// The opposite way; daylight saving is decided by the system, and fields out of their range carry over.
std::int64_t from_local_time(std::tm local);

/// Wide text in the bytes of a code page. What the code page lacks becomes '?' (a surrogate pair two); an unpaired
/// surrogate becomes U+FFFD.
std::string to_code_page(const std::wstring& text, std::uint32_t code_page);

/// The opposite way. A byte that is no text of the code page becomes U+FFFD.
std::wstring from_code_page(std::string_view bytes, std::uint32_t code_page);

/// A path in its parts; put together they give the path again.
struct path_parts {
    std::wstring drive;     ///< a letter and ':', or empty
    std::wstring directory; ///< up to and with the last separator
    std::wstring title;
    std::wstring extension; ///< from the last '.' of the file name on
};

path_parts split_path(const std::wstring& path);

constexpr bool is_path_separator(wchar_t c) {
    return c == L'/' || c == L'\\';
}

} // namespace hqf
