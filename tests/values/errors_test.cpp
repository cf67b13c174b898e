// Codes with their sentences, the record of reports, and the scope of the getter that reads.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "hqf/errors/c_error.h"
#include "hqf/errors/c_lmx_exception.h"

namespace {

using namespace lmx;

TEST(elmx_error, code_name_and_sentence_belong_together) {
    const struct {
        int code;
        elmx_error name;
        const char* sentence;
    } rows[] = {{0, err_no_error, "No Error"},
                {4, err_attributes_found_in_anonymous_compositor, "Attributes found in anonymous compositor"},
                {9, err_badly_formed_dtd, "Badly formed DTD"},
                {20, err_length_too_short, "Length too short"},
                {38, err_value_does_not_match_enumerations, "Value does not match enumerations"},
                {46, err_min_max_occurs_error_on_marshaling, "min/max occurs error on marshaling"},
                {1008, err_user_defined_error_9, "User defined error 9"}};
    for (const auto& row : rows) {
        EXPECT_EQ(row.name, row.code) << row.sentence;
        EXPECT_STREQ(get_error_description(row.name), row.sentence);
    }
    for (int code = -10; code < 2000; ++code)
        EXPECT_EQ(*get_error_description(static_cast<elmx_error>(code)) != '\0',
                  (code >= 0 && code < 47) || (code >= 1000 && code < 1009))
            << code;
}

class recording_error : public c_error {
public:
    void report_error(elmx_error_type type, elmx_error code, const char* source, int line, const char* text) override {
        reports.push_back(std::to_string(type) + " " + std::to_string(code) + " " + (source ? source : "null") + " " +
                          std::to_string(line) + " " + text);
    }
    std::vector<std::string> reports;
};

TEST(c_error, starts_without_a_record) {
    c_error errors;
    auto type = error_warning;
    auto code = err_badly_formed_comment;
    int line = 7;
    EXPECT_TRUE(!errors.get_error_info(&type, &code, &line) && line == 7) << "nothing may be stored";
    EXPECT_TRUE(errors.get_last_error_type() == 4 && errors.get_last_error() == 0 && !errors.is_errored());
}

TEST(c_error, grades_count_and_the_last_report_is_kept) {
    for (const auto type : {error_fatal, error_error, error_warning, error_notice}) {
        recording_error errors;
        errors.error(type, err_badly_formed_dtd, "file", 12, "text");
        EXPECT_EQ(errors.is_errored(), type == error_fatal || type == error_error) << type;
        EXPECT_EQ(errors.is_fatal_errored(), type == error_fatal) << type;
        elmx_error_type last{};
        elmx_error code{};
        int line = 0;
        EXPECT_TRUE(errors.get_error_info(&last, &code, &line)) << type;
        EXPECT_TRUE(last == type && code == err_badly_formed_dtd && line == 12) << type;
    }
}

TEST(c_error, a_fatal_report_is_the_last_one) {
    recording_error errors;
    errors.error(error_error, err_badly_formed_comment, nullptr, 1, "first");
    errors.error(error_fatal, err_badly_formed_dtd, "f", 2, "second");
    errors.error(error_error, err_not_well_formed, "f", 3, "ignored");
    EXPECT_EQ(errors.reports, (std::vector<std::string>{"1 8 null 1 first", "0 9 f 2 second"}));
    EXPECT_TRUE(errors.get_last_error() == 9 && errors.get_last_error_type() == error_fatal);
}

TEST(c_getter_error_binder, nests_and_puts_the_old_getter_back) {
    // Nothing here touches the getters, so their addresses are enough.
    int places[3];
    const auto getter = [&](int i) { return reinterpret_cast<c_get_as_utf8*>(&places[i]); };
    c_error errors;
    const auto bound_now = [&] {
        c_getter_error_binder probe(errors);
        probe.bind(getter(2));
        return probe.get_old_getter();
    };
    {
        c_getter_error_binder outer(errors);
        outer.bind(getter(0));
        {
            c_getter_error_binder inner(errors), never_bound(errors);
            inner.bind(getter(1));
            inner.bind(getter(0));
            EXPECT_TRUE(inner.get_new_getter() == getter(1) && inner.get_old_getter() == getter(0))
                << "only the first bind acts";
            EXPECT_EQ(bound_now(), getter(1));
        }
        EXPECT_EQ(bound_now(), getter(0)) << "an unbound binder leaves the getter alone";
    }
    EXPECT_EQ(bound_now(), nullptr);
}

TEST(c_lmx_exception, carries_code_sentence_and_line) {
    const c_lmx_reader_exception thrown(err_badly_formed_dtd, 3);
    const c_lmx_exception& base = thrown;
    EXPECT_TRUE(base.get_error() == 9 && thrown.get_line() == 3);
    EXPECT_STREQ(base.what(), "Badly formed DTD");
}

} // namespace
