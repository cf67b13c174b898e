#include "colour_table.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

#include "hqf/values/text.h"

namespace {

constexpr int first_nm = 380, last_nm = 730, step_nm = 10;

/// The forms that a row shows; null where the colour has none of that kind.
struct shown_forms {
    const hqf_v2::ColorSpaceCIELabType* lab = nullptr;
    const hqf_v2::ColorSpaceSRGBType* srgb = nullptr;
    const hqf_v2::ColorSpaceMunsellType* munsell = nullptr;
    const hqf_v2::ColorSpaceSpectralType* spectrum = nullptr;
};

shown_forms forms_of(const hqf_v2::ColorType& color) {
    using space = hqf_v2::sg_ColorSpace;
    shown_forms forms;
    for (unsigned int i = 0; i < color.size_ColorSpace(); ++i) {
        const space& form = color.get_ColorSpace(i);
        switch (form.getchosen()) {
        case space::chosen_ColorSpaceCIELab: forms.lab = &form.get_ColorSpaceCIELab(); break;
        case space::chosen_ColorSpaceSRGB: forms.srgb = &form.get_ColorSpaceSRGB(); break;
        case space::chosen_ColorSpaceMunsell: forms.munsell = &form.get_ColorSpaceMunsell(); break;
        case space::chosen_ColorSpaceSpectral: forms.spectrum = &form.get_ColorSpaceSpectral(); break;
        default: break; // a colour may have values in 23 more
        }
    }
    return forms;
}

template<class... arguments>
std::string formatted(const char* format, arguments... values) {
    char text[160];
    std::snprintf(text, sizeof text, format, values...);
    return text;
}

/// Counts UTF-16 units, which is the width of names in European writing.
std::string padded(std::wstring text, std::size_t width) {
    if (text.size() < width) text.resize(width, L' ');
    return narrow(text);
}

std::string lab_text(const hqf_v2::ColorSpaceCIELabType* lab) {
    if (lab == nullptr) return formatted("%7s %7s %7s", "-", "-", "-");
    return formatted("%7.2f %7.2f %7.2f", lab->get_L(), lab->get_A(), lab->get_B());
}

std::string swatch_text(const hqf_v2::ColorSpaceSRGBType* srgb, bool in_colour) {
    if (srgb == nullptr) return "   -      ";
    const auto byte = [](double value) { return static_cast<int>(std::lround(std::clamp(value, 0.0, 1.0) * 255)); };
    const int red = byte(srgb->get_Red()), green = byte(srgb->get_Green()), blue = byte(srgb->get_Blue());
    const std::string block = in_colour ? formatted("\x1b[48;2;%d;%d;%dm  \x1b[0m", red, green, blue) : "  ";
    return block + formatted(" #%02X%02X%02X", red, green, blue);
}

/// The curve, one character for each 10 nm, and the point where it is highest. The curve goes from 0 to its peak, so
/// that a dark colour shows its shape, too; the number behind it gives the scale.
std::string spectrum_text(const hqf_v2::ColorSpaceSpectralType* spectrum) {
    static constexpr const char* eighths[] = {"▁", "▂", "▃", "▄", "▅", "▆", "▇", "█"};
    if (spectrum == nullptr || spectrum->size_ReflectancePoint() == 0) return "-";
    const hqf_v2::ReflectancePointType* peak = &spectrum->get_ReflectancePoint(0);
    for (unsigned int i = 1; i < spectrum->size_ReflectancePoint(); ++i) {
        const auto& point = spectrum->get_ReflectancePoint(i);
        if (point.get_ReflectancePointType() > peak->get_ReflectancePointType()) peak = &point;
    }
    const char* curve[(last_nm - first_nm) / step_nm + 1];
    std::fill(std::begin(curve), std::end(curve), " ");
    for (unsigned int i = 0; i < spectrum->size_ReflectancePoint(); ++i) {
        const auto& point = spectrum->get_ReflectancePoint(i);
        const double place = (point.get_Wavelength() - first_nm) / step_nm;
        if (place < 0 || place > (last_nm - first_nm) / step_nm) continue;
        const double height = point.get_ReflectancePointType() / peak->get_ReflectancePointType();
        curve[std::lround(place)] = eighths[static_cast<int>(std::clamp(height * 8, 0.0, 7.0))];
    }
    std::string text;
    for (const char* piece : curve)
        text += piece;
    return text + formatted("  %3.0f nm %5.1f %%", peak->get_Wavelength(), peak->get_ReflectancePointType() * 100);
}

std::string geometry_text(const hqf_v2::GeometryChoiceType& geometry) {
    switch (geometry.getchosen()) {
    case hqf_v2::GeometryChoiceType::chosen_Angle: return formatted("geometry %g°", geometry.get_Angle());
    case hqf_v2::GeometryChoiceType::chosen_SphereGeometry: return narrow(geometry.get_SphereGeometry());
    case hqf_v2::GeometryChoiceType::chosen_UnknownGeometry: return narrow(geometry.get_UnknownGeometry());
    default: return "geometry not stated";
    }
}

} // namespace

std::string narrow(const std::wstring& text) {
    std::string out;
    return lmx::convert(&out, text);
}

std::string conditions(const hqf_v2::PaletteType& palette) {
    using tristimulus = hqf_v2::ColorSpaceSpecificationSpectrumTristimulusType;
    // All through const references: the other get_X() of an optional child marks it present, and it would be written.
    const auto& collection = palette.get_CollectionColorSpaceSpecification();
    if (!palette.isset_CollectionColorSpaceSpecification() ||
        !collection.isset_ColorSpaceSpecificationSpectrumTristimulus())
        return "conditions stand with each value";
    const tristimulus& values = collection.get_ColorSpaceSpecificationSpectrumTristimulus();
    const auto& light = values.get_IlluminationOptions();
    std::string illuminant = light.getchosen() == hqf_v2::IlluminationOptionsType::chosen_Illuminant
                                 ? narrow(light.get_Illuminant().get_Illuminant()) // "Illuminant_D50"
                                 : "Illuminant by chromaticity or temperature";
    std::ranges::replace(illuminant, '_', ' ');
    const bool is_10_degree = values.getenum_FieldOfView() == tristimulus::e_FieldOfView_10_Degree;
    return illuminant + (is_10_degree ? ", 10° observer, " : ", 2° observer, ") +
           geometry_text(values.get_GeometryChoice());
}

void colour_table::heading() {
    out_ << "\n No  Name                  L*      a*      b*   sRGB         Munsell         "
         << formatted("%d nm      reflectance      %d nm  peak\n", first_nm, last_nm);
}

void colour_table::colour_set(const hqf_v2::ColorSetType& set) {
    out_ << '\n' << narrow(set.get_ColorSetName()) << '\n';
    for (unsigned int i = 0; i < set.size_Color(); ++i)
        row(set.get_Color(i));
}

void colour_table::row(const hqf_v2::ColorType& color) {
    const shown_forms forms = forms_of(color);
    out_ << formatted("%3s  ", narrow(color.get_ColorNumber()).c_str()) << padded(color.get_ColorName(), 16) << ' '
         << lab_text(forms.lab) << "   " << swatch_text(forms.srgb, in_colour_) << "   "
         << padded(forms.munsell == nullptr ? L"-" : forms.munsell->get_ColorName(), 14) << "  "
         << spectrum_text(forms.spectrum) << '\n';
}
