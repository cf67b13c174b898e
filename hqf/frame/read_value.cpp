#include "hqf/frame/read_value.h"

#include "hqf/frame/checks.h"
#include "hqf/values/c_pattern.h"
#include "hqf/values/datetime_text.h"
#include "hqf/values/lexical.h"
#include "hqf/values/text.h"
#include "hqf/values/to_number.h"
#include "hqf/xml_in/c_xml_reader.h"

namespace hqf::frame {

namespace {

/// One value on its way: reports with its item, and remembers the code that ends it.
class conversion {
public:
    conversion(const value_target& target, lmx::c_xml_reader& reader, const std::string& item)
        : target_(target)
        , reader_(reader)
        , item_(item)
        , text_(reader.value_buffer) {}

    lmx::elmx_error run() {
        switch (target_.what) {
        case kind::text: text(); break;
        case kind::enumerated: literal(); break;
        case kind::real: real(); break;
        case kind::integer: integer<int>(to_int); break;
        case kind::natural: integer<unsigned int>(to_unsigned); break;
        case kind::octet: integer<unsigned char>(to_unsigned); break;
        case kind::boolean:
            if (require(lmx::is_valid_bool(text_), lmx::err_invalid_value_format_for_this_type)) store(to_bool(text_));
            break;
        case kind::moment: moment(); break;
        default:
            if (require(lmx::c_binary::is_valid_base64(text_), lmx::err_invalid_value_format_for_this_type))
                static_cast<lmx::c_binary*>(target_.value)->from_base64(text_);
            break;
        }
        return error_;
    }

private:
    /// True when the condition holds, and when the handler wants to go on without it.
    bool require(bool holds, lmx::elmx_error code) {
        if (!holds) error_ = reader_.handle_error(code, item_, "Hqf", __LINE__);
        return error_ == lmx::err_no_error;
    }

    template<class value_type>
    void store(value_type value) {
        *static_cast<value_type*>(target_.value) = value;
    }

    void text() {
        const facets* rules = target_.rules;
        if (rules != nullptr && rules->minimum_length >= 0 &&
            !require(lmx::is_min_length_ok(text_, static_cast<unsigned int>(rules->minimum_length)),
                     lmx::err_length_too_short))
            return;
        if (rules != nullptr && rules->maximum_length >= 0 &&
            !require(lmx::is_max_length_ok(text_, static_cast<unsigned int>(rules->maximum_length)),
                     lmx::err_length_too_long))
            return;
        auto& value = *static_cast<std::wstring*>(target_.value);
        lmx::vtostring(value, text_);
        if (rules != nullptr && rules->texts != nullptr)
            require(rules->texts->number_of(value) != 0, lmx::err_value_does_not_match_enumerations);
    }

    void literal() {
        const literals& texts = *target_.rules->texts;
        auto& value = *static_cast<enumerated*>(target_.value);
        std::wstring text;
        lmx::vtostring(text, text_);
        // Stored first: a text that is no literal stays where the handler goes on.
        value.set_text(text, texts);
        require(value.number() != 0, lmx::err_value_does_not_match_enumerations);
    }

    void real() {
        if (!require(lmx::is_valid_float(text_), lmx::err_invalid_value_format_for_this_type)) return;
        const double value = to_double(text_);
        // Stored first: a value out of range stays in the member.
        store(value);
        if (target_.rules == nullptr) return;
        lmx::elmx_error code = check_range(value, *target_.rules, true);
        if (code == lmx::err_value_less_than_specified_minimum && require(false, code)) code = check_maximum(value);
        if (code == lmx::err_value_greater_than_specified_maximum) require(false, code);
    }

    lmx::elmx_error check_maximum(double value) const {
        facets only_maximum = *target_.rules;
        only_maximum.has_minimum = false;
        return check_range(value, only_maximum, false);
    }

    template<class value_type, class converter>
    void integer(converter convert) {
        if (!require(lmx::is_valid_integer(text_), lmx::err_invalid_value_format_for_this_type)) return;
        const facets* rules = target_.rules;
        if (rules != nullptr && rules->integer_minimum != nullptr &&
            !require(text_ >= *rules->integer_minimum, lmx::err_value_less_than_specified_minimum))
            return;
        if (rules != nullptr && rules->integer_maximum != nullptr &&
            !require(text_ <= *rules->integer_maximum, lmx::err_value_greater_than_specified_maximum))
            return;
        store(static_cast<value_type>(convert(text_)));
    }

    void moment() {
        const char* const begin = text_.data();
        const char* const end = begin + text_.size();
        if (!require(is_datetime(begin, end), lmx::err_invalid_value_format_for_this_type)) return;
        if (target_.rules != nullptr && target_.rules->zoned &&
            !require(has_zone(begin, end), lmx::err_no_pattern_matched))
            return;
        *static_cast<lmx::c_datetime*>(target_.value) = text_;
    }

    bool has_zone(const char* begin, const char* end) const {
        switch (match_zone_pattern(begin, end)) {
        case zone_pattern::matched: return true;
        case zone_pattern::not_matched: return false;
        default: break;
        }
        static const lmx::c_pattern pattern(".+T.+(Z|[+\\-].+)");
        return pattern.is_match(text_);
    }

    const value_target& target_;
    lmx::c_xml_reader& reader_;
    const std::string& item_;
    const std::string& text_;
    lmx::elmx_error error_ = lmx::err_no_error;
};

} // namespace

lmx::elmx_error convert_value(const value_target& target, lmx::c_xml_reader& reader, const std::string& item) {
    return conversion(target, reader, item).run();
}

} // namespace hqf::frame
