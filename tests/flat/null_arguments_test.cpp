// Every place of every export that refuses a null pointer, through the same three rules. The rows come from the list of
// exports; what a row must do is said here.

#include <string>

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

TEST(NullArguments, AreTakenWhereTheyMeanNothing) {
    auto group = MAKE(sg_Function);
    listener ear;
    EXPECT_EQ(CSharp_sg_Function_assign_Function__SWIG_1(group, nullptr), nullptr);
    EXPECT_EQ(CSharp_sg_Function_getchosen(group), hqf_sg_Function_chosen_Function);
    EXPECT_EQ(ear.heard(), nothing());
}

} // namespace
