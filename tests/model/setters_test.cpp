// Every setter of a checked value, at its bounds and past them, with what the schema says. A refused value leaves the
// one before it in place. The rows are derived by corpus.py.

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <type_traits>

#include "hqf/hqf.h"

namespace {

constexpr double infinity = std::numeric_limits<double>::infinity();
constexpr double nan = std::numeric_limits<double>::quiet_NaN();

/// A value of any setter. Every number of the model is a double without loss.
struct datum {
    constexpr datum(double value)
        : number(value) {}
    constexpr datum(const wchar_t* value)
        : text(value) {}
    template<class value_type>
    value_type as() const {
        if constexpr (std::is_same_v<value_type, std::wstring>)
            return text;
        else
            return static_cast<value_type>(number);
    }
    double number = 0;
    const wchar_t* text = nullptr;
};

struct row {
    const char* what;
    std::string (*fault)(const row&);
    datum sound;
    datum value;
    /// Of the setter; for a literal, its number and how many there are.
    int code;
    int count = 0;
};

bool same(double a, double b) {
    return (a == b && std::signbit(a) == std::signbit(b)) || (std::isnan(a) && std::isnan(b));
}
bool same(const std::wstring& a, const std::wstring& b) {
    return a == b;
}

/// Sets a sound value, then the one in question.
template<class model_class, auto set, auto get>
std::string refuses_or_stores(const row& r) {
    model_class object;
    using stored = std::decay_t<decltype((object.*get)())>;
    if ((object.*set)(r.sound.as<stored>()) != 0) return "the sound value is refused";
    const int code = (object.*set)(r.value.as<stored>());
    if (code != r.code) return "code " + std::to_string(code) + ", expected " + std::to_string(r.code);
    const auto left = (code == 0 ? r.value : r.sound).as<stored>();
    return same((object.*get)(), left) ? "" : "another value is stored";
}

/// A literal and its number belong together both ways, and no other number is taken.
template<class model_class, auto set, auto get_text, auto get>
std::string has_number(const row& r) {
    model_class object;
    using number = decltype((object.*get)());
    if (!(object.*set)(number(r.code)) || (object.*get_text)() != r.value.text) return "the number gives another text";
    for (const int other : {0, r.count + 1, -1})
        if ((object.*set)(number(other))) return "takes number " + std::to_string(other);
    return (object.*get)() == r.code ? "" : "the text gives another number";
}

#define SET(CLASS, MEMBER, SOUND, VALUE, CODE)                                                                         \
    {#CLASS "." #MEMBER " = " #VALUE,                                                                                  \
     refuses_or_stores<hqf_v2::CLASS, &hqf_v2::CLASS::set_##MEMBER, &hqf_v2::CLASS::get_##MEMBER>, SOUND, VALUE,       \
     CODE},
#define ENUM(CLASS, MEMBER, NUMBER, TEXT, COUNT)                                                                       \
    {#CLASS "." #MEMBER " number " #NUMBER,                                                                            \
     has_number<hqf_v2::CLASS, &hqf_v2::CLASS::setenum_##MEMBER, &hqf_v2::CLASS::get_##MEMBER,                         \
                &hqf_v2::CLASS::getenum_##MEMBER>,                                                                     \
     TEXT,                                                                                                             \
     TEXT,                                                                                                             \
     NUMBER,                                                                                                           \
     COUNT},

const row rows[] = {
#include "setters.inc"
};

TEST(setters, every_row) {
    for (const auto& row : rows)
        EXPECT_EQ(row.fault(row), "") << row.what;
}

} // namespace
