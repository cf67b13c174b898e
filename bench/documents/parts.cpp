#include "bench/documents/parts.h"

#include <stdexcept>

#include "hqf/values/text.h"

namespace hqf_bench {

void ok(lmx::elmx_error code) {
    if (code != lmx::err_no_error)
        throw std::runtime_error("the model refuses a generated value with code " + std::to_string(code));
}

std::wstring wide(const std::string& utf8) {
    std::wstring text;
    lmx::convert(&text, utf8);
    return text;
}

lmx::c_datetime date(unsigned int number) {
    static const char* const zones[] = {"Z", "+01:00", "-05:00"};
    const auto two_digits = [](unsigned int value) { return std::to_string(100 + value).substr(1); };
    return lmx::c_datetime("2025-" + two_digits(number / 28 % 12 + 1) + "-" + two_digits(number % 28 + 1) + "T" +
                           two_digits(number % 24) + ":" + two_digits(number % 60) + ":" + two_digits(number * 7 % 60) +
                           zones[number % 3]);
}

void add_preamble(hqf_v2::Hqf& document, const std::string& purpose) {
    auto& preamble = document.get_Preamble();
    auto& header = preamble.get_Header();
    add_custom_attribute(header, "ReportNumber", 42);
    ok(header.set_Creator(L"Benchmark"));
    ok(header.set_CreatorVersion(L"1.0"));
    ok(header.append_ChangeHistory(date(0)));
    ok(header.append_ChangeHistory(date(1)));
    ok(header.set_Purpose(wide(purpose)));
    ok(header.set_Comments(L"Generated values; every run makes the same ones"));
    ok(preamble.get_Owner().append_Company(L"Example Colours"));
    ok(preamble.get_Version().set_Version(L"2"));
}

void describe_device(hqf_v2::DeviceType& device, bool hand_held) {
    ok(device.set_Manufacturer(L"Example Instruments"));
    ok(device.set_Model(hand_held ? L"Hand held" : L"Bench 45/0"));
    ok(device.set_SerialNumber(hand_held ? L"H-77" : L"B-1024"));
    ok(device.set_DeviceClass(hand_held ? L"DeviceClass_Scanning" : L"DeviceClass_Spot"));
    ok(device.set_FirmwareVersion(L"2.14"));
    if (hand_held) return;
    ok(device.set_BootFirmwareVersion(L"1.03"));
    ok(device.get_CalibrationState().set_CalibrationStateType(L"CalibrationState_Calibrated"));
    ok(device.get_CalibrationState().set_CalibrationDateTime(date(2)));
    auto& settings = device.get_DeviceSettings();
    add_custom_attribute(settings, "WhiteTile", "T-77");
    ok(settings.set_Aperture(4));
    ok(settings.set_LensPosition(-2));
    ok(settings.set_GlassCompensation(false));
    ok(settings.get_GlossCompensation().set_GlossCompensation(true));
    ok(settings.get_GlossCompensation().set_CompensationValue(0.5));
    ok(settings.get_Averaging().set_Averaging(true));
    ok(settings.get_Averaging().set_AveragingValue(3));
}

std::wstring colour_name(unsigned int number) {
    static const char* const hues[] = {"Red",  "Orange", "Yellow", "Green", "Teal",
                                       "Blue", "Violet", "Purple", "Grün",  "Gris"};
    static const char* const tones[] = {"Light", "Deep", "Warm", "Pale"};
    return wide(std::string(tones[number / 10 % 4]) + ' ' + hues[number % 10] + ' ' + std::to_string(number));
}

} // namespace hqf_bench
