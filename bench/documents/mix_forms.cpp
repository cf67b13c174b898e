#include "bench/documents/mix_forms.h"

#include <iterator>

#include "bench/documents/mix_conditions.h"

namespace hqf_bench {

namespace {

using hqf_v2::sg_ColorSpace;
using values_t = random_values;

constexpr wchar_t maker[] = L"Example Pigments";

/// What all forms have.
template<class form>
form& begin(form& space, values_t& values) {
    if (values.one_in(4)) ok(space.set_Comments(varied_text(values)));
    if (values.one_in(4)) ok(space.set_UniqueID(L"value-" + std::to_wstring(values.below(100000))));
    if (values.one_in(6)) add_custom_attribute(space, "Repeat", static_cast<int>(values.below(9)));
    if (values.one_in(8)) {
        space.get_ParentColorSpace().setnil_ParentColorSpace();
    } else if (values.one_in(8)) {
        auto& parent = space.get_ParentColorSpace().get_ColorSpace().get_ColorSpaceNCS();
        ok(parent.append_ChangeHistory(date(3)));
        parent.get_ColorSpaceSpecificationSpectrumGeneric().setnil_ColorSpaceSpecificationSpectrumGeneric();
        ok(parent.set_ColorName(L"NCS S 5020-G50Y"));
    }
    ok(space.append_ChangeHistory(date(values.below(1000))));
    if (values.one_in(4)) ok(space.set_Name(varied_text(values)));
    return space;
}

template<class form>
void fill_rgb(form& given, values_t& values) {
    static const wchar_t* const depths[] = {L"ColorDepth_Infinite", L"ColorDepth_8", L"ColorDepth_16",
                                            L"ColorDepth_32"};
    auto& space = begin(given, values);
    vary(space.get_ColorSpaceSpecificationSpectrumTristimulus(), values);
    ok(space.set_Red(values.decimal(0, 1, 4)));
    ok(space.set_Green(values.decimal(0, 1, 4)));
    ok(space.set_Blue(values.decimal(0, 1, 4)));
    if (values.one_in(3)) ok(space.set_Alpha(values.decimal(0, 1, 2)));
    ok(space.set_ColorDepth(values.one_of(depths)));
}

template<class form>
void fill_axes(form& given, values_t& values) {
    auto& space = begin(given, values);
    ok(space.set_Name(L"Generic"));
    for (const wchar_t* name : {L"Gloss", L"Texture"}) {
        ok(space.append_Axis());
        ok(space.back_Axis().set_AxisName(name));
        auto& value = space.back_Axis().get_AxisValueChoice().get_AxisFloatingPointValue();
        ok(value.set_AxisNominalMin(0));
        ok(value.set_AxisNominalMax(100));
        if (values.one_in(2)) ok(value.set_AxisNominalScale(L"Scale_Log"));
        ok(value.set_FloatingPointValueType(values.measured(0, 100)));
    }
    ok(space.append_Axis());
    ok(space.back_Axis().set_AxisName(L"Finish"));
    ok(space.back_Axis().get_AxisValueChoice().set_AxisStringValue(varied_text(values)));
}

template<class form>
void fill_inks(form& space, values_t& values) {
    ok(space.set_Cyan(values.decimal(0, 100, 1)));
    ok(space.set_Magenta(values.decimal(0, 100, 1)));
    ok(space.set_Yellow(values.decimal(0, 100, 1)));
    ok(space.set_Black(values.decimal(0, 100, 1)));
    if (values.one_in(2)) {
        ok(space.append_SpotColor());
        ok(space.back_SpotColor().set_Name(L"Varnish"));
        ok(space.back_SpotColor().set_Percentage(100));
    }
}

void fill_spectrum(hqf_v2::ColorSpaceSpectralType& given, values_t& values) {
    auto& space = begin(given, values);
    vary(space.get_ColorSpaceSpecificationSpectrumSpectral(), values);
    for (int wavelength_nm = 400; wavelength_nm <= 700; wavelength_nm += 20) {
        ok(space.append_ReflectancePoint());
        ok(space.back_ReflectancePoint().set_Wavelength(wavelength_nm));
        ok(space.back_ReflectancePoint().set_ReflectancePointType(values.measured(0.02, 0.98)));
    }
}

void fill_recipe(hqf_v2::ColorSpaceRecipeType& given, values_t& values) {
    static const wchar_t* const pigments[] = {L"Titanium dioxide, rutile", L"Red iron oxide", L"Carbon black"};
    auto& space = begin(given, values);
    vary(space.get_ColorSpaceSpecificationSpectrumGeneric(), values);
    for (const wchar_t* pigment : pigments) {
        ok(space.append_ColorantElement());
        auto& element = space.back_ColorantElement();
        auto& colorant = element.get_Colorant();
        if (values.one_in(3)) add_custom_attribute(colorant, "ColourIndex", "C.I. 77891");
        ok(colorant.set_Name(pigment));
        ok(colorant.set_Manufacturer(maker));
        ok(colorant.set_PartNumber(L"P-0" + std::to_wstring(values.below(10))));
        if (values.one_in(3)) {
            colorant.get_Density().setnil_Density();
        } else {
            ok(colorant.get_Density().set_Density(values.measured(1, 6)));
        }
        ok(element.set_Contribution(values.measured(0, 1)));
    }
    if (values.one_in(2)) return;
    auto& base = space.get_BaseElement();
    add_custom_attribute(base.get_Base(), "Batch", static_cast<int>(values.below(1000)));
    ok(base.get_Base().set_Name(L"Acrylic base"));
    ok(base.get_Base().set_Manufacturer(L"Example Coatings"));
    ok(base.get_Base().set_PartNumber(L"B-1"));
    ok(base.set_Contribution(1.25));
}

void fill_reference(hqf_v2::ColorSpaceTINTREFType& given, values_t& values) {
    static const wchar_t* const finishes[] = {L"Finish_Coated", L"Finish_Uncoated", L"Finish_Matte"};
    auto& space = begin(given, values);
    ok(space.set_FamilyName(L"Example house colours"));
    ok(space.get_ColorName().set_PrefixName(L""));
    ok(space.get_ColorName().set_BaseName(colour_name(values.below(500))));
    ok(space.get_ColorName().set_SuffixName(L"C"));
    ok(space.set_Page(L"1.1"));
    ok(space.set_Gamut(L"Gamut_sRGB"));
    ok(space.get_Recipe().append_ColorantElement());
    auto& element = space.get_Recipe().back_ColorantElement();
    ok(element.get_Colorant().append_CustomAttributes());
    auto& grams = element.get_Colorant().back_CustomAttributes().get_CustomAttribute();
    ok(grams.set_Name(L"Grams"));
    ok(grams.get_ValueChoice().set_DoubleValue(values.measured(1, 50)));
    ok(element.get_Colorant().set_Name(L"Yellow iron oxide"));
    ok(element.get_Colorant().set_Manufacturer(maker));
    ok(element.set_Contribution(values.measured(0, 5)));
    ok(space.append_ColorAndFinish());
    ok(space.back_ColorAndFinish().set_Finish(values.one_of(finishes)));
    fill_spectrum(space.back_ColorAndFinish().get_ColorSpaceSpectral(), values);
}

/// A form whose values are three numbers: how to set each, and its range.
template<class form, class conditions>
struct three_numbers {
    form& (sg_ColorSpace::*choose)();
    conditions& (form::*specification)();
    struct {
        lmx::elmx_error (form::*set)(double);
        double low, high;
    } values[3];

