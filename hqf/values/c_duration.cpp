#include "hqf/values/c_duration.h"

#include <cmath>
#include <locale>
#include <ostream>
#include <sstream>
#include <string_view>

#include "hqf/values/scan.h"
#include "hqf/values/seconds_text.h"
#include "hqf/values/to_number.h"

namespace lmx {

namespace {

// Days of that many months in a row, at the least and at the most.
constexpr std::int64_t fewest_days[12] = {0, 28, 59, 89, 120, 150, 181, 212, 242, 273, 303, 334};
constexpr std::int64_t most_days[12] = {0, 31, 62, 92, 123, 153, 184, 215, 245, 276, 306, 337};

struct fields {
    bool is_neg = false;
    std::uint32_t years = 0;
    std::uint32_t months = 0;
    std::uint32_t days = 0;
    std::uint32_t hours = 0;
    std::uint32_t mins = 0;
    float secs = 0;
};

/// Walks a text through the form of a duration. A number that no designator has confirmed yet is pending.
class walk {
public:
    walk(std::string_view text, fields& out)
        : out_(out)
        , cursor_(text.data())
        , end_(text.data() + text.size())
        , number_(cursor_) {}

    /// Whether the text is a duration to its end; the fields that were confirmed on the way are stored in any case.
    bool run() {
        out_.is_neg = cursor_ != end_ && *cursor_ == '-';
        scan_sign(cursor_, end_);
        if (!scan_literal(cursor_, end_, 'P')) return false;
        date_part();
        if (cursor_ == end_) return !is_pending_;
        if (!scan_literal(cursor_, end_, 'T') || cursor_ == end_) return false;
        return time_part();
    }

private:
    bool scan_value() {
        number_ = cursor_;
        return scan_digits(cursor_, end_) != 0;
    }

    bool confirm(char designator, std::uint32_t& field) {
        const std::string_view text(number_, static_cast<std::size_t>(cursor_ - number_));
        if (!scan_literal(cursor_, end_, designator)) return false;
        field = static_cast<std::uint32_t>(hqf::to_int(text));
        return true;
    }

    void date_part() {
        is_pending_ = scan_value();
        if (is_pending_ && confirm('Y', out_.years)) is_pending_ = scan_value();
        if (is_pending_ && confirm('M', out_.months)) is_pending_ = scan_value();
        if (is_pending_ && confirm('D', out_.days)) is_pending_ = false;
    }

    bool time_part() {
        if (scan_value()) is_pending_ = true;
        // A number left pending by the date part lets a designator stand here without digits of its own.
        if (is_pending_ && confirm('H', out_.hours)) is_pending_ = scan_value();
        if (is_pending_ && confirm('M', out_.mins)) is_pending_ = scan_value();
        bool has_fraction = false;
        if (scan_literal(cursor_, end_, '.')) {
            if (cursor_ == end_) return false;
            has_fraction = scan_digits(cursor_, end_) != 0;
        }
        if (has_fraction || is_pending_) {
            const std::string_view text(number_, static_cast<std::size_t>(cursor_ - number_));
            if (!scan_literal(cursor_, end_, 'S')) return false;
            out_.secs = static_cast<float>(hqf::to_double(text));
        }
        return cursor_ == end_;
    }

