/// Reflectance spectra, in turn of 36 points (380 to 730 nm in steps of 10) and of 81 (380 to 780 nm in steps of 5),
/// each with its conditions.

#include <algorithm>

#include "bench/documents/documents.h"
#include "bench/documents/parts.h"

namespace hqf_bench {

namespace {

class spectra final : public author {
public:
    void add_to(hqf_v2::Hqf& document) override {
        if (number_ % 100 == 0) add_palette(document);
        auto& set = document.back_Palette().back_ColorSet();
        ok(set.append_Color());
        auto& color = set.back_Color();
        ok(color.set_ColorName(colour_name(number_)));
        ok(color.set_ColorNumber(std::to_wstring(number_)));
        ok(color.append_ChangeHistory(date(number_)));
        ok(color.append_ColorSpace());
        fill(color.back_ColorSpace().get_ColorSpaceSpectral());
        ++number_;
    }

private:
    void add_palette(hqf_v2::Hqf& document) {
        ok(document.append_Palette());
        auto& palette = document.back_Palette();
        ok(palette.set_PaletteName(L"Measured samples " + std::to_wstring(number_)));
        ok(palette.append_ChangeHistory(date(number_)));
        ok(palette.append_ColorSet());
        auto& set = palette.back_ColorSet();
        ok(set.set_ColorSetName(L"Box " + std::to_wstring(number_)));
        ok(set.append_ChangeHistory(date(number_)));
    }

    void fill(hqf_v2::ColorSpaceSpectralType& spectral) {
        ok(spectral.append_ChangeHistory(date(number_)));
        auto& conditions = spectral.get_ColorSpaceSpecificationSpectrumSpectral();
        measure_reflectance(conditions, date(number_));
        measure_at_45_degrees(conditions);

        const bool fine = number_ % 2 == 1;
        const int last_nm = fine ? 780 : 730;
        const int step_nm = fine ? 5 : 10;
        const int digits = 4 + static_cast<int>(values_.below(3));
        double reflectance = values_.decimal(0.03, 0.9, digits);
        for (int wavelength_nm = 380; wavelength_nm <= last_nm; wavelength_nm += step_nm) {
            ok(spectral.append_ReflectancePoint());
            auto& point = spectral.back_ReflectancePoint();
            ok(point.set_Wavelength(wavelength_nm));
            ok(point.set_ReflectancePointType(reflectance));
            reflectance =
                values_.decimal(std::max(0.02, reflectance - 0.03), std::min(0.98, reflectance + 0.03), digits);
        }
    }

    random_values values_{2};
    unsigned int number_ = 0;
};

} // namespace

std::unique_ptr<author> spectrum_author() {
    return std::make_unique<spectra>();
}

} // namespace hqf_bench
