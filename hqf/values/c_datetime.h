#pragma once

#include <cstdint>
#include <iosfwd>
#include <string>

#include "hqf/platform/api.h"

/// The date and time types of XML Schema (Part 2, 3.2.7 to 3.2.14): `c_datetime`, `c_date`, `c_time`, `c_gyearmonth`,
/// `c_gyear`, `c_gmonthday`, `c_gmonth` and `c_gday`.
///
/// Plain values that hold what a text said. They know no calendar: month 13, day 45 and hour 25 are kept as they are,
/// and no value is ever moved to UTC. One object, one thread; distinct objects are independent.

namespace lmx {

/// The fields that all eight classes have; each class offers accessors for those of its form.
///
/// The zone has three states: none (offset 0, `is_utc` false), UTC (`is_utc` true), a numeric offset (not 0, `is_utc`
/// false). So "+00:00" is read as no zone.
struct HQF_API c_datetime_base {
    std::int32_t year = 1;
    std::uint32_t month = 0;
    std::uint32_t day = 0;
    std::uint32_t hours = 0;
    std::uint32_t mins = 0;
    float secs = 0;
    /// East of Greenwich is positive.
    std::int32_t total_offset_mins = 0;
    bool is_utc = false;
};

/// What the eight classes share. `T` is the class itself.
template<class T>
class HQF_API c_datetime_common : public c_datetime_base {
public:
    /// Whether the text has the lexical form of the class, to its end. Digits are counted and nothing else is judged:
    /// "2001-02-31T25:61:61.5+99:99" is valid. Blanks around the value are not.
    static bool is_valid(const std::string& text);

    /// The text that insertion into a fresh stream gives.
    std::string get_as_string() const;

    bool get_is_utc() const { return is_utc; }
    /// Sets the flag alone; the offset stays, though a UTC value never shows it.
    void set_is_utc(bool value) { is_utc = value; }

    int get_total_offset_mins() const { return total_offset_mins; }
    /// Sets the offset in minutes alone; `is_utc` stays.
    void set_total_offset_mins(int value) { total_offset_mins = value; }

    /// Sets the offset to `offset_hours` and, in the direction of their sign, `offset_mins` more. An offset that isn't
    /// 0 clears `is_utc`.
    void set_offset(int offset_hours, unsigned int offset_mins);
    /// The same operation as `set_offset`.
    void set_offset_mins(int offset_hours, unsigned int offset_mins) { set_offset(offset_hours, offset_mins); }

    /// Comparing goes by year, month, day, hours, minutes and seconds, and the first difference decides. The zone plays
    /// no part: 12:00:00Z equals 12:00:00+05:00.
    friend bool operator==(const T& a, const T& b) { return a.equals(b); }
    friend bool operator!=(const T& a, const T& b) { return !a.equals(b); }
    friend bool operator<(const T& a, const T& b) { return !a.equals(b) && !a.is_after(b); }
    friend bool operator<=(const T& a, const T& b) { return !a.is_after(b); }
    friend bool operator>(const T& a, const T& b) { return a.is_after(b); }
    friend bool operator>=(const T& a, const T& b) { return a.equals(b) || a.is_after(b); }

    /// Writes the value in its lexical form. Month, day, hours and minutes have two digits, the year at least four; an
    /// offset of 0 shows no zone. Seconds go through the stream's own number insertion, in its precision.
    ///
    /// The stream's fill is "0" afterwards, and where the form has seconds, the fixed flag is clear.
    friend std::ostream& operator<<(std::ostream& os, const T& value) {
        value.write(os);
        return os;
    }

protected:
    /// Takes the fields of a text one by one up to the first thing that doesn't fit the form; the fields behind it keep
    /// their values.
    void assign(const char* text);
    void assign(const std::string& text);

private:
    bool equals(const T& other) const;
    bool is_after(const T& other) const;
    void write(std::ostream& os) const;
};

/// xs:dateTime, "2001-12-31T23:59:59.5+01:00".
class HQF_API c_datetime : public c_datetime_common<c_datetime> {
public:
    c_datetime() = default;
    c_datetime(const c_datetime&) = default;
    c_datetime(const char* text) { assign(text); }
    c_datetime(const std::string& text) { assign(text); }
    c_datetime& operator=(const c_datetime&) = default;
    /// Takes what can be read of the text: from the first thing that doesn't fit on, no field changes.
    c_datetime& operator=(const char* text) { return assign(text), *this; }
    c_datetime& operator=(const std::string& text) { return assign(text), *this; }

    int get_year() const { return year; }
    unsigned int get_month() const { return month; }
    unsigned int get_day() const { return day; }
    unsigned int get_hours() const { return hours; }
    unsigned int get_mins() const { return mins; }
    float get_secs() const { return secs; }
    void set_year(int value) { year = value; }
    void set_month(unsigned int value) { month = value; }
    void set_day(unsigned int value) { day = value; }
    void set_hours(unsigned int value) { hours = value; }
    void set_mins(unsigned int value) { mins = value; }
    void set_secs(float value) { secs = value; }
};

/// xs:date, "2001-12-31Z".
class HQF_API c_date : public c_datetime_common<c_date> {
public:
    c_date() = default;
    c_date(const c_date&) = default;
    c_date(const char* text) { assign(text); }
    c_date(const std::string& text) { assign(text); }
    c_date& operator=(const c_date&) = default;
    /// As with `c_datetime`.
    c_date& operator=(const char* text) { return assign(text), *this; }
    c_date& operator=(const std::string& text) { return assign(text), *this; }

