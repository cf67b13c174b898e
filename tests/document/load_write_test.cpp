// The four operations of the root class on files and texts: suffixes, codes, stamps, and what a failure leaves behind.

#include <gtest/gtest.h>

#include <map>

#include "tests/document/support.h"
#include "tests/support/documents.h"

namespace {

using namespace document_test;

constexpr char smallest[] = R"(<?xml version="1.0" encoding="UTF-8"?>
<Hqf:Hqf xmlns:Hqf="http://hqf.example/v2" xmlns:xsi="http://www.w3.org/2001/XMLSchema-instance">
	<Hqf:Preamble>
		<Hqf:Header>
			<Hqf:Creator>tests</Hqf:Creator>
			<Hqf:CreatorVersion>1</Hqf:CreatorVersion>
			<Hqf:ChangeHistory>2024-05-01T09:00:00Z</Hqf:ChangeHistory>
			<Hqf:Purpose></Hqf:Purpose>
			<Hqf:ReadSDKInformation>
				<Hqf:SDKName>Hqf2-LMX-3.7.6</Hqf:SDKName>
				<Hqf:SDKVersion>1.0</Hqf:SDKVersion>
			</Hqf:ReadSDKInformation>
			<Hqf:WriteSDKInformation>
				<Hqf:SDKName>Hqf2-LMX-3.7.6</Hqf:SDKName>
				<Hqf:SDKVersion>1.0</Hqf:SDKVersion>
			</Hqf:WriteSDKInformation>
		</Hqf:Header>
	</Hqf:Preamble>
</Hqf:Hqf>
)";

std::string replaced(std::string text, const std::string& old, const std::string& with) {
    const std::size_t at = text.find(old);
    if (at == std::string::npos) throw std::logic_error("not there: " + old);
    return text.replace(at, old.size(), with);
}

bool is_write_stamped(const hqf_v2::Hqf& document) {
    return document.get_Preamble().get_Header().isset_WriteSDKInformation();
}

TEST(write_file, suffix_decides) {
    // The end of the name counts, capitals are another suffix, and an archive's XML file stands beside it.
    const std::map<std::string, int> names = {{"a.hqf", 0},      {".hqf", 0},       {"a.hqfz.hqf", 0}, {"a.hqfz", 0},
                                              {"中-𝄞.hqf", 0},   {"a.HQF", 1001},   {"a.HQFZ", 1001},  {"a.xml", 1001},
                                              {"a.hqf ", 1001},  {"a.hqfzz", 1001}, {"hqf", 1001},     {"a", 1001},
                                              {"none/a.hqf", 1}, {"none/a.hqfz", 1}};
    for (const auto& [name, code] : names) {
        const folder place;
        hqf_v2::Hqf document, again;
        fill_header(document);
        EXPECT_EQ(document.writeFile(wide(place / name)), code) << name;
        EXPECT_EQ(place.size(), code == 0 ? 1u : 0u) << name;
        EXPECT_EQ(is_write_stamped(document), code == 0) << name << ": no stamp before the file is open";
        if (code != 0) continue;
        EXPECT_EQ(bytes_of(place / name) == smallest, name.back() == 'f') << name;
        EXPECT_EQ(again.loadFile(wide(place / name)), 0) << name;
        EXPECT_TRUE(hqf::equal(document, again)) << name;
    }
    for (const wchar_t* path : {L"", L"f", L"hqfz"})
        EXPECT_EQ(hqf_v2::Hqf().writeFile(path), 1001) << "shorter";
}

TEST(write_file, failures_leave_no_file) {
    const folder place;
    std::filesystem::create_directories(place / "folder.hqf");
    make_file(place / "old.hqf", "old");
    hqf_v2::Hqf incomplete;
    for (const char* name : {"new.hqf", "old.hqf", "new.hqfz"})
        EXPECT_EQ(incomplete.writeFile(wide(place / name)), 46) << name;
    EXPECT_EQ(incomplete.marshal((place / "new.hqf").c_str()), 46);
    EXPECT_EQ(place.size(), 1u) << "only the folder is left; the old file was truncated first";
    EXPECT_TRUE(is_write_stamped(incomplete)) << "before the first element";
    EXPECT_EQ(incomplete.writeFile(wide(place / "folder.hqf")), 1) << "a folder can't be opened";

    // Incomplete far behind a buffer's length: what had reached the disk goes, too.
    hqf_v2::Hqf long_one;
    ASSERT_EQ(long_one.unmarshal(support::document("documents/rendition-chart.hqf")), 0);
    long_one.append_ColorQualityControl();
    EXPECT_EQ(long_one.writeFile(wide(place / "long.hqf")), 46);
    EXPECT_FALSE(std::filesystem::exists(place / "long.hqf"));

    struct : hqf_v2::FunctionDE {
        lmx::elmx_error marshal(lmx::c_xml_writer&, const char*) override { throw std::bad_alloc(); }
    } without_memory;
    EXPECT_THROW(static_cast<hqf_v2::FunctionDE&>(without_memory).marshal((place / "thrown").c_str()), std::bad_alloc);
    EXPECT_FALSE(std::filesystem::exists(place / "thrown"));

    // A disk without room, reached by a link: never name the device itself, since the file is deleted.
    if (!std::filesystem::exists("/dev/full")) GTEST_SKIP() << "no /dev/full";
    long_one.clear_ColorQualityControl();
    hqf_v2::Hqf small; // smaller than the stream's buffer
    fill_header(small);
    for (hqf_v2::Hqf* const document : {&long_one, &small})
        for (const bool by_path : {true, false}) {
            const auto path = place / "full.hqf";
            std::filesystem::create_symlink("/dev/full", path);
            EXPECT_EQ(by_path ? document->writeFile(wide(path)) : document->marshal(path.c_str()), 42);
            EXPECT_FALSE(std::filesystem::is_symlink(path));
        }
}

