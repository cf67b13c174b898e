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
                {15, err_mis_match_between_specified_char_encoding_and_read_bytes,
                 "Mis-match between specified char encoding and read bytes"},
                {20, err_length_too_short, "Length too short"},
                {25, err_required_attribute_s_missing, "Required attribute(s) missing"},
                {29, err_unable_to_read_element_value, "Unable to read element value"},
                {35, err_invalid_value_format_for_this_type, "Invalid value format for this type"},
                {38, err_value_does_not_match_enumerations, "Value does not match enumerations"},
                {42, err_undefined_error, "Undefined error"},
                {46, err_min_max_occurs_error_on_marshaling, "min/max occurs error on marshaling"},
                {1000, err_user_defined_error_1, "User defined error 1"},
                {1008, err_user_defined_error_9, "User defined error 9"}};
    for (const auto& row : rows) {
        EXPECT_EQ(row.name, row.code) << row.sentence;
        EXPECT_STREQ(get_error_description(row.name), row.sentence);
    }
}

TEST(elmx_error, only_the_56_codes_have_a_sentence) {
    int with_sentence = 0;
    for (int code = -10; code < 2000; ++code)
        with_sentence += *get_error_description(static_cast<elmx_error>(code)) != '\0';
    EXPECT_EQ(with_sentence, 56);
    for (const int code : {-1, 47, 999, 1009})
        EXPECT_STREQ(get_error_description(static_cast<elmx_error>(code)), "") << code;
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
    EXPECT_FALSE(errors.get_error_info(&type, &code, &line));
    EXPECT_EQ(line, 7) << "nothing may be stored";
    EXPECT_EQ(errors.get_last_error_type(), 4);
    EXPECT_EQ(errors.get_last_error(), 0);
    EXPECT_FALSE(errors.is_errored());
}

TEST(c_error, grades_count_and_the_last_report_is_kept) {
    const struct {
        elmx_error_type type;
        bool errored, fatal;
        const char* why;
    } rows[] = {{error_fatal, true, true, "fatal counts as an error too"},
                {error_error, true, false, "an error isn't fatal"},
                {error_warning, false, false, "a warning isn't an error"},
                {error_notice, false, false, "nor is a notice"}};
    for (const auto& row : rows) {
        recording_error errors;
        errors.error(row.type, err_badly_formed_dtd, "file", 12, "text");
        EXPECT_EQ(errors.is_errored(), row.errored) << row.why;
        EXPECT_EQ(errors.is_fatal_errored(), row.fatal) << row.why;
        elmx_error_type type{};
        elmx_error code{};
        int line = 0;
        ASSERT_TRUE(errors.get_error_info(&type, &code, &line)) << row.why;
        EXPECT_EQ(type, row.type) << row.why;
        EXPECT_EQ(code, 9) << row.why;
        EXPECT_EQ(line, 12) << row.why;
        EXPECT_EQ(errors.reports.at(0), std::to_string(row.type) + " 9 file 12 text");
    }
}

TEST(c_error, a_fatal_report_is_the_last_one) {
    recording_error errors;
    errors.error(error_error, err_badly_formed_comment, nullptr, 1, "first");
    errors.error(error_fatal, err_badly_formed_dtd, "f", 2, "second");
    errors.error(error_error, err_not_well_formed, "f", 3, "ignored");
    EXPECT_EQ(errors.reports, (std::vector<std::string>{"1 8 null 1 first", "0 9 f 2 second"}));
    EXPECT_EQ(errors.get_last_error(), 9);
    EXPECT_EQ(errors.get_last_error_type(), error_fatal);
}

TEST(c_getter_error_binder, nests_and_puts_the_old_getter_back) {
    // Nothing here touches the getters, so their addresses are enough.
    int a = 0, b = 0, c = 0;
    auto* const first = reinterpret_cast<c_get_as_utf8*>(&a);
    auto* const second = reinterpret_cast<c_get_as_utf8*>(&b);
    c_error errors;
    const auto bound_now = [&] {
        c_getter_error_binder probe(errors);
        probe.bind(reinterpret_cast<c_get_as_utf8*>(&c));
        return probe.get_old_getter();
    };
    {
        c_getter_error_binder outer(errors);
        outer.bind(first);
        {
            c_getter_error_binder inner(errors);
            inner.bind(second);
            inner.bind(first);
            EXPECT_EQ(inner.get_new_getter(), second) << "only the first bind acts";
            EXPECT_EQ(inner.get_old_getter(), first);
            EXPECT_EQ(bound_now(), second);
        }
        { c_getter_error_binder never_bound(errors); }
        EXPECT_EQ(bound_now(), first) << "an unbound binder leaves the getter alone";
    }
    EXPECT_EQ(bound_now(), nullptr);
}

TEST(c_lmx_exception, carries_code_sentence_and_line) {
    try {
        throw c_lmx_reader_exception(err_badly_formed_dtd, 3);
    } catch (const c_lmx_exception& caught) {
        EXPECT_EQ(caught.get_error(), 9);
        EXPECT_STREQ(caught.what(), "Badly formed DTD");
        EXPECT_EQ(dynamic_cast<const c_lmx_reader_exception&>(caught).get_line(), 3);
    }
}

} // namespace
