#include "leaf.h"

using namespace hqf_v2;

namespace {

// Reflectance factors from 380 to 730 nm, CIE 13.3; the values in both colour spaces are computed from them.
constexpr double reflectances[] = {0.036, 0.037, 0.039, 0.040, 0.042, 0.043, 0.044, 0.045, 0.047, 0.050, 0.055, 0.062,
                                   0.075, 0.092, 0.108, 0.133, 0.150, 0.155, 0.147, 0.133, 0.118, 0.106, 0.098, 0.093,
                                   0.089, 0.086, 0.084, 0.084, 0.085, 0.092, 0.102, 0.123, 0.152, 0.188, 0.226, 0.260};
constexpr double first_nm = 380, step_nm = 10;

} // namespace

void must(lmx::elmx_error code) {
    if (code != lmx::err_no_error) throw lmx::c_lmx_exception(code);
}

// Conditions are nil in all three forms, because the palette states them for its whole collection. They must be there
// all the same: a form without them is incomplete, and writing the document would end with code 46.
void fill_leaf(ColorType& leaf, const lmx::c_datetime& when) {
    must(leaf.set_ColorName(L"Olive green leaf"));
    must(leaf.set_ColorNumber(L"25"));
    must(leaf.append_ChangeHistory(when));

    must(leaf.append_ColorSpace());
    ColorSpaceSpectralType& spectrum = leaf.back_ColorSpace().get_ColorSpaceSpectral();
    must(spectrum.append_ChangeHistory(when));
    spectrum.get_ColorSpaceSpecificationSpectrumSpectral().setnil_ColorSpaceSpecificationSpectrumSpectral();
    double wavelength = first_nm;
    for (const double reflectance : reflectances) {
        must(spectrum.append_ReflectancePoint());
        must(spectrum.back_ReflectancePoint().set_Wavelength(wavelength));
        must(spectrum.back_ReflectancePoint().set_ReflectancePointType(reflectance));
        wavelength += step_nm;
    }

    must(leaf.append_ColorSpace());
    ColorSpaceCIELabType& lab = leaf.back_ColorSpace().get_ColorSpaceCIELab();
    must(lab.append_ChangeHistory(when));
    lab.get_ColorSpaceSpecificationSpectrumTristimulus().setnil_ColorSpaceSpecificationSpectrumTristimulus();
    must(lab.set_L(40.79));
    must(lab.set_A(-12.39));
    must(lab.set_B(24.06));

    must(leaf.append_ColorSpace());
    ColorSpaceSRGBType& srgb = leaf.back_ColorSpace().get_ColorSpaceSRGB();
    must(srgb.append_ChangeHistory(when));
    srgb.get_ColorSpaceSpecificationSpectrumTristimulus().setnil_ColorSpaceSpecificationSpectrumTristimulus();
    must(srgb.set_Red(0.3377));
    must(srgb.set_Green(0.398));
    must(srgb.set_Blue(0.2165));
    srgb.setenum_ColorDepth(ColorSpaceSRGBType::e_ColorDepth_Infinite);
}
