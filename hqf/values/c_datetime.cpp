#include "hqf/values/c_datetime.h"

#include <cstring>
#include <locale>
#include <ostream>
#include <sstream>

#include "hqf/values/datetime_text.h"
#include "hqf/values/scan.h"
#include "hqf/values/seconds_text.h"

namespace lmx {

namespace {

/// The lexical forms, a letter for each field: Y year, M month, D day, h hours, m minutes, s seconds. Every other
/// character stands for itself, and a zone may follow. Checking, assigning and writing all walk these.
template<class T>
constexpr const char* form_of = nullptr;
template<>
constexpr const char* form_of<c_datetime> = "Y-M-DTh:m:s";
template<>
constexpr const char* form_of<c_date> = "Y-M-D";
template<>
constexpr const char* form_of<c_time> = "h:m:s";
template<>
constexpr const char* form_of<c_gyear> = "Y";
template<>
constexpr const char* form_of<c_gyearmonth> = "Y-M";
template<>
constexpr const char* form_of<c_gmonth> = "--M--";
template<>
constexpr const char* form_of<c_gmonthday> = "--M-D";
template<>
constexpr const char* form_of<c_gday> = "---D";

struct zone {
    std::int32_t offset_minutes = 0;
    bool is_utc = false;
};

/// Reads what remains of the text as a zone; false when it is none.
bool scan_zone(const char* cursor, const char* end, zone& out) {
    out = zone();
    if (cursor == end) return true;
    if (scan_literal(cursor, end, 'Z')) {
        out.is_utc = true;
        return cursor == end;
    }
    const bool is_negative = *cursor == '-';
    std::uint32_t hours = 0;
    std::uint32_t mins = 0;
    if (!scan_sign(cursor, end) || scan_unsigned(cursor, end, hours) != 2 || !scan_literal(cursor, end, ':') ||
        scan_unsigned(cursor, end, mins) != 2 || cursor != end)
        return false;
    const auto minutes = static_cast<std::int32_t>(hours * 60 + mins);
    out.offset_minutes = is_negative ? -minutes : minutes;
    return true;
}

/// Moves over one element of a form; false when something else stands there.
bool check_element(char element, const char*& cursor, const char* end) {
    switch (element) {
    case 'Y': return scan_digits(cursor, end) >= 4;
    case 'M':
    case 'D':
    case 'h':
    case 'm': return scan_digits(cursor, end) == 2;
    case 's':
        if (scan_digits(cursor, end) != 2) return false;
        if (scan_literal(cursor, end, '.')) scan_digits(cursor, end);
        return true;
    default: return scan_literal(cursor, end, element);
    }
}

bool check_form(const char* form, const char* cursor, const char* end) {
    if (*form == 'Y' || *form == 'h') scan_sign(cursor, end);
    for (; *form != '\0'; ++form)
        if (!check_element(*form, cursor, end)) return false;
    zone ignored;
    return scan_zone(cursor, end, ignored);
}

/// Reads one element of a form into its field; false when it doesn't fit, which the field then keeps all the same.
bool assign_element(char element, const char*& cursor, const char* end, bool is_day_free, c_datetime_base& out) {
    std::uint32_t year = 0;
    switch (element) {
    case 'Y': {
        const unsigned int digits = scan_unsigned(cursor, end, year);
        out.year = static_cast<std::int32_t>(year);
        return digits >= 4;
    }
    case 'M': return scan_unsigned(cursor, end, out.month) == 2;
    case 'D': {
        const unsigned int digits = scan_unsigned(cursor, end, out.day);
        return is_day_free ? digits >= 1 : digits == 2;
    }
    case 'h': return scan_unsigned(cursor, end, out.hours) == 2;
    case 'm': return scan_unsigned(cursor, end, out.mins) == 2;
    case 's': return scan_seconds(cursor, end, out.secs) >= 2;
    default: return scan_literal(cursor, end, element);
    }
}

void assign_form(const char* form, const char* cursor, const char* end, c_datetime_base& out) {
    const bool is_day_free = *form == '-';
    bool is_negative = false;
    if (*form == 'Y') {
        is_negative = cursor != end && *cursor == '-';
        scan_sign(cursor, end);
    }
    for (; *form != '\0'; ++form)
        if (!assign_element(*form, cursor, end, is_day_free, out)) return;
    zone read;
    if (scan_zone(cursor, end, read)) {
        out.total_offset_mins = read.offset_minutes;
        out.is_utc = read.is_utc;
    }
    if (is_negative) out.year = static_cast<std::int32_t>(0 - static_cast<std::uint32_t>(out.year));
}

constexpr std::uint32_t magnitude(std::int32_t value) {
    return value < 0 ? 0 - static_cast<std::uint32_t>(value) : static_cast<std::uint32_t>(value);
}

void write_padded(std::ostream& os, int width, std::uint32_t value) {
    os.width(width);
    os << value;
}

void write_zone(std::ostream& os, const c_datetime_base& value) {
    if (value.is_utc) {
        os.put('Z');
    } else if (value.total_offset_mins != 0) {
        const std::uint32_t minutes = magnitude(value.total_offset_mins);
        os.put(value.total_offset_mins < 0 ? '-' : '+');
        write_padded(os, 2, minutes / 60);
        os.put(':');
        write_padded(os, 2, minutes % 60);
    }
}

void write_form(const char* form, std::ostream& os, const c_datetime_base& value) {
    os.fill('0');
    for (; *form != '\0'; ++form) {
        switch (*form) {
        case 'Y':
            if (value.year < 0) os.put('-');
            write_padded(os, 4, magnitude(value.year));
            break;
        case 'M': write_padded(os, 2, value.month); break;
        case 'D': write_padded(os, 2, value.day); break;
        case 'h': write_padded(os, 2, value.hours); break;
        case 'm': write_padded(os, 2, value.mins); break;
        case 's':
            if (value.secs < 10.0f) os.put('0');
            hqf::insert_seconds(os, value.secs);
            break;
        default: os.put(*form);
        }
    }
    write_zone(os, value);
}

} // namespace

template<class T>
bool c_datetime_common<T>::is_valid(const std::string& text) {
    return check_form(form_of<T>, text.data(), text.data() + text.size());
}

template<class T>
std::string c_datetime_common<T>::get_as_string() const {
    std::ostringstream os;
    os.imbue(std::locale::classic());
    write(os);
    return os.str();
}

template<class T>
void c_datetime_common<T>::set_offset(int offset_hours, unsigned int offset_mins) {
    const std::uint32_t whole = static_cast<std::uint32_t>(offset_hours) * 60;
    total_offset_mins = static_cast<std::int32_t>(offset_hours < 0 ? whole - offset_mins : whole + offset_mins);
    if (total_offset_mins != 0) is_utc = false;
}

template<class T>
void c_datetime_common<T>::assign(const char* text) {
    if (text != nullptr) assign_form(form_of<T>, text, text + std::strlen(text), *this);
}

template<class T>
void c_datetime_common<T>::assign(const std::string& text) {
    assign_form(form_of<T>, text.data(), text.data() + text.size(), *this);
}

template<class T>
bool c_datetime_common<T>::equals(const T& other) const {
    return year == other.year && month == other.month && day == other.day && hours == other.hours &&
           mins == other.mins && secs == other.secs;
}

template<class T>
bool c_datetime_common<T>::is_after(const T& other) const {
    if (year != other.year) return year > other.year;
    if (month != other.month) return month > other.month;
    if (day != other.day) return day > other.day;
    if (hours != other.hours) return hours > other.hours;
    if (mins != other.mins) return mins > other.mins;
    return secs > other.secs;
}

template<class T>
void c_datetime_common<T>::write(std::ostream& os) const {
    write_form(form_of<T>, os, *this);
}

template class c_datetime_common<c_datetime>;
template class c_datetime_common<c_date>;
template class c_datetime_common<c_time>;
template class c_datetime_common<c_gyear>;
template class c_datetime_common<c_gyearmonth>;
template class c_datetime_common<c_gmonth>;
template class c_datetime_common<c_gmonthday>;
template class c_datetime_common<c_gday>;

} // namespace lmx

namespace hqf {

bool is_datetime(const char* begin, const char* end) {
    return lmx::check_form(lmx::form_of<lmx::c_datetime>, begin, end);
}

} // namespace hqf
