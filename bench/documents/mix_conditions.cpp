#include "bench/documents/mix_conditions.h"

#include <vector>

namespace hqf_bench {

std::wstring varied_text(random_values& values) {
    static const char* const texts[] = {
        "Measured on the day of production",
        "Ünïcödé – Farbe, цвет, 色, χρώμα",
        "Café, naïve façade, Größe 5 µm",
        "beyond the plane: 🎨 𝄞",
        "gloss < 20 & haze > 3, \"matt\" or 'satin'",
        "Краска для фасада, партия № 7",
        "内装用塗料、つや消し",
    };
    return wide(values.one_of(texts));
}

void fill_profile(hqf_v2::ProfileType& profile, random_values& values) {
    static const wchar_t* const directions[] = {L"Profile_Input", L"Profile_Output", L"Profile_Both"};
    ok(profile.set_Direction(values.one_of(directions)));
    if (values.one_in(3)) {
        ok(profile.get_ProfileChoice().set_ProfileURI(L"https://profiles.example.org/scanner/2024.icc?v=2&s=1"));
        return;
    }
    std::vector<unsigned char> bytes(480);
    for (unsigned char& byte : bytes)
        byte = static_cast<unsigned char>(values.below(256));
    auto& file = profile.get_ProfileChoice().get_ProfileFile();
    ok(file.set_ProfileName(L"press.icc"));
    ok(file.set_ProfileFile(lmx::c_binary(bytes.data(), static_cast<unsigned int>(bytes.size()))));
    ok(profile.append_Parameters());
    ok(profile.back_Parameters().set_Name(L"g"));
    ok(profile.back_Parameters().get_ValueChoice().set_DoubleValue(2.4));
    ok(profile.append_Parameters());
    ok(profile.back_Parameters().set_Name(wide("Σ")));
    ok(profile.back_Parameters().get_ValueChoice().set_StringValue(L"480 bytes"));
    ok(profile.set_Created(date(values.below(1000))));
}

void vary_geometry(hqf_v2::GeometryChoiceType& geometry, random_values& values) {
    switch (values.below(4)) {
    case 0: ok(geometry.set_SphereGeometry(L"Sphere_Included")); break;
    case 1: ok(geometry.set_UnknownGeometry(varied_text(values))); break;
    default: ok(geometry.set_Angle(45));
    }
}

void vary_illumination(hqf_v2::IlluminationOptionsType& illumination, random_values& values) {
    static const wchar_t* const illuminants[] = {L"Illuminant_D50", L"Illuminant_D65", L"Illuminant_A",
                                                 L"Illuminant_F11", L"Illuminant_9300"};
    if (values.one_in(4)) ok(illumination.set_Description(varied_text(values)));
    switch (values.below(6)) {
    case 0: ok(illumination.set_ColorTemperature(2000 + values.below(8000))); break;
    case 1:
        ok(illumination.get_WhitePointChromaticity().set_CoordinateX(0.3457));
        ok(illumination.get_WhitePointChromaticity().set_CoordinateY(0.3585));
        break;
    case 2:
        ok(illumination.get_Illuminant().set_Illuminant(L"Illuminant_Custom"));
        ok(illumination.get_Illuminant().set_CustomName(L"LED 4000 K"));
        break;
    default: ok(illumination.get_Illuminant().set_Illuminant(values.one_of(illuminants)));
    }
}

void vary(hqf_v2::ColorSpaceSpecificationSpectrumGeneric& conditions, random_values& values) {
    if (values.one_in(2)) return conditions.setnil_ColorSpaceSpecificationSpectrumGeneric();
    vary_common(conditions, values);
    vary_spectrum(conditions, values);
    vary_generic(conditions, values);
}

void vary(hqf_v2::ColorSpaceSpecificationSpectrumTristimulus& conditions, random_values& values) {
    if (values.one_in(2)) return conditions.setnil_ColorSpaceSpecificationSpectrumTristimulus();
    vary_common(conditions, values);
    vary_spectrum(conditions, values);
    vary_tristimulus(conditions, values);
}

void vary(hqf_v2::ColorSpaceSpecificationSpectrumSpectral& conditions, random_values& values) {
    if (values.one_in(2)) return conditions.setnil_ColorSpaceSpecificationSpectrumSpectral();
    vary_common(conditions, values);
    vary_spectrum(conditions, values);
    vary_spectral(conditions, values);
}

void vary(hqf_v2::ColorSpaceSpecificationEmissiveGeneric& conditions, random_values& values) {
    if (values.one_in(2)) return conditions.setnil_ColorSpaceSpecificationEmissiveGeneric();
    vary_common(conditions, values);
    vary_emission(conditions, values);
    vary_generic(conditions, values);
}

void vary(hqf_v2::ColorSpaceSpecificationEmissiveTristimulus& conditions, random_values& values) {
    if (values.one_in(2)) return conditions.setnil_ColorSpaceSpecificationEmissiveTristimulus();
    vary_common(conditions, values);
    vary_emission(conditions, values);
    vary_tristimulus(conditions, values);
}

void vary(hqf_v2::ColorSpaceSpecificationEmissiveSpectral& conditions, random_values& values) {
    if (values.one_in(2)) return conditions.setnil_ColorSpaceSpecificationEmissiveSpectral();
    vary_common(conditions, values);
    vary_emission(conditions, values);
    vary_spectral(conditions, values);
}

void vary(hqf_v2::CollectionColorSpaceSpecificationType& conditions, random_values& values) {
    const auto reflecting = [&](auto& what) {
        vary_common(what, values);
        vary_spectrum(what, values);
    };
    const auto emitting = [&](auto& what) {
        vary_common(what, values);
        vary_emission(what, values);
    };
    reflecting(conditions.get_ColorSpaceSpecificationSpectrumGeneric());
    vary_generic(conditions.get_ColorSpaceSpecificationSpectrumGeneric(), values);
    reflecting(conditions.get_ColorSpaceSpecificationSpectrumSpectral());
    vary_spectral(conditions.get_ColorSpaceSpecificationSpectrumSpectral(), values);
    reflecting(conditions.get_ColorSpaceSpecificationSpectrumTristimulus());
    vary_tristimulus(conditions.get_ColorSpaceSpecificationSpectrumTristimulus(), values);
    emitting(conditions.get_ColorSpaceSpecificationEmissiveGeneric());
    vary_generic(conditions.get_ColorSpaceSpecificationEmissiveGeneric(), values);
    emitting(conditions.get_ColorSpaceSpecificationEmissiveSpectral());
    vary_spectral(conditions.get_ColorSpaceSpecificationEmissiveSpectral(), values);
    emitting(conditions.get_ColorSpaceSpecificationEmissiveTristimulus());
    vary_tristimulus(conditions.get_ColorSpaceSpecificationEmissiveTristimulus(), values);
}

} // namespace hqf_bench
