// Each of the 68 elements that can be a document of their own: read from memory, a text, a file and by constructors,
// and written back byte for byte. The documents are those of the corpus.

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <sstream>

#include "hqf/hqf.h"
#include "tests/model/corpus.h"
#include "tests/support/files.h"

namespace {

template<class model_class>
void enter(const std::string& name, const std::string& text, int code_when_new) {
    SCOPED_TRACE(name);
    const unsigned int size = static_cast<unsigned int>(text.size());
    const support::folder place;
    const std::string path = place / "a.xml", nowhere = place / "none" / "a.xml";
    model_class object;
    EXPECT_EQ(object.unmarshal(text), 0);
    std::string written;
    EXPECT_EQ(object.marshal(&written), 0);
    EXPECT_EQ(written, text);
    EXPECT_EQ(object.marshal(path.c_str()), 0);
    EXPECT_EQ(support::bytes_of(path), text);
    std::ostringstream stream;
    EXPECT_EQ(object.marshal(stream), 0);
    EXPECT_EQ(stream.str(), text);
    EXPECT_EQ(object.marshal(nowhere.c_str()), 1);

    model_class from_file, from_bytes;
    EXPECT_EQ(from_file.unmarshal(path.c_str()), 0);
    EXPECT_EQ(from_bytes.unmarshal(text.data(), size), 0);
    lmx::c_xml_reader_memory reader(text.data(), size);
    model_class from_reader;
    EXPECT_EQ(from_reader.unmarshal(reader), 0);
    lmx::elmx_error codes[] = {lmx::err_xml_badly_formed, lmx::err_xml_badly_formed, lmx::err_xml_badly_formed};
    model_class made_of_file(path.c_str(), &codes[0]), made_of_bytes(text.data(), size, &codes[1]),
        made_of_text(text, &codes[2]);
    for (const auto code : codes)
        EXPECT_EQ(code, 0);
    for (model_class* other : {&from_file, &from_bytes, &from_reader, &made_of_file, &made_of_bytes, &made_of_text})
        EXPECT_TRUE(hqf::equal(*other, object));

    // Cut before the end tag, and under a root of another name: the code, from every entry.
    const std::string cut = text.substr(0, text.rfind('<'));
    const std::string renamed = "<Hqf:Other" + text.substr(text.find("<Hqf:") + 5 + name.size());
    model_class(cut, &codes[0]);
    EXPECT_NE(codes[0], 0);
    EXPECT_NE(codes[0], lmx::err_undefined_error);
    model_class(renamed.data(), static_cast<unsigned int>(renamed.size()), &codes[1]);
    EXPECT_EQ(codes[1], 16);
    model_class(nowhere.c_str(), &codes[2]);
    EXPECT_EQ(codes[2], 1);
    EXPECT_EQ(from_file.unmarshal(nowhere.c_str()), 1);

    // What is incomplete is not written, and no file stays behind.
    model_class fresh;
    std::string out = "untouched";
    EXPECT_EQ(fresh.marshal(&out), code_when_new);
    EXPECT_EQ(out == "untouched", code_when_new != 0);
    EXPECT_EQ(fresh.marshal(path.c_str()), code_when_new);
    EXPECT_EQ(std::filesystem::exists(path), code_when_new == 0);
}

const struct {
    const char* name;
    void (*enter)(const std::string&, const std::string&, int);
    int code_when_new;
} entries[] = {
#define ENTRY(CLASS, CODE_WHEN_NEW) {#CLASS, enter<hqf_v2::CLASS>, CODE_WHEN_NEW},
#include "entries.inc"
};

TEST(entries, every_global_element) {
    ASSERT_EQ(std::size(entries), 68u);
    const std::string bytes = corpus::bytes();
    const std::vector<corpus::test_case> cases = corpus::cases(bytes);
    for (const auto& entry : entries) {
        const std::string what = entry.name + std::string(entry.name == std::string("Hqf") ? ": smallest" : ": root");
        const auto found =
            std::find_if(cases.begin(), cases.end(), [&](const auto& test) { return test.what == what; });
        ASSERT_NE(found, cases.end()) << what;
        std::string text(found->document);
        if (entry.name == std::string("Hqf")) { // a new document is stamped
            const std::string stamp = "\t\t\t<Hqf:ReadSDKInformation>\n\t\t\t\t<Hqf:SDKName>x</Hqf:SDKName>\n"
                                      "\t\t\t\t<Hqf:SDKVersion>1</Hqf:SDKVersion>\n\t\t\t</Hqf:ReadSDKInformation>\n";
            text.insert(text.find("\t\t</Hqf:Header>"), stamp);
        }
        entry.enter(entry.name, text, entry.code_when_new);
    }
}

} // namespace
