/// Palettes of 500 colours in sets of 100, each colour as CIELAB, sRGB and CMYK. In every second set the conditions
/// stand once, in the set, and those of each value are nil; in the others each value has its own.

#include "bench/documents/documents.h"
#include "bench/documents/parts.h"

namespace hqf_bench {

namespace {

class palettes final : public author {
public:
    void add_to(hqf_v2::Hqf& document) override {
        if (number_ % 500 == 0) add_palette(document);
        auto& palette = document.back_Palette();
        if (number_ % 100 == 0) add_set(palette);
        auto& set = palette.back_ColorSet();
        ok(set.append_Color());
        fill(set.back_Color());
        ++number_;
    }

private:
    bool conditions_in_set() const { return number_ / 100 % 2 == 0; }

    void add_palette(hqf_v2::Hqf& document) {
        ok(document.append_Palette());
        auto& palette = document.back_Palette();
        ok(palette.set_PaletteName(L"Interior " + std::to_wstring(number_)));
        ok(palette.set_UniqueID(L"palette-" + std::to_wstring(number_)));
        ok(palette.append_ChangeHistory(date(number_)));
        ok(palette.append_SemanticAssociation(L"Walls"));
    }

    void add_set(hqf_v2::PaletteType& palette) {
        ok(palette.append_ColorSet());
        auto& set = palette.back_ColorSet();
        ok(set.set_ColorSetName(L"Season " + std::to_wstring(number_)));
        ok(set.append_ChangeHistory(date(number_)));
        if (!conditions_in_set()) return;
        auto& conditions = set.get_CollectionColorSpaceSpecification();
        auto& generic = conditions.get_ColorSpaceSpecificationSpectrumGeneric();
        measure_reflectance(generic, date(number_));
        auto& tristimulus = conditions.get_ColorSpaceSpecificationSpectrumTristimulus();
        measure_reflectance(tristimulus, date(number_));
        calculate_tristimulus(tristimulus, L"Illuminant_D50");
        measure_at_45_degrees(tristimulus);
    }

    void fill(hqf_v2::ColorType& color) {
        ok(color.set_ColorName(colour_name(number_)));
        ok(color.set_ColorNumber(std::to_wstring(number_)));
        ok(color.append_ChangeHistory(date(number_)));

        ok(color.append_ColorSpace());
        auto& lab = color.back_ColorSpace().get_ColorSpaceCIELab();
        ok(lab.append_ChangeHistory(date(number_)));
        describe(lab.get_ColorSpaceSpecificationSpectrumTristimulus(), L"Illuminant_D50");
        ok(lab.set_L(values_.measured(5, 98)));
        ok(lab.set_A(values_.measured(-80, 80)));
        ok(lab.set_B(values_.measured(-80, 80)));

        ok(color.append_ColorSpace());
        auto& srgb = color.back_ColorSpace().get_ColorSpaceSRGB();
        ok(srgb.append_ChangeHistory(date(number_)));
        describe(srgb.get_ColorSpaceSpecificationSpectrumTristimulus(), L"Illuminant_D65");
        ok(srgb.set_Red(values_.decimal(0, 1, 4)));
        ok(srgb.set_Green(values_.decimal(0, 1, 4)));
        ok(srgb.set_Blue(values_.decimal(0, 1, 4)));
        ok(srgb.set_ColorDepth(L"ColorDepth_8"));

        ok(color.append_ColorSpace());
        auto& cmyk = color.back_ColorSpace().get_ColorSpaceCMYK();
        ok(cmyk.append_ChangeHistory(date(number_)));
        cmyk.get_ColorSpaceSpecificationSpectrumGeneric().setnil_ColorSpaceSpecificationSpectrumGeneric();
        ok(cmyk.set_Cyan(values_.decimal(0, 100, 2)));
        ok(cmyk.set_Magenta(values_.decimal(0, 100, 2)));
        ok(cmyk.set_Yellow(values_.decimal(0, 100, 2)));
        ok(cmyk.set_Black(values_.decimal(0, 100, 2)));
    }

    void describe(hqf_v2::ColorSpaceSpecificationSpectrumTristimulus& conditions, const wchar_t* illuminant) {
        if (conditions_in_set()) {
            conditions.setnil_ColorSpaceSpecificationSpectrumTristimulus();
            return;
        }
        measure_reflectance(conditions, date(number_));
        calculate_tristimulus(conditions, illuminant);
        measure_at_45_degrees(conditions);
    }

    random_values values_{1};
    unsigned int number_ = 0;
};

} // namespace

std::unique_ptr<author> palette_author() {
    return std::make_unique<palettes>();
}

} // namespace hqf_bench
