// One pair of conversions a host, in a table by its number.

#include "hqf/zip/attributes.h"

#include "hqf/platform/file_access.h"
#include "hqf/zip/CZipException.h"

#include <iterator>

namespace hqf {
namespace {

constexpr std::uint32_t may_read = 0x124;   // r--r--r--
constexpr std::uint32_t may_write = 0x90;   // -w--w----
constexpr std::uint32_t is_folder = 0x4000; // S_IFDIR
constexpr std::uint32_t may_enter = 0x49;   // --x--x--x
constexpr std::uint32_t regular_file = 0x8000;
constexpr std::uint32_t owner_reads = 0x100;
constexpr std::uint32_t owner_writes = 0x80;
constexpr std::uint32_t kind_of_file = 0xF000;

std::uint32_t unix_mode(std::uint32_t attributes) {
    return ((attributes & attribute_hidden) == 0 ? may_read : 0) |
           ((attributes & attribute_read_only) == 0 ? may_write : 0) |
           ((attributes & attribute_folder) != 0 ? is_folder | may_enter : regular_file);
}

// A DOS header carries the Unix mode too, so that an archive unpacked there gives usable files.
std::uint32_t to_fat(std::uint32_t attributes) {
    return (attributes & 0xFFFF) | unix_mode(attributes) << 16;
}
std::uint32_t from_fat(std::uint32_t external) {
    return external & 0xFFFF;
}

std::uint32_t to_unix(std::uint32_t attributes) {
    return unix_mode(attributes) << 16 | (attributes & attribute_folder);
}
std::uint32_t from_unix(std::uint32_t external) {
    const std::uint32_t mode = external >> 16;
    return ((mode & owner_reads) == 0 ? std::uint32_t{attribute_hidden} : 0U) |
           ((mode & owner_writes) == 0 ? std::uint32_t{attribute_read_only} : 0U) |
           ((mode & kind_of_file) == is_folder ? attribute_folder : attribute_archive);
}

std::uint32_t low_word(std::uint32_t value) {
    return value & 0xFFFF;
}

// A Macintosh knows folders and locked files.
std::uint32_t macintosh(std::uint32_t value) {
    return value & (attribute_folder | attribute_read_only);
}

struct conversion {
    std::uint32_t (*to)(std::uint32_t) = nullptr;
    std::uint32_t (*from)(std::uint32_t) = nullptr;
};

constexpr conversion conversions[] = {
    {to_fat, from_fat},     {}, {}, {to_unix, from_unix}, {}, {}, {low_word, low_word},
    {macintosh, macintosh}, {}, {}, {low_word, low_word},
};

const conversion& conversion_of(std::uint8_t host) {
    if (!is_supported_host(host)) throw CZipException(CZipException::noAttributes);
    return conversions[host];
}

} // namespace

bool is_supported_host(std::uint8_t host) {
    return host < std::size(conversions) && conversions[host].to != nullptr;
}

std::uint32_t to_external_attributes(std::uint8_t host, std::uint32_t attributes) {
    return conversion_of(host).to(attributes);
}

std::uint32_t from_external_attributes(std::uint8_t host, std::uint32_t external) {
    return conversion_of(host).from(external);
}

} // namespace hqf
