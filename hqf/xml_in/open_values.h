#pragma once

#include <algorithm>
#include <cstddef>
#include <unordered_map>
#include <utility>
#include <vector>

namespace hqf {

/// The entity values that are being read, one inside the other, outermost first. An address is a value's identity.
///
/// Few are open as a rule, and a walk finds one of those soonest. What lies deeper stands in an index too, so that a
/// document that nests its entities as deep as it may doesn't make each reference compare them all.
class open_values {
public:
    static constexpr std::size_t none = static_cast<std::size_t>(-1);

    std::size_t size() const { return values_.size(); }
    const char* operator[](std::size_t place) const { return values_[place]; }

    /// Where a value stands, `none` if it isn't open.
    std::size_t find(const char* value) const {
        const auto end = values_.begin() + static_cast<std::ptrdiff_t>(std::min(values_.size(), walked));
        const auto found = std::find(values_.begin(), end, value);
        if (found != end) return static_cast<std::size_t>(found - values_.begin());
        const auto deep = places_.find(value);
        return deep == places_.end() ? none : deep->second;
    }
    bool holds(const char* value) const { return find(value) != none; }

    /// Precondition: the value isn't open.
    void push(const char* value) {
        // In this order a failure leaves both as they were.
        if (values_.size() == values_.capacity()) values_.reserve(2 * values_.size() + walked);
        if (values_.size() >= walked) places_.emplace(value, values_.size());
        values_.push_back(value);
    }
    void pop() {
        if (values_.size() > walked) places_.erase(values_.back());
        values_.pop_back();
    }
    /// The value at a place has moved to another address.
    void replace(std::size_t place, const char* value) {
        if (place >= walked) {
            auto entry = places_.extract(values_[place]);
            entry.key() = value;
            places_.insert(std::move(entry));
        }
        values_[place] = value;
    }
    void clear() {
        values_.clear();
        places_.clear();
    }

private:
    static constexpr std::size_t walked = 16;

    std::vector<const char*> values_;
    std::unordered_map<const char*, std::size_t> places_;
};

} // namespace hqf
