#pragma once

#include <cstdint>
#include <iosfwd>
#include <string>
#include <string_view>

#include "hqf/platform/api.h"

namespace lmx {

/// A signed duration, xs:duration (XML Schema Part 2, 3.2.6): "-P1Y2M3DT4H5M6.7S".
///
/// The fields are magnitudes, kept as the text gave them: "P12M" stays twelve months, and zero is "P". A plain value:
/// one object, one thread.
class HQF_API c_duration {
public:
    c_duration() = default;
    c_duration(const c_duration&) = default;
    c_duration(const char* text);
    c_duration(const std::string& text) { assign(text); }
    c_duration& operator=(const c_duration&) = default;
    /// Clears all fields, then takes what can be read of the text: from the first thing that leaves the form on, the
    /// fields stay zero.
    c_duration& operator=(const char* text);
    c_duration& operator=(const std::string& text) { return assign(text), *this; }

    /// Whether the text is a duration. "P" alone is, "PT" isn't.
    static bool is_valid(const char* text);
    static bool is_valid(const std::string& text);

    bool get_is_neg() const { return is_neg_; }
    unsigned int get_years() const { return years_; }
    unsigned int get_months() const { return months_; }
    unsigned int get_days() const { return days_; }
    unsigned int get_hours() const { return hours_; }
    unsigned int get_mins() const { return mins_; }
    float get_secs() const { return secs_; }
    void set_is_neg(bool value) { is_neg_ = value; }
    void set_years(unsigned int value) { years_ = value; }
    void set_months(unsigned int value) { months_ = value; }
    void set_days(unsigned int value) { days_ = value; }
    void set_hours(unsigned int value) { hours_ = value; }
    void set_mins(unsigned int value) { mins_ = value; }
    void set_secs(float value) { secs_ = value; }

    /// Carries whole minutes out of the seconds, hours out of the minutes, days out of the hours and years out of the
    /// months. Days are never carried into months: months differ in length.
    void normalize();

    /// The text that insertion into a fresh stream gives.
    std::string get_as_string() const;

    /// Comparing works on normalised copies. Where the length of months leaves the order open, as between "P1M" and
    /// "P30D", only `!=` is true. The order of negative durations is that of their magnitudes.
    friend HQF_API bool operator==(const c_duration& a, const c_duration& b);
    friend HQF_API bool operator!=(const c_duration& a, const c_duration& b);
    friend HQF_API bool operator<(const c_duration& a, const c_duration& b);
    friend HQF_API bool operator<=(const c_duration& a, const c_duration& b);
    friend HQF_API bool operator>(const c_duration& a, const c_duration& b);
    friend HQF_API bool operator>=(const c_duration& a, const c_duration& b);

    /// Writes the fields that aren't zero. Seconds go through the stream's own number insertion; when some are written,
    /// the stream's fixed flag is clear afterwards.
    friend HQF_API std::ostream& operator<<(std::ostream& os, const c_duration& value);

private:
    void assign(std::string_view text);
    static bool is_indeterminate(const c_duration& a, const c_duration& b);
    static bool is_same(const c_duration& a, const c_duration& b);
    static bool is_longer(const c_duration& a, const c_duration& b);

    bool is_neg_ = false;
    std::uint32_t years_ = 0;
    std::uint32_t months_ = 0;
    std::uint32_t days_ = 0;
    std::uint32_t hours_ = 0;
    std::uint32_t mins_ = 0;
    float secs_ = 0;
};

} // namespace lmx
