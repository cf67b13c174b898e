// What the library writes is valid against the schema, as another program judges it; and what the interface lets
// through although the schema forbids it is known by name.

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <iterator>
#include <map>
#include <set>

#include "tests/document/support.h"
#include "tests/model/corpus.h"
#include "tests/support/documents.h"

namespace {

using namespace document_test;

bool ends_with(const std::string& text, const std::string& end) {
    return text.size() >= end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

/// Names of the documents, and whether xmllint finds them valid.
std::map<std::string, bool> validate(const std::map<std::string, std::string>& documents) {
    const folder place;
    std::string list;
    for (const auto& [name, text] : documents) {
        make_file(place / name, text);
        list += (place / name).string() + '\n';
    }
    make_file(place / "list", list);
    const std::string command =
        "xargs -n 500 " HQF_XMLLINT " --noout --schema " HQF_SCHEMA " < '" + (place / "list").string() + "' 2>&1";
    std::map<std::string, bool> result;
    std::FILE* const pipe = popen(command.c_str(), "r");
    char line[4096];
    while (pipe != nullptr && std::fgets(line, sizeof line, pipe) != nullptr) {
        const std::string text(line);
        for (const auto& [end, valid] :
             {std::pair<std::string, bool>(" validates\n", true), {" fails to validate\n", false}})
            if (ends_with(text, end)) {
                const std::string path = text.substr(0, text.size() - end.size());
                result[path.substr(path.rfind('/') + 1)] = valid;
            }
    }
    if (pipe != nullptr) pclose(pipe);
    return result;
}

class validation : public testing::Test {
protected:
    void SetUp() override {
        if (*HQF_XMLLINT == '\0') GTEST_SKIP() << "no xmllint (package libxml2-utils)";
    }
};

/// Ends of the names of corpus cases that load, and are written as what the schema refuses.
const struct {
    const char* end;
    const char* why;
} exceptions[] = {
    {"'2024-02-30T10:00:00Z'", "dates are digits to the library, and no calendar has this one"},
    {"H '359.99999999999994'", "14 digits round it onto its open bound"},
    {"Hue '359.99999999999994'", "the same"},
    {"ReflectancePointType: body '-0.9999999999999999'", "the same"},
    {"ReflectancePointType: body '9.999999999999998'", "the same"},
};

TEST_F(validation, what_is_written_is_valid) {
    const std::set<std::string_view> families = {"sound",         "nil",    "choice",   "group",
                                                 "literal",       "bound",  "wildcard", "attribute missing",
                                                 "unknown child", "length", "twice"};
    std::map<std::string, std::string> documents;
    std::map<std::string, std::string> names;
    const auto add = [&](const std::string& name, std::string_view text) {
        hqf_v2::Hqf document;
        ASSERT_EQ(document.unmarshal(std::string(text)), 0) << name;
        const std::string number = std::to_string(documents.size()) + ".xml";
        documents[number] = written(document);
        names[number] = name;
    };
    for (const char* kind : {"documents", "syntax"})
        for (const auto& [name, text] : support::documents(kind))
            add(name, text);
    const std::string bytes = corpus::bytes();
    for (const corpus::test_case& test : corpus::cases(bytes))
        if (test.code == 0 && test.write == "0" && families.count(test.family))
            add(std::string(test.family) + ", " + std::string(test.what), test.document);
    const auto found = validate(documents);
    EXPECT_EQ(found.size(), documents.size()) << "xmllint didn't judge all";
    for (const auto& [number, valid] : found) {
        const std::string& name = names[number];
        const auto* const exception = std::find_if(std::begin(exceptions), std::end(exceptions),
                                                   [&](const auto& each) { return ends_with(name, each.end); });
        EXPECT_EQ(valid, exception == std::end(exceptions)) << name << '\n' << documents[number];
    }
}

/// A palette with a device, and a quality-control record.
struct whole {
    hqf_v2::Hqf document;
    hqf_v2::ColorSpaceSpecificationSpectrumGenericType& specification() {
        return document.get_Palette(0)
            .get_CollectionColorSpaceSpecification()
            .get_ColorSpaceSpecificationSpectrumGeneric();
    }
    hqf_v2::DeviceSettings& settings() { return specification().get_Device().get_DeviceSettings(); }
    hqf_v2::ColorQualityControlType& control() { return document.get_ColorQualityControl(0); }

    whole() {
        const lmx::c_datetime date("2024-05-01T09:00:00Z");
        fill_header(document);
        document.get_Palette(0).set_PaletteName(L"p");
        document.get_Palette(0).append_ChangeHistory(date);
        auto& made = specification();
        made.get_DeviceFilter().setnil_DeviceFilter();
        made.get_DevicePolarization().set_DevicePolarization(false);
        made.append_ChangeHistory(date);
        made.get_Spectrum().set_SpectrumType(L"Spectrum_Reflectance");
        auto& device = made.get_Device();
        device.set_Manufacturer(L"");
        device.set_Model(L"");
        device.set_SerialNumber(L"");
        settings().get_Averaging().set_AveragingValue(2);
        settings().get_Averaging().set_Averaging(true);
        control().append_ChangeHistory(date);
        control().append_StandardAndMeasurement();
        control().back_StandardAndMeasurement().get_Standard().setnil_Standard();
        auto& target = control().get_PhysicalSample().get_Sample().get_SampleTarget();
        target.get_Substrate().get_SubstratePaper();
        target.set_Target(L"Target_Custom");
        control().append_Tolerance();
        control().back_Tolerance().get_Function().get_FunctionDE();
    }
};

TEST_F(validation, what_the_interface_lets_through) {
    const struct {
        const char* name;
        bool valid;
        void (*edit)(whole&);
        const char* why;
    } rows[] = {
        {"whole", true, [](whole&) {}, "all others are this one with one change"},
        {"aperture-1", true, [](whole& w) { w.settings().set_Aperture(1); }, "inside"},
        {"aperture-0", false, [](whole& w) { w.settings().set_Aperture(0); }, "the setter has no minimum"},
        {"temperature-0", false, [](whole& w) { w.specification().get_IlluminationOptions().set_ColorTemperature(0); },
         "nor has this one"},
        {"unset-body", false, [](whole& w) { w.settings().get_Averaging().unset_Averaging(); },
         "a body that may be unset is written empty, and empty is no boolean"},
        {"plain-function", false, [](whole& w) { w.control().back_Tolerance().get_Function().get_Function(); },
         "the head of the group is abstract and names no type"},
        {"typed-function", true,
         [](whole& w) { w.control().back_Tolerance().get_Function().assign_Function(new hqf_v2::FunctionDEType); },
         "with a type it is as good as any"},
        {"empty-date", false, [](whole& w) { w.control().append_ChangeHistory(lmx::c_datetime()); },
         "list setters check nothing"},
        {"no-such-day", false,
         [](whole& w) { w.control().append_ChangeHistory(lmx::c_datetime("2024-02-30T10:00:00Z")); },
         "dates are digits to the library"},
        {"no-zone", false, [](whole& w) { w.control().append_ChangeHistory(lmx::c_datetime("2024-05-01T10:00:00")); },
         "the writer asks for no zone"},
    };
    std::map<std::string, std::string> documents;
    for (const auto& row : rows) {
        whole edited;
        row.edit(edited);
        documents[row.name] = written(edited.document);
    }
    const auto found = validate(documents);
    for (const auto& row : rows) {
        ASSERT_TRUE(found.count(row.name)) << row.name << " wasn't judged:\n" << documents[row.name];
        EXPECT_EQ(found.at(row.name), row.valid) << row.name << ": " << row.why << '\n' << documents[row.name];
    }
}

} // namespace