    fields& out_;
    const char* cursor_;
    const char* end_;
    const char* number_; // where the last number began
    bool is_pending_ = false;
};

std::string_view view(const char* text) {
    return text == nullptr ? std::string_view() : std::string_view(text);
}

bool is_valid_text(std::string_view text) {
    fields ignored;
    return walk(text, ignored).run();
}

} // namespace

c_duration::c_duration(const char* text) {
    assign(view(text));
}

c_duration& c_duration::operator=(const char* text) {
    assign(view(text));
    return *this;
}

bool c_duration::is_valid(const char* text) {
    return is_valid_text(view(text));
}

bool c_duration::is_valid(const std::string& text) {
    return is_valid_text(text);
}

void c_duration::assign(std::string_view text) {
    fields read;
    walk(text, read).run();
    is_neg_ = read.is_neg;
    years_ = read.years;
    months_ = read.months;
    days_ = read.days;
    hours_ = read.hours;
    mins_ = read.mins;
    secs_ = read.secs;
}

void c_duration::normalize() {
    constexpr double minutes_limit = 4294967296.0;
    const double whole_mins = std::trunc(static_cast<double>(secs_) / 60);
    // Seconds beyond what the minutes can hold, infinite ones among them, stay where they are.
    if (whole_mins >= 1 && whole_mins < minutes_limit) {
        mins_ += static_cast<std::uint32_t>(whole_mins);
        secs_ = std::fmod(secs_, 60.0f);
    }
    hours_ += mins_ / 60;
    mins_ %= 60;
    days_ += hours_ / 24;
    hours_ %= 24;
    years_ += months_ / 12;
    months_ %= 12;
}

std::string c_duration::get_as_string() const {
    std::ostringstream os;
    os.imbue(std::locale::classic());
    os << *this;
    return os.str();
}

bool c_duration::is_indeterminate(const c_duration& first, const c_duration& second) {
    if (first.is_neg_ != second.is_neg_ || first.months_ % 12 == second.months_ % 12) return false;
    c_duration a = first;
    c_duration b = second;
    a.normalize();
    b.normalize();
    const std::int64_t more_a = a.years_ > b.years_ ? std::int64_t{a.years_} - b.years_ : 0;
    const std::int64_t more_b = b.years_ > a.years_ ? std::int64_t{b.years_} - a.years_ : 0;
    const std::int64_t least_a = fewest_days[a.months_] + 365 * more_a + a.days_;
    const std::int64_t most_a = most_days[a.months_] + 366 * more_a + a.days_;
    const std::int64_t least_b = fewest_days[b.months_] + 365 * more_b + b.days_;
    const std::int64_t most_b = most_days[b.months_] + 366 * more_b + b.days_;
    return most_a > least_b && least_a < most_b;
}

bool c_duration::is_same(const c_duration& first, const c_duration& second) {
    c_duration a = first;
    c_duration b = second;
    a.normalize();
    b.normalize();
    return a.is_neg_ == b.is_neg_ && a.years_ == b.years_ && a.months_ == b.months_ && a.days_ == b.days_ &&
           a.hours_ == b.hours_ && a.mins_ == b.mins_ && a.secs_ == b.secs_;
}

bool c_duration::is_longer(const c_duration& first, const c_duration& second) {
    c_duration a = first;
    c_duration b = second;
    a.normalize();
    b.normalize();
    if (a.years_ != b.years_) return a.years_ > b.years_;
    if (a.months_ != b.months_) return a.months_ > b.months_;
    if (a.days_ != b.days_) return a.days_ > b.days_;
    if (a.hours_ != b.hours_) return a.hours_ > b.hours_;
    if (a.mins_ != b.mins_) return a.mins_ > b.mins_;
    return a.secs_ > b.secs_;
}

bool operator==(const c_duration& a, const c_duration& b) {
    return !c_duration::is_indeterminate(a, b) && c_duration::is_same(a, b);
}

bool operator!=(const c_duration& a, const c_duration& b) {
    return !(a == b);
}

bool operator>(const c_duration& a, const c_duration& b) {
    return !c_duration::is_indeterminate(a, b) && c_duration::is_longer(a, b);
}

bool operator>=(const c_duration& a, const c_duration& b) {
    return !c_duration::is_indeterminate(a, b) && (c_duration::is_longer(a, b) || c_duration::is_same(a, b));
}

bool operator<(const c_duration& a, const c_duration& b) {
    return !c_duration::is_indeterminate(a, b) && !c_duration::is_longer(a, b) && !c_duration::is_same(a, b);
}

bool operator<=(const c_duration& a, const c_duration& b) {
    return !c_duration::is_indeterminate(a, b) && !c_duration::is_longer(a, b);
}

std::ostream& operator<<(std::ostream& os, const c_duration& value) {
    const auto put_field = [&os](std::uint32_t field, char designator) {
        if (field != 0) os << field << designator;
    };
    if (value.is_neg_) os << '-';
    os << 'P';
    put_field(value.years_, 'Y');
    put_field(value.months_, 'M');
    put_field(value.days_, 'D');
    if (value.hours_ == 0 && value.mins_ == 0 && value.secs_ == 0) return os;
    os << 'T';
    put_field(value.hours_, 'H');
    put_field(value.mins_, 'M');
    if (value.secs_ != 0) {
        hqf::insert_seconds(os, value.secs_);
        os << 'S';
    }
    return os;
}

} // namespace lmx
