// Every place of every export that refuses a null pointer, through the same three rules. The rows come from the list of
// exports; what a row must do is said here.

#include <algorithm>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support.h"

using namespace flat_test;

namespace {

struct refusal {
    const char* name;
    const char* cls; // qualified; null: text
    bool is_const;
    bool (*gives_default)(); // calls with null for the object itself, too: the operation must not be reached
};

const refusal refusals[] = {
#include "tests/flat/null_arguments.inc"
};

std::ptrdiff_t rows_with(std::string_view begin, std::string_view end, bool is_const) {
    return std::ranges::count_if(refusals, [&](const refusal& row) {
        const std::string_view name = row.name;
        return row.cls != nullptr && name.starts_with(begin) && name.ends_with(end) && row.is_const == is_const;
    });
}

TEST(NullArguments, GiveTheirMessageAndTheDefault) {
    for (const refusal& row : refusals)
        EXPECT_TRUE(row.gives_default()) << row.name << ", without callbacks";
    listener ear;
    for (const refusal& row : refusals) {
        EXPECT_TRUE(row.gives_default()) << row.name;
        const std::string message = row.cls == nullptr
                                        ? "null string"
                                        : row.cls + std::string(row.is_const ? " const" : "") + " & type is null";
        EXPECT_EQ(ear.heard(), null_of(message)) << row.name;
    }
}

TEST(NullArguments, OfEveryClassAreThere) {
    // 205 model classes, and the three values with a copy and swap.
    EXPECT_EQ(rows_with("CSharp_new_", "__SWIG_1", true), 205 + 3);
    EXPECT_EQ(rows_with("CSharp_", "_swap", false), 205 + 3);
    EXPECT_EQ(rows_with("CSharp_", "_assign_Function__SWIG_0", true), 1);
    EXPECT_EQ(rows_with("CSharp_", "_assign_Function__SWIG_1", true), 0)
        << "the form that takes over may be given null";
}

} // namespace
