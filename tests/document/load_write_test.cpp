// The four operations of the root class on files and texts: suffixes, codes, stamps, and what a failure leaves behind.

#include <gtest/gtest.h>

#include <cstring>

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
    const struct {
        const char* name;
        int code;
        const char* file; // the one that is there afterwards
        const char* why;
    } rows[] = {
        {"a.hqf", 0, "a.hqf", "plain XML"},
        {".hqf", 0, ".hqf", "an empty stem is one, too"},
        {"a.hqfz.hqf", 0, "a.hqfz.hqf", "the end counts"},
        {"a.hqfz", 0, "a.hqfz", "an archive, and its XML file is gone"},
        {"Grün-\xE4\xB8\xAD-\xF0\x9D\x84\x9E.hqf", 0, "Grün-\xE4\xB8\xAD-\xF0\x9D\x84\x9E.hqf",
         "a path of any letters"},
        {"a.HQF", 1001, nullptr, "capitals are another suffix"},
        {"a.HQFZ", 1001, nullptr, "in archives, too"},
        {"a.xml", 1001, nullptr, "neither suffix"},
        {"a.hqf ", 1001, nullptr, "a blank belongs to the name"},
        {"a.hqfzz", 1001, nullptr, "longer than a suffix"},
        {"hqf", 1001, nullptr, "no point"},
        {"a", 1001, nullptr, "no suffix"},
        {"none/a.hqf", 1, nullptr, "no such folder"},
        {"none/a.hqfz", 1, nullptr, "the archive's XML file stands beside it"},
    };
    for (const auto& row : rows) {
        const folder place;
        hqf_v2::Hqf document;
        fill_header(document);
        EXPECT_EQ(document.writeFile(wide(place / row.name)), row.code) << row.why;
        EXPECT_EQ(place.size(), row.file ? 1u : 0u) << row.why;
        EXPECT_EQ(is_write_stamped(document), row.code == 0) << row.why << ": no stamp before the file is open";
        if (!row.file) continue;
        EXPECT_TRUE(std::filesystem::exists(place / row.file)) << row.why;
        const bool plain = row.file[std::strlen(row.file) - 1] == 'f';
        EXPECT_EQ(bytes_of(place / row.file) == smallest, plain) << row.why;
        hqf_v2::Hqf again;
        EXPECT_EQ(again.loadFile(wide(place / row.file)), 0) << row.why;
        EXPECT_TRUE(hqf::equal(document, again)) << row.why;
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

    // A disk without room, reached by a link: never name the device itself, since the file is deleted.
    if (!std::filesystem::exists("/dev/full")) GTEST_SKIP() << "no /dev/full";
    long_one.clear_ColorQualityControl();
    for (const bool by_path : {true, false}) {
        std::filesystem::create_symlink("/dev/full", place / "full.hqf");
        EXPECT_EQ(by_path ? long_one.writeFile(wide(place / "full.hqf"))
                          : long_one.marshal((place / "full.hqf").c_str()),
                  42);
        EXPECT_FALSE(std::filesystem::is_symlink(place / "full.hqf"));
    }
    hqf_v2::Hqf small;
    fill_header(small);
    std::filesystem::create_symlink("/dev/full", place / "full.hqf");
    EXPECT_EQ(small.writeFile(wide(place / "full.hqf")), 42) << "smaller than the stream's buffer";
    EXPECT_TRUE(std::filesystem::exists("/dev/full"));
}