    int get_year() const { return year; }
    unsigned int get_month() const { return month; }
    unsigned int get_day() const { return day; }
    void set_year(int value) { year = value; }
    void set_month(unsigned int value) { month = value; }
    void set_day(unsigned int value) { day = value; }
};

/// xs:time, "23:59:59". `is_valid` lets a sign pass, which assignment doesn't read.
class HQF_API c_time : public c_datetime_common<c_time> {
public:
    c_time() = default;
    c_time(const c_time&) = default;
    c_time(const char* text) { assign(text); }
    c_time(const std::string& text) { assign(text); }
    c_time& operator=(const c_time&) = default;
    /// As with `c_datetime`.
    c_time& operator=(const char* text) { return assign(text), *this; }
    c_time& operator=(const std::string& text) { return assign(text), *this; }

    unsigned int get_hours() const { return hours; }
    unsigned int get_mins() const { return mins; }
    float get_secs() const { return secs; }
    void set_hours(unsigned int value) { hours = value; }
    void set_mins(unsigned int value) { mins = value; }
    void set_secs(float value) { secs = value; }
};

/// xs:gYear, "2001".
class HQF_API c_gyear : public c_datetime_common<c_gyear> {
public:
    c_gyear() = default;
    c_gyear(const c_gyear&) = default;
    c_gyear(const char* text) { assign(text); }
    c_gyear(const std::string& text) { assign(text); }
    c_gyear& operator=(const c_gyear&) = default;
    /// As with `c_datetime`.
    c_gyear& operator=(const char* text) { return assign(text), *this; }
    c_gyear& operator=(const std::string& text) { return assign(text), *this; }

    int get_year() const { return year; }
    void set_year(int value) { year = value; }
};

/// xs:gYearMonth, "2001-12".
class HQF_API c_gyearmonth : public c_datetime_common<c_gyearmonth> {
public:
    c_gyearmonth() = default;
    c_gyearmonth(const c_gyearmonth&) = default;
    c_gyearmonth(const char* text) { assign(text); }
    c_gyearmonth(const std::string& text) { assign(text); }
    c_gyearmonth& operator=(const c_gyearmonth&) = default;
    /// As with `c_datetime`.
    c_gyearmonth& operator=(const char* text) { return assign(text), *this; }
    c_gyearmonth& operator=(const std::string& text) { return assign(text), *this; }

    int get_year() const { return year; }
    unsigned int get_month() const { return month; }
    void set_year(int value) { year = value; }
    void set_month(unsigned int value) { month = value; }
};

/// xs:gMonth as the first edition of XML Schema spelled it, "--12--".
class HQF_API c_gmonth : public c_datetime_common<c_gmonth> {
public:
    c_gmonth() = default;
    c_gmonth(const c_gmonth&) = default;
    c_gmonth(const char* text) { assign(text); }
    c_gmonth(const std::string& text) { assign(text); }
    c_gmonth& operator=(const c_gmonth&) = default;
    /// As with `c_datetime`.
    c_gmonth& operator=(const char* text) { return assign(text), *this; }
    c_gmonth& operator=(const std::string& text) { return assign(text), *this; }

    unsigned int get_month() const { return month; }
    void set_month(unsigned int value) { month = value; }
};

/// xs:gMonthDay, "--12-31". Assignment takes a day of any number of digits.
class HQF_API c_gmonthday : public c_datetime_common<c_gmonthday> {
public:
    c_gmonthday() = default;
    c_gmonthday(const c_gmonthday&) = default;
    c_gmonthday(const char* text) { assign(text); }
    c_gmonthday(const std::string& text) { assign(text); }
    c_gmonthday& operator=(const c_gmonthday&) = default;
    /// As with `c_datetime`.
    c_gmonthday& operator=(const char* text) { return assign(text), *this; }
    c_gmonthday& operator=(const std::string& text) { return assign(text), *this; }

    unsigned int get_month() const { return month; }
    unsigned int get_day() const { return day; }
    void set_month(unsigned int value) { month = value; }
    void set_day(unsigned int value) { day = value; }
};

/// xs:gDay, "---31". Assignment takes a day of any number of digits.
class HQF_API c_gday : public c_datetime_common<c_gday> {
public:
    c_gday() = default;
    c_gday(const c_gday&) = default;
    c_gday(const char* text) { assign(text); }
    c_gday(const std::string& text) { assign(text); }
    c_gday& operator=(const c_gday&) = default;
    /// As with `c_datetime`.
    c_gday& operator=(const char* text) { return assign(text), *this; }
    c_gday& operator=(const std::string& text) { return assign(text), *this; }

    unsigned int get_day() const { return day; }
    void set_day(unsigned int value) { day = value; }
};

extern template class c_datetime_common<c_datetime>;
extern template class c_datetime_common<c_date>;
extern template class c_datetime_common<c_time>;
extern template class c_datetime_common<c_gyear>;
extern template class c_datetime_common<c_gyearmonth>;
extern template class c_datetime_common<c_gmonth>;
extern template class c_datetime_common<c_gmonthday>;
extern template class c_datetime_common<c_gday>;

/// The name under which the model's own types refer to a date and time.
using tc_datetime = c_datetime;

} // namespace lmx
