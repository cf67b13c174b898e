/// What an archive can't do without: zlib alone on the same bytes, with the settings of our archives, and the CRC-32.
/// All buffers exist beforehand.

#include <zlib.h>

#include "bench/subject.h"

namespace hqf_bench {

namespace {

constexpr int raw_window_bits = -15;
constexpr int memory_level = 8;
constexpr char checks_zlib[] = "CRC-32";

uLong crc_of(const std::string& bytes) {
    return crc32(0, reinterpret_cast<const Bytef*>(bytes.data()), static_cast<uInt>(bytes.size()));
}

/// Gives a stream all of `in` and room for `out`.
z_stream stream_over(const std::string& in, std::string& out) {
    z_stream stream{};
    stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(in.data()));
    stream.avail_in = static_cast<uInt>(in.size());
    stream.next_out = reinterpret_cast<Bytef*>(out.data());
    stream.avail_out = static_cast<uInt>(out.size());
    return stream;
}

bool deflates(const std::string& text, std::string& packed, std::size_t& size) {
    z_stream stream = stream_over(text, packed);
    if (deflateInit2(&stream, Z_DEFAULT_COMPRESSION, Z_DEFLATED, raw_window_bits, memory_level, Z_DEFAULT_STRATEGY) !=
        Z_OK)
        return false;
    const int code = deflate(&stream, Z_FINISH);
    size = stream.total_out;
    deflateEnd(&stream);
    return code == Z_STREAM_END;
}

bool inflates(const std::string& packed, std::string& text) {
    z_stream stream = stream_over(packed, text);
    if (inflateInit2(&stream, raw_window_bits) != Z_OK) return false;
    const int code = inflate(&stream, Z_SYNC_FLUSH);
    inflateEnd(&stream);
    return code == Z_STREAM_END && stream.total_out == text.size();
}

void deflate_and_crc(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    std::string packed(text.size() + 1000, '\0');
    std::size_t size = 0;
    for (auto _ : state) {
        if (!deflates(text, packed, size)) state.SkipWithError("deflate fails");
        benchmark::DoNotOptimize(crc_of(text));
    }
    report(state, text.size(), checks_zlib);
    state.counters["packed_bytes"] = static_cast<double>(size);
}

void inflate_and_crc(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    std::string packed(text.size() + 1000, '\0'), unpacked(text.size(), '\0');
    std::size_t size = 0;
    if (!deflates(text, packed, size)) state.SkipWithError("deflate fails");
    packed.resize(size);
    for (auto _ : state) {
        if (!inflates(packed, unpacked)) state.SkipWithError("inflate fails");
        benchmark::DoNotOptimize(crc_of(unpacked));
    }
    report(state, text.size(), checks_zlib);
}

} // namespace

void add_zlib_archive(const subject& document) {
    const auto add = [&](const char* task, void (*run)(benchmark::State&, subject)) {
        benchmark::RegisterBenchmark(document.benchmark_name(task, "zlib").c_str(), run, document)
            ->Unit(benchmark::kMillisecond);
    };
    add("archive_load", inflate_and_crc);
    add("archive_save", deflate_and_crc);
}

} // namespace hqf_bench