TEST(load_file, any_name_but_an_archive_s_is_xml) {
    const folder place;
    for (const std::string name : {"a.hqf", "a.txt", "a.HQFZ", "a.hqfz.bak", "a", "é𝄞"}) {
        make_file(place / name, smallest);
        EXPECT_EQ(hqf_v2::Hqf().loadFile(wide(place / name)), 0) << name;
        std::filesystem::remove(place / name);
        EXPECT_EQ(hqf_v2::Hqf().loadFile(wide(place / name)), 1) << name << " is gone";
    }
    EXPECT_EQ(hqf_v2::Hqf().loadFile(L""), 1);
    EXPECT_EQ(hqf_v2::Hqf().unmarshal(""), 1) << "a narrow path";
    // This overload knows nothing of archives.
    make_file(place / "a.hqfz", smallest);
    EXPECT_EQ(hqf_v2::Hqf().unmarshal((place / "a.hqfz").c_str()), 0);
}

TEST(stamps, where_they_come_from_and_go) {
    using hqf_v2::Hqf;
    const auto read_name = [](const Hqf& document) {
        const auto& header = document.get_Preamble().get_Header();
        return header.isset_ReadSDKInformation() ? header.get_ReadSDKInformation().get_SDKName() : L"none";
    };
    Hqf document;
    EXPECT_EQ(read_name(document), L"Hqf2-LMX-3.7.6");
    EXPECT_EQ(document.get_Preamble().get_Header().get_ReadSDKInformation().get_SDKVersion().get_SDKVersion(), L"1.0");
    EXPECT_FALSE(is_write_stamped(document));

    const auto failed = document.writeString();
    EXPECT_TRUE(failed.getElmxError() == 46 && failed.getXmlDocument().empty());
    EXPECT_TRUE(is_write_stamped(document)) << "a failed write stamps";
    document.reset();
    EXPECT_FALSE(is_write_stamped(document));
    EXPECT_EQ(read_name(document), L"Hqf2-LMX-3.7.6") << "reset makes a new document, and that is stamped";

    fill_header(document);
    EXPECT_EQ(written(document).find("WriteSDKInformation"), std::string::npos) << "marshal doesn't stamp";
    EXPECT_FALSE(is_write_stamped(document));
    EXPECT_EQ(document.writeString().getXmlDocument(), wide(std::string(smallest)));
    EXPECT_TRUE(is_write_stamped(document)) << "the stamp stays";

    const std::string of_another = replaced(smallest, "Hqf2-LMX-3.7.6", "another");
    ASSERT_EQ(document.unmarshal(of_another), 0);
    EXPECT_EQ(read_name(document), L"another") << "a file's own information replaces the stamp";
    const std::size_t from = of_another.find("\t\t\t<Hqf:ReadSDK"), to = of_another.find("\t\t\t<Hqf:WriteSDK");
    Hqf fresh;
    ASSERT_EQ(fresh.unmarshal(std::string(of_another).erase(from, to - from)), 0);
    EXPECT_EQ(read_name(fresh), L"Hqf2-LMX-3.7.6") << "a file without it leaves the stamp";
}

TEST(load, appends_and_keeps_what_was_read) {
    const std::string chart = support::document("documents/test-color-samples.hqf");
    hqf_v2::Hqf document, once;
    ASSERT_EQ(once.unmarshal(chart), 0);
    ASSERT_GT(once.size_Color(), 0u);
    for (int round = 0; round < 2; ++round)
        ASSERT_EQ(document.unmarshal(chart), 0);
    EXPECT_EQ(document.size_Color(), 2 * once.size_Color());
    EXPECT_EQ(document.get_Preamble().get_Header().size_ChangeHistory(),
              2 * once.get_Preamble().get_Header().size_ChangeHistory());
    EXPECT_EQ(document.writeString().getElmxError(), 0);

    // The colour that failed stays, without what didn't come.
    const std::size_t colour = chart.find("<Hqf:Color ");
    hqf_v2::Hqf part;
    EXPECT_NE(part.unmarshal(chart.substr(0, chart.find("</Hqf:ColorSpace", colour))), 0);
    EXPECT_EQ(part.size_Color(), 1u);
    EXPECT_EQ(part.get_Color(0).get_ColorName(), once.get_Color(0).get_ColorName());
    part.reset();
    EXPECT_EQ(part.unmarshal(chart), 0);
    EXPECT_TRUE(hqf::equal(part, once)) << "valid after a failure";

    // Single members are overwritten.
    EXPECT_EQ(part.unmarshal(replaced(smallest, "tests", "later")), 0);
    EXPECT_EQ(part.get_Preamble().get_Header().get_Creator(), L"later");
    EXPECT_EQ(part.size_Color(), once.size_Color());
}

} // namespace
