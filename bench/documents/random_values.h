/// The numbers of the generated documents: the same on every machine, whatever the standard library.
#pragma once

#include <cmath>
#include <cstdint>

namespace hqf_bench {

/// A stream of numbers that its seed alone decides (SplitMix64: a counter and a mixing of its bits).
class random_values {
public:
    explicit random_values(std::uint64_t seed)
        : state_(seed) {}

    std::uint64_t next() {
        state_ += 0x9E3779B97F4A7C15u;
        std::uint64_t mixed = state_;
        mixed = (mixed ^ (mixed >> 30)) * 0xBF58476D1CE4E5B9u;
        mixed = (mixed ^ (mixed >> 27)) * 0x94D049BB133111EBu;
        return mixed ^ (mixed >> 31);
    }

    /// 0 to `count` - 1. The bias of the remainder is of no account at our counts.
    unsigned int below(unsigned int count) { return static_cast<unsigned int>(next() % count); }

    bool one_in(unsigned int count) { return below(count) == 0; }

    /// A number from `low` to `high`, both possible, with at most `digits` decimals.
    double decimal(double low, double high, int digits) {
        const double scale = std::pow(10.0, digits);
        const double first = std::ceil(low * scale);
        const double count = std::floor(high * scale) - first + 1;
        return (first + static_cast<double>(below(static_cast<unsigned int>(count)))) / scale;
    }

    /// An instrument's number: two to four decimals.
    double measured(double low, double high) { return decimal(low, high, 2 + static_cast<int>(below(3))); }

    template<class item, unsigned int count>
    const item& one_of(const item (&items)[count]) {
        return items[below(count)];
    }

private:
    std::uint64_t state_;
};

} // namespace hqf_bench
