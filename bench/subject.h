/// What a benchmark works on and how it is named, the same for every peer.
#pragma once

#include <benchmark/benchmark.h>

#include <cstddef>
#include <filesystem>
#include <string>

#include "bench/documents/documents.h"

namespace hqf_bench {

/// How often a row that writes does its work before the time starts. A virtual machine's host finds memory that is used
/// for the first time, which costs several times the write itself.
inline constexpr int warm_up_rounds = 3;

/// One generated document.
struct subject {
    kind which;
    unsigned int megabytes;

    /// UTF-8; made when first asked for.
    const std::string& text() const { return document_text(which, megabytes); }

    /// "load/palettes/50MB/expat": what `table.py` takes apart.
    std::string benchmark_name(const std::string& task, const std::string& peer) const {
        return task + '/' + name_of(which) + '/' + std::to_string(megabytes) + "MB/" + peer;
    }
};

/// What a peer has made sure of when it is done; printed beside its row.
namespace checks {
constexpr char hqf_load[] = "all rules of the schema, typed objects";
constexpr char expat_load[] = "well-formedness, namespaces";
constexpr char pugixml_load[] = "most of well-formedness, tree";
constexpr char hqf_write[] = "mandatory members and minimum counts";
constexpr char nothing[] = "nothing";
} // namespace checks

/// Throughput in bytes of document text, the text's size and what the peer checks.
inline void report(benchmark::State& state, std::size_t document_bytes, const char* checked) {
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations()) * static_cast<std::int64_t>(document_bytes));
    state.counters["document_bytes"] = static_cast<double>(document_bytes);
    state.SetLabel(checked);
}

/// Loads the text into `document`; on failure the benchmark ends with an error.
inline bool load(benchmark::State& state, hqf_v2::Hqf& document, const std::string& text) {
    const lmx::elmx_error error = document.unmarshal(text.data(), static_cast<unsigned int>(text.size()));
    if (error == lmx::err_no_error) return true;
    state.SkipWithError(("load: code " + std::to_string(error)).c_str());
    return false;
}

/// A file that is gone with this object.
class scratch_file {
public:
    explicit scratch_file(const std::string& stem);
    ~scratch_file();
    scratch_file(const scratch_file&) = delete;
    scratch_file& operator=(const scratch_file&) = delete;

    const std::filesystem::path& path() const { return path_; }

private:
    std::filesystem::path path_;
};

// Each adds the rows of one file.
void add_hqf_load(const subject& document);
void add_hqf_write(const subject& document);
void add_hqf_objects(const subject& document);
void add_expat_load(const subject& document);
void add_pugixml_load(const subject& document);
void add_pugixml_write(const subject& document);
void add_hqf_archive(const subject& document);
void add_zlib_archive(const subject& document);
void add_flat_calls(); ///< not about a document: their rows have no size

} // namespace hqf_bench
