/// The first ten lines with the library, as the README shows them. Run it where rendition-chart.hqf lies.

#include <iostream>

#include <hqf/hqf.h>

int main() {
    // clang-format off
    // README begin
    hqf_v2::Hqf document;
    if (lmx::elmx_error code = document.loadFile(L"rendition-chart.hqf"); code != 0)
        return std::cerr << "no chart: " << lmx::get_error_description(code) << '\n', 1;
    hqf_v2::ColorType& color = document.get_Palette(0).get_ColorSet(0).get_Color(0);
    hqf_v2::ColorSpaceCIELabType& lab = color.get_ColorSpace(1).get_ColorSpaceCIELab();
    std::cout << "L* is " << lab.get_L() << '\n';                                // L* is 37.82
    std::cout << "L* of 151 gives code " << lab.set_L(151) << '\n';              // 36: above the maximum, not stored
    lab.set_L(38.1);
    document.get_Preamble().get_Header().set_Comments(L"Dark skin measured again");
    std::cout << "writing gives code " << document.writeFile(L"my-chart.hqf") << '\n'; // 0: all is well
    // README end
    // clang-format on
}
