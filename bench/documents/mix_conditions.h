/// The specifications of the mix: nil, short or with all that can stand in them (devices, profiles, filters, gamma).
#pragma once

#include "bench/documents/parts.h"

namespace hqf_bench {

/// Text that is not only English letters: other alphabets, characters beyond U+FFFF, what a writer must escape.
std::wstring varied_text(random_values& values);

void fill_profile(hqf_v2::ProfileType& profile, random_values& values);

template<class specification>
void vary_common(specification& conditions, random_values& values) {
    if (values.one_in(4)) ok(conditions.set_Comments(varied_text(values)));
    if (values.one_in(4)) ok(conditions.set_UniqueID(L"spec-" + std::to_wstring(values.below(10000))));
    if (values.one_in(4)) add_custom_attribute(conditions, "Drift", values.decimal(-1, 1, 3));
    if (values.one_in(12)) fill_profile(conditions.get_Profile(), values);
    if (values.one_in(4)) describe_device(conditions.get_Device(), values.one_in(2));
    switch (values.below(3)) {
    case 0: ok(conditions.get_DeviceFilter().set_DeviceFilterType(L"Filter_None")); break;
    case 1: conditions.get_DeviceFilter().setnil_DeviceFilter(); break;
    default:
        ok(conditions.get_DeviceFilter().set_DeviceFilterType(L"Filter_Custom"));
        ok(conditions.get_DeviceFilter().set_CustomOrPartial(L"420 nm cut"));
    }
    if (values.one_in(4)) {
        conditions.get_DevicePolarization().setnil_DevicePolarization();
    } else {
        ok(conditions.get_DevicePolarization().set_DevicePolarization(values.one_in(2)));
    }
    ok(conditions.append_ChangeHistory(date(values.below(1000))));
}

template<class specification>
void vary_spectrum(specification& conditions, random_values& values) {
    static const wchar_t* const spectra[] = {L"Spectrum_Reflectance", L"Spectrum_Transmittance",
                                             L"Spectrum_TotalTransmittance", L"Spectrum_Custom"};
    ok(conditions.get_Spectrum().set_SpectrumType(values.one_of(spectra)));
    if (values.one_in(8)) ok(conditions.get_Spectrum().set_CustomTypeName(L"Fluorescence"));
}

template<class specification>
void vary_emission(specification& conditions, random_values& values) {
    static const wchar_t* const types[] = {L"Emissive_Spot", L"Emissive_SpotAmbient", L"Emissive_ScanningFlash"};
    ok(conditions.set_EmissiveType(values.one_of(types)));
    ok(conditions.set_EmissiveMode(values.one_in(2) ? L"EmissiveMode_Diffuser" : L"EmissiveMode_NA"));
}

void vary_geometry(hqf_v2::GeometryChoiceType& geometry, random_values& values);
void vary_illumination(hqf_v2::IlluminationOptionsType& illumination, random_values& values);

template<class specification>
void vary_generic(specification& conditions, random_values& values) {
    if (values.one_in(2)) vary_geometry(conditions.get_GeometryChoice(), values);
    if (values.one_in(2)) vary_illumination(conditions.get_IlluminationOptions(), values);
    if (values.one_in(2)) ok(conditions.set_FieldOfView(L"FieldOfView_10_Degree"));
    if (values.one_in(4)) ok(conditions.set_ASTM_Table(L"E308_Table6"));
    if (values.one_in(4)) ok(conditions.set_Gamma(values.decimal(1, 2.6, 2)));
    if (values.one_in(4)) ok(conditions.set_DensityStatus(L"Status_DIN-NB"));
}

template<class specification>
void vary_tristimulus(specification& conditions, random_values& values) {
    vary_illumination(conditions.get_IlluminationOptions(), values);
    ok(conditions.set_FieldOfView(values.one_in(2) ? L"FieldOfView_2_Degree" : L"FieldOfView_10_Degree"));
    if (values.one_in(2)) vary_geometry(conditions.get_GeometryChoice(), values);
    if (values.one_in(4)) ok(conditions.set_ASTM_Table(L"E308_Table5"));
    if (values.one_in(4)) ok(conditions.set_Gamma(2.2));
}

template<class specification>
void vary_spectral(specification& conditions, random_values& values) {
    vary_geometry(conditions.get_GeometryChoice(), values);
    if (values.one_in(4)) ok(conditions.set_ASTM_Table(L"E308_Table5"));
}

// One overload for each of the six leaves; half of them are nil.
void vary(hqf_v2::ColorSpaceSpecificationSpectrumGeneric& conditions, random_values& values);
void vary(hqf_v2::ColorSpaceSpecificationSpectrumTristimulus& conditions, random_values& values);
void vary(hqf_v2::ColorSpaceSpecificationSpectrumSpectral& conditions, random_values& values);
void vary(hqf_v2::ColorSpaceSpecificationEmissiveGeneric& conditions, random_values& values);
void vary(hqf_v2::ColorSpaceSpecificationEmissiveTristimulus& conditions, random_values& values);
void vary(hqf_v2::ColorSpaceSpecificationEmissiveSpectral& conditions, random_values& values);

/// Conditions for a whole palette or colour set, all six kinds.
void vary(hqf_v2::CollectionColorSpaceSpecificationType& conditions, random_values& values);

} // namespace hqf_bench
