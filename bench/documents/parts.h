/// Parts that documents of every kind have: preamble, dates, custom attributes, conditions of a measurement.
#pragma once

#include <string>
#include <type_traits>

#include "bench/documents/random_values.h"
#include "hqf/hqf.h"

namespace hqf_bench {

/// Throws `std::runtime_error` for any other code: a value that the model refuses would be missing from the document.
void ok(lmx::elmx_error code);

/// UTF-8 as the model's wide text.
std::wstring wide(const std::string& utf8);

/// Times of day of one year, in three time zones.
lmx::c_datetime date(unsigned int number);

void add_preamble(hqf_v2::Hqf& document, const std::string& purpose);

template<class parent, class value>
void add_custom_attribute(parent& owner, const char* name, const value& content) {
    ok(owner.append_CustomAttribute());
    auto& attribute = owner.back_CustomAttribute();
    ok(attribute.set_Name(wide(name)));
    auto& choice = attribute.get_ValueChoice();
    if constexpr (std::is_same_v<value, double>) {
        ok(choice.set_DoubleValue(content));
    } else if constexpr (std::is_same_v<value, int>) {
        ok(choice.set_IntegerValue(content));
    } else {
        ok(choice.set_StringValue(wide(content)));
    }
}

/// An instrument on the table with all its settings, or one held in the hand.
void describe_device(hqf_v2::DeviceType& device, bool hand_held);

/// What every specification of a reflecting sample begins with: no filter, no polarization.
template<class specification>
void measure_reflectance(specification& conditions, const lmx::c_datetime& when) {
    ok(conditions.get_DeviceFilter().set_DeviceFilterType(L"Filter_None"));
    ok(conditions.get_DevicePolarization().set_DevicePolarization(false));
    ok(conditions.append_ChangeHistory(when));
    ok(conditions.get_Spectrum().set_SpectrumType(L"Spectrum_Reflectance"));
}

template<class specification>
void measure_at_45_degrees(specification& conditions) {
    ok(conditions.get_GeometryChoice().set_Angle(45));
}

template<class specification>
void calculate_tristimulus(specification& conditions, const wchar_t* illuminant) {
    ok(conditions.get_IlluminationOptions().get_Illuminant().set_Illuminant(illuminant));
    ok(conditions.set_FieldOfView(L"FieldOfView_2_Degree"));
}

/// 40 names of colours, some of them not English.
std::wstring colour_name(unsigned int number);

} // namespace hqf_bench