    void fill(sg_ColorSpace& space, values_t& from) const {
        form& chosen = begin((space.*choose)(), from);
        vary((chosen.*specification)(), from);
        for (const auto& value : values)
            ok((chosen.*value.set)(from.measured(value.low, value.high)));
    }
};

#define TRIPLE(name, branch, a, low_a, high_a, b, low_b, high_b, c, low_c, high_c)                                     \
    [](sg_ColorSpace& space, values_t& values) {                                                                       \
        using form = hqf_v2::ColorSpace##name##Type;                                                                   \
        using conditions = hqf_v2::ColorSpaceSpecification##branch;                                                    \
        three_numbers<form, conditions>{                                                                               \
            &sg_ColorSpace::get_ColorSpace##name,                                                                      \
            &form::get_ColorSpaceSpecification##branch,                                                                \
            {{&form::set_##a, low_a, high_a}, {&form::set_##b, low_b, high_b}, {&form::set_##c, low_c, high_c}}}       \
            .fill(space, values);                                                                                      \
    }

void (*const forms[])(sg_ColorSpace&, values_t&) = {
    [](sg_ColorSpace& space, values_t& values) { fill_recipe(space.get_ColorSpaceRecipe(), values); },
    [](sg_ColorSpace& space, values_t& values) { fill_reference(space.get_ColorSpaceTINTREF(), values); },
    [](sg_ColorSpace& space, values_t& values) {
        fill_axes(space.get_ColorSpaceGeneric(), values);
        vary(space.get_ColorSpaceGeneric().get_ColorSpaceSpecificationSpectrumGeneric(), values);
    },
    [](sg_ColorSpace& space, values_t& values) {
        fill_axes(space.get_ColorSpaceEmissiveGeneric(), values);
        vary(space.get_ColorSpaceEmissiveGeneric().get_ColorSpaceSpecificationEmissiveGeneric(), values);
    },
    [](sg_ColorSpace& space, values_t& values) {
        auto& densities = begin(space.get_ColorSpaceDensity(), values);
        vary(densities.get_ColorSpaceSpecificationSpectrumGeneric(), values);
        for (const wchar_t* filter : {L"Filter_Cyan", L"Filter_Magenta", L"Filter_Yellow", L"Filter_Visual"}) {
            ok(densities.append_Density());
            ok(densities.back_Density().set_DensityStatus(L"Status_T"));
            ok(densities.back_Density().set_DensityFilter(filter));
            ok(densities.back_Density().set_DensityType(values.measured(0, 2.5)));
        }
    },
    [](sg_ColorSpace& space, values_t& values) { fill_rgb(space.get_ColorSpaceRGB(), values); },
    [](sg_ColorSpace& space, values_t& values) { fill_rgb(space.get_ColorSpaceSRGB(), values); },
    [](sg_ColorSpace& space, values_t& values) { fill_rgb(space.get_ColorSpaceAdobeRGB(), values); },
    [](sg_ColorSpace& space, values_t& values) { fill_rgb(space.get_ColorSpaceAdobeWideGamutRGB(), values); },
    [](sg_ColorSpace& space, values_t& values) { fill_spectrum(space.get_ColorSpaceSpectral(), values); },
    [](sg_ColorSpace& space, values_t& values) {
        auto& spectrum = begin(space.get_ColorSpaceEmissiveSpectral(), values);
        vary(spectrum.get_ColorSpaceSpecificationEmissiveSpectral(), values);
        for (int wavelength_nm = 380; wavelength_nm <= 780; wavelength_nm += 20) {
            ok(spectrum.append_EmissiveSpectralPoint());
            ok(spectrum.back_EmissiveSpectralPoint().set_Wavelength(wavelength_nm));
            ok(spectrum.back_EmissiveSpectralPoint().set_EmissiveSpectralPointType(values.decimal(0, 200, 6)));
        }
    },
    TRIPLE(CIELab, SpectrumTristimulus, L, 0, 100, A, -80, 80, B, -80, 80),
    TRIPLE(CIELCh, SpectrumTristimulus, L, 0, 100, C, 0, 100, H, 0, 359),
    TRIPLE(CIEXYZ, SpectrumTristimulus, X, 0, 1, Y, 0, 1, Z, 0, 1),
    TRIPLE(EmissiveCIEXYZ, EmissiveTristimulus, X, 0, 400, Y, 0, 400, Z, 0, 400),
    TRIPLE(CIExyY, SpectrumTristimulus, X, 0, 1, Y, 0, 1, CapY, 0, 1),
    TRIPLE(EmissiveCIExyY, EmissiveTristimulus, X, 0, 1, Y, 0, 1, CapY, 0, 400),
    TRIPLE(CIELuv, SpectrumTristimulus, L, 0, 100, U, -100, 100, V, -100, 100),
    TRIPLE(HSL, SpectrumGeneric, Hue, 0, 359, Saturation, 0, 1, Lightness, 0, 1),
    TRIPLE(HSV, SpectrumGeneric, Hue, 0, 359, Saturation, 0, 1, Value, 0, 1),
    [](sg_ColorSpace& space, values_t& values) {
        auto& cmyk = begin(space.get_ColorSpaceCMYK(), values);
        vary(cmyk.get_ColorSpaceSpecificationSpectrumGeneric(), values);
        fill_inks(cmyk, values);
    },
    [](sg_ColorSpace& space, values_t& values) {
        auto& sextet = begin(space.get_ColorSpaceTINTREFSextet(), values);
        vary(sextet.get_ColorSpaceSpecificationSpectrumGeneric(), values);
        fill_inks(sextet, values);
        ok(sextet.set_Orange(values.decimal(0, 100, 1)));
        ok(sextet.set_Green(values.decimal(0, 100, 1)));
    },
    TRIPLE(YUV, SpectrumGeneric, Y, 0, 1, U, -0.4, 0.4, V, -0.6, 0.6),
    TRIPLE(YIQ, SpectrumGeneric, Y, 0, 1, I, -0.5, 0.5, Q, -0.5, 0.5),
    TRIPLE(YBR, SpectrumGeneric, Y, 0, 1, B, 0, 1, R, 0, 1),
    [](sg_ColorSpace& space, values_t& values) {
        auto& notation = begin(space.get_ColorSpaceNCS(), values);
        vary(notation.get_ColorSpaceSpecificationSpectrumGeneric(), values);
        ok(notation.set_ColorName(L"NCS S " + std::to_wstring(1000 + values.below(8000)) + L"-Y60R"));
    },
    [](sg_ColorSpace& space, values_t& values) {
        auto& notation = begin(space.get_ColorSpaceMunsell(), values);
        vary(notation.get_ColorSpaceSpecificationSpectrumGeneric(), values);
        ok(notation.set_CollectionName(L"Munsell"));
        ok(notation.set_ColorName(L"3YR " + std::to_wstring(1 + values.below(9)) + L"/3.2"));
    },
};

#undef TRIPLE

static_assert(std::size(forms) == form_count);

} // namespace

void fill_form(hqf_v2::sg_ColorSpace& space, unsigned int form, random_values& values) {
    forms[form](space, values);
}

} // namespace hqf_bench
