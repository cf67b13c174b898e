// Codes with their sentences, the record of reports, and the scope of the getter that reads.

#include <gtest/gtest.h>

#include <string>

#include "hqf/errors/c_error.h"
#include "hqf/errors/c_lmx_exception.h"

namespace {

using namespace lmx;

TEST(elmx_error, code_name_and_sentence_belong_together) {
    const std::tuple<int, elmx_error, const char*> rows[] = {
        {0, err_no_error, "No Error"},
        {4, err_attributes_found_in_anonymous_compositor, "Attributes found in anonymous compositor"},
        {20, err_length_too_short, "Length too short"},
        {38, err_value_does_not_match_enumerations, "Value does not match enumerations"},
        {46, err_min_max_occurs_error_on_marshaling, "min/max occurs error on marshaling"},
        {1008, err_user_defined_error_9, "User defined error 9"}};
    for (const auto& [code, name, sentence] : rows) {
        EXPECT_EQ(name, code) << sentence;
        EXPECT_STREQ(get_error_description(name), sentence);
    }
    for (int code = -10; code < 2000; ++code)
        EXPECT_EQ(*get_error_description(static_cast<elmx_error>(code)) != '\0',
                  (code >= 0 && code < 47) || (code >= 1000 && code < 1009))
            << code;
}

struct recording_error : c_error {
    void report_error(elmx_error_type type, elmx_error code, const char* source, int line, const char* text) override {
        reports += std::to_string(type) + " " + std::to_string(code) + " " + (source ? source : "null") + " " +
                   std::to_string(line) + " " + text + "|";
    }
    std::string reports;
};

TEST(c_error, keeps_the_last_report_and_none_behind_a_fatal_one) {
    recording_error errors;
    elmx_error_type type{};
    elmx_error code{};
    int line = 7;
    EXPECT_TRUE(!errors.get_error_info(&type, &code, &line) && line == 7) << "nothing may be stored";
    EXPECT_TRUE(errors.get_last_error_type() == 4 && errors.get_last_error() == 0 && !errors.is_errored());
    for (const auto& [grade, errored, fatal] : {std::tuple{error_notice, false, false},
                                                {error_error, true, false},
                                                {error_warning, true, false},
                                                {error_fatal, true, true}}) {
        ++line;
        errors.error(grade, err_badly_formed_dtd, line == 8 ? nullptr : "f", line, "text");
        EXPECT_TRUE(errors.is_errored() == errored && errors.is_fatal_errored() == fatal) << grade;
        int told = 0;
        EXPECT_TRUE(errors.get_error_info(&type, &code, &told) && type == grade && code == 9 && told == line) << grade;
    }
    errors.error(error_error, err_not_well_formed, "f", 3, "ignored");
    EXPECT_EQ(errors.reports, "3 9 null 8 text|1 9 f 9 text|2 9 f 10 text|0 9 f 11 text|");
    EXPECT_TRUE(errors.get_last_error() == 9 && errors.get_last_error_type() == error_fatal);
}

TEST(c_getter_error_binder, nests_and_puts_the_old_getter_back) {
    // Nothing here touches the getters, so their addresses are enough.
    int places[3];
    const auto getter = [&](int i) { return reinterpret_cast<c_get_as_utf8*>(&places[i]); };
    c_error errors;
    {
        c_getter_error_binder outer(errors);
        outer.bind(getter(0));
        {
            c_getter_error_binder inner(errors), never_bound(errors);
            inner.bind(getter(1));
            inner.bind(getter(0));
            EXPECT_TRUE(inner.get_new_getter() == getter(1) && inner.get_old_getter() == getter(0))
                << "only the first bind acts";
        }
        c_getter_error_binder probe(errors);
        probe.bind(getter(2));
        EXPECT_EQ(probe.get_old_getter(), getter(0)) << "the old getter is back, an unbound binder leaves it alone";
    }
    c_getter_error_binder probe(errors);
    probe.bind(getter(2));
    EXPECT_EQ(probe.get_old_getter(), nullptr);
}

TEST(c_lmx_exception, carries_code_sentence_and_line) {
    const c_lmx_reader_exception thrown(err_badly_formed_dtd, 3);
    const c_lmx_exception& base = thrown;
    EXPECT_TRUE(base.get_error() == 9 && thrown.get_line() == 3);
    EXPECT_STREQ(base.what(), "Badly formed DTD");
}

} // namespace