TEST(load_file, any_name_but_an_archive_s_is_xml) {
    const folder place;
    const struct {
        const char* name;
        int code;
    } rows[] = {{"a.hqf", 0},      {"a.txt", 0}, {"a.HQFZ", 0},
                {"a.hqfz.bak", 0}, {"a", 0},     {"\xC3\xA9\xF0\x9D\x84\x9E", 0}};
    for (const auto& row : rows) {
        make_file(place / row.name, smallest);
        EXPECT_EQ(hqf_v2::Hqf().loadFile(wide(place / row.name)), row.code) << row.name;
        std::filesystem::remove(place / row.name);
        EXPECT_EQ(hqf_v2::Hqf().loadFile(wide(place / row.name)), 1) << row.name << " is gone";
    }
    EXPECT_EQ(hqf_v2::Hqf().loadFile(L""), 1);
    EXPECT_EQ(hqf_v2::Hqf().unmarshal(""), 1) << "a narrow path";
    // This overload knows nothing of archives.
    make_file(place / "a.hqfz", smallest);
    EXPECT_EQ(hqf_v2::Hqf().unmarshal((place / "a.hqfz").c_str()), 0);
}

TEST(load_string, codes_of_the_root) {
    const std::string preamble = "<Hqf:Preamble>";
    const struct {
        std::string text;
        int code;
        const char* why;
    } rows[] = {
        {smallest, 0, "as written"},
        {std::string(smallest).substr(std::string(smallest).find("<Hqf:Hqf")), 0, "no declaration"},
        {replaced(smallest, "<Hqf:Hqf ", "<Hqf:Hqf xsi:schemaLocation='a b' xsi:type='x' "), 0, "xsi attributes"},
        {replaced(smallest, "<Hqf:Hqf ", "<Hqf:Hqf Comments='x' "), 39, "the root has no attributes"},
        {replaced(smallest, "//hqf.example/v2", "//hqf.example/v3"), 16, "another namespace"},
        {replaced(replaced(smallest, "<Hqf:Hqf xmlns:Hqf", "<x:Hqf xmlns:x='http://hqf.example/v2' xmlns:Hqf"),
                  "</Hqf:Hqf>", "</x:Hqf>"),
         0, "another prefix for the root"},
        {replaced(replaced(smallest, "<Hqf:Hqf xmlns:Hqf", "<x:Hqf xmlns:x='http://hqf.example/v2' xmlns:Hqf"),
                  "</Hqf:Hqf>", "</Hqf:Hqf>"),
         10, "an end tag spelled another way"},
        {"<Hqf xmlns='http://hqf.example/v1'/>", 16, "a default namespace of another URI"},
        {"<Hqf/>", 16, "no namespace"},
        {"<Hqf:Hqf/>", 16, "nobody declares the prefix"},
        {"<Hqf xmlns='http://hqf.example/v2'/>", 32, "an empty root"},
        {"", 34, "nothing"},
        {"<!-- nothing -->", 34, "nothing but a comment"},
        {replaced(smallest, "T09:00:00Z", "T09:00:00"), 22, "no time zone"},
        {replaced(smallest, "T09:00:00Z", "T09:00:00+00:00"), 0, "a zone of no offset"},
        {replaced(smallest, preamble, "<Hqf:Color/>" + preamble), 21, "Preamble isn't first"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(hqf_v2::Hqf().loadString(wide(row.text)), row.code) << row.why;
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
    EXPECT_EQ(failed.getElmxError(), 46);
    EXPECT_EQ(failed.getXmlDocument(), L"");
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

TEST(write_string, wide_text_of_any_character) {
    hqf_v2::Hqf document, again;
    fill_header(document);
    const std::wstring name = L"\xE9 \x4E2D \xD834\xDD1E < & > \" '";
    document.get_Preamble().get_Header().set_Name(name);
    const auto result = document.writeString();
    ASSERT_EQ(result.getElmxError(), 0);
    EXPECT_NE(result.getXmlDocument().find(L"<Hqf:Name>\xE9 \x4E2D \xD834\xDD1E &lt; &amp; > &quot; &apos;</Hqf:Name>"),
              std::wstring::npos);
    EXPECT_EQ(again.loadString(result.getXmlDocument()), 0);
    EXPECT_EQ(again.get_Preamble().get_Header().get_Name(), name);
}

} // namespace
