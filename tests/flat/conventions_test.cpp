// How each kind of value crosses, and where a failure ends. That objects and documents cross whole is seen where the C#
// classes are tested.

#include <new>
#include <stdexcept>

#include <gtest/gtest.h>

#include "hqf/errors/c_lmx_exception.h"
#include "hqf/flat/conventions.h"
#include "hqf/hqf.h"
#include "hqf/zip/CZipException.h"
#include "support.h"
#include "tests/support/files.h"
#include "tests/support/memory.h"

using namespace flat_test;
using support::wide;

namespace {

/// The object behind an opaque pointer.
template<class T>
T& inside(void* object) {
    return *static_cast<T*>(object);
}

const std::string archives = HQF_TEST_DATA "/archives/";

} // namespace

// Text

TEST(WideText, CrossesUnitByUnit) {
    const std::tuple<const wchar_t*, std::wstring, const char*> rows[] = {
        {L"", L"", "empty"},
        {nullptr, L"", "null is the empty string"},
        {L"z\u00FF\u0100\uFFFF", L"z\u00FF\u0100\uFFFF", "plain, and units above 0xFF"},
        {L"\xD834\xDD1E", L"\xD834\xDD1E", "a surrogate pair stays two units"},
        {L"a\xD834", L"a\xD834", "a lone high surrogate"},
        {L"\xDD1Ez", L"\xDD1Ez", "a lone low surrogate"},
        {L"\x1D11E", L"\x1D11E", "a character in one 32-bit element"},
    };
    listener ear;
    auto header = MAKE(Header);
    for (const auto& [in, out, why] : rows) {
        EXPECT_EQ(CSharp_Header_set_Creator(header, in), 0) << why;
        wchar_t* const text = CSharp_Header_get_Creator(header);
        EXPECT_EQ(SysStringLen(text), out.size()) << why;
        EXPECT_EQ(taken(text), out) << why;
    }
    EXPECT_EQ(ear.heard(), nothing());
    const std::wstring with_nul(L"a\0b", 3);
    inside<hqf_v2::Header>(header.get()).set_Creator(with_nul);
    EXPECT_EQ(taken(CSharp_Header_get_Creator(header)), with_nul);
}

TEST(NarrowText, CrossesByteByByte) {
    auto info = MAKE_VALUE(c_any_info, 0);
    for (const char* text : {"", "\xC3\xA9\xF0\x9D\x84\x9E", "\xFF no UTF-8"}) {
        CSharp_c_any_info_set_name(info, text);
        EXPECT_EQ(taken(CSharp_c_any_info_get_name(info)), text);
    }
    const std::string with_nul("a\0b", 3);
    inside<lmx::c_any_info>(info.get()).set_value(with_nul);
    EXPECT_EQ(taken(CSharp_c_any_info_get_value(info)), with_nul);
}

TEST(PlatformStrings, HaveTheirLengthInFrontAndZerosWithoutText) {
    wchar_t* const wide_zeros = SysAllocStringLen(nullptr, 3);
    EXPECT_EQ(SysStringLen(wide_zeros), 3u);
    EXPECT_EQ(taken(wide_zeros), std::wstring(3, L'\0'));
    char* const bytes = SysAllocStringByteLen("abcde", 3);
    EXPECT_EQ(SysStringByteLen(bytes), 3u);
    EXPECT_EQ(reinterpret_cast<const std::uint32_t*>(bytes)[-1], 3u) << "where the platform has it";
    EXPECT_EQ(taken(bytes), "abc");
    EXPECT_EQ(SysAllocStringLen(nullptr, 0x40000000u), nullptr) << "its length in bytes needs more than 32 bits";
    EXPECT_EQ(SysStringLen(nullptr) + SysStringByteLen(nullptr), 0u);
    SysFreeString(nullptr);
}

// Numbers

TEST(Numbers, CrossByTheirKind) {
    auto averaging = MAKE(Averaging);
    for (const auto& [in, out] : {std::pair{0, 0}, {2, 1}, {-1, 1}, {0x100, 1}}) {
        EXPECT_EQ(CSharp_Averaging_set_Averaging(averaging, in), 0);
        EXPECT_EQ(CSharp_Averaging_get_Averaging(averaging), out) << "anything but 0 is true: " << in;
    }
    for (const auto& [in, code, out] :
         {std::tuple{2u, 0, 2u}, {100u, 36, 2u}, {1u, 37, 2u}, {0x163u, 0, 99u}, {0xFFFFFF00u, 37, 99u}}) {
        EXPECT_EQ(CSharp_Averaging_set_AveragingValue(averaging, in), code) << in;
        EXPECT_EQ(CSharp_Averaging_get_AveragingValue(averaging), out) << "the low 8 bits count: " << in;
    }
    auto lab = MAKE(ColorSpaceCIELabType);
    for (const auto& [in, code, out] : {std::tuple{37.5, 0, 37.5}, {150.5, 36, 37.5}, {-1.0, 37, 37.5}}) {
        EXPECT_EQ(CSharp_ColorSpaceCIELabType_set_L(lab, in), code) << "codes come as they are: " << in;
        EXPECT_EQ(CSharp_ColorSpaceCIELabType_get_L(lab), out) << in;
    }
    auto light = MAKE(IlluminationOptionsType);
    EXPECT_EQ(CSharp_IlluminationOptionsType_set_ColorTemperature(light, 0x80000000u), 36);
    EXPECT_EQ(CSharp_IlluminationOptionsType_getchosen(light), hqf_IlluminationOptionsType_chosen_ColorTemperature);
}

// Identities

TEST(Identities, AreSharedComparedAsPointersAndReplaced) {
    auto spot = MAKE(SampleSpot);
    const char* const first = CSharp_SampleSpotType_id_get();
    EXPECT_STREQ(first, "SampleSpotType");
    EXPECT_EQ(CSharp_SampleSpot_getid(spot), first);
    const std::string same_text = first;
    EXPECT_EQ(CSharp_SampleSpot_has_id(spot, first), 1);
    EXPECT_EQ(CSharp_SampleSpot_has_id(spot, CSharp_SampleType_id_get()), 1) << "of its base";
    EXPECT_EQ(CSharp_SampleSpot_has_id(spot, CSharp_SampleTargetType_id_get()), 0);
    EXPECT_EQ(CSharp_SampleSpot_has_id(spot, same_text.c_str()), 0) << "another pointer to the same text";

    CSharp_SampleSpotType_id_set(same_text.c_str());
    const char* const second = CSharp_SampleSpotType_id_get();
    EXPECT_STREQ(second, "SampleSpotType");
    EXPECT_NE(second, same_text.c_str()) << "a copy of its own";
    EXPECT_EQ(CSharp_SampleSpot_has_id(spot, first), 0) << "given out before";
    EXPECT_EQ(CSharp_SampleSpot_has_id(spot, second), 1);
    listener ear;
    CSharp_SampleSpotType_id_set(nullptr);
    EXPECT_EQ(CSharp_SampleSpot_getid(spot), nullptr);
    EXPECT_EQ(ear.heard(), nothing()) << "null is allowed here";
    hqf_v2::SampleSpotType::id = first;
}

// Documents

TEST(Documents, DamagedGive1000AndAnExceptionItsText) {
    listener ear;
    auto document = MAKE(Hqf);
    for (const auto& [file, raises] : {std::pair{"archive-wrong-crc", false}, // turned into a code by the load itself
                                       {"archive-cut", true},
                                       {"archive-encrypted", true},
                                       {"no such archive", true}}) {
        EXPECT_EQ(CSharp_Hqf_loadFile(document, wide(archives + file + ".hqfz").c_str()), 1000) << file;
        EXPECT_EQ(ear.heard(), raises ? raised(CZipException(118).what()) : nothing()) << file;
    }
    EXPECT_EQ(CSharp_Hqf_loadFile(document, wide(archives + "rendition-chart.hqfz").c_str()), 0) << "usable as before";
}

// Failures

TEST(Exceptions, EndAtTheExport) {
    using hqf::flat::call;
    listener ear;
    EXPECT_EQ(call(+[]() -> lmx::elmx_error { throw CZipException(102); }), 1000);
    EXPECT_EQ(call(+[]() -> lmx::elmx_error { throw std::out_of_range("far"); }), 42);
    EXPECT_EQ(call(+[]() -> lmx::elmx_error { throw lmx::c_lmx_exception(lmx::err_no_error); }), 42) << "never 0";
    const calls told = ear.heard();
    EXPECT_EQ(told, (calls{raised(CZipException(102).what())[0], raised("far")[0], raised("No Error")[0]}));
    EXPECT_EQ(call(+[]() -> lmx::elmx_error { throw 7; }), 42) << "an exception without a text";
    EXPECT_EQ(call(+[]() -> bool { throw std::out_of_range("far"); }), 0);
    EXPECT_EQ(call(+[]() -> double { throw std::out_of_range("far"); }), 0.0);
    EXPECT_EQ(call(+[]() -> const std::wstring& { throw std::out_of_range("far"); }), nullptr);
    call(+[]() -> void { throw std::out_of_range("far"); });
    EXPECT_EQ(ear.heard().size(), 5u);
    SWIGRegisterExceptionArgumentCallbacks_HqfModule(
        nullptr,
        [](const char*, const char*) {
            messages.push_back({"the last registered", 1, ""});
        },
        nullptr);
    CSharp_length(nullptr);
    EXPECT_EQ(ear.heard(), (calls{{"the last registered", 1, ""}}));
}

TEST(Exceptions, OfMemoryEndAtTheExport) {
    if (!support::counts_memory()) GTEST_SKIP() << "another allocator stands before ours";
    listener ear;
    auto header = MAKE(Header);
    const std::wstring text(1000, L'x');
    CSharp_Header_set_Creator(header, L"before");
    support::memory_is_out = true;
    EXPECT_EQ(CSharp_Header_set_Creator(header, text.c_str()), 42);
    EXPECT_EQ(ear.heard(), raised("std::bad_alloc"));
    support::memory_is_out = true;
    EXPECT_EQ(CSharp_new_c_decimal__SWIG_0(), nullptr);
    EXPECT_EQ(ear.heard(), raised("std::bad_alloc"));
    EXPECT_EQ(taken(CSharp_Header_get_Creator(header)), L"before");
    EXPECT_EQ(CSharp_Header_set_Creator(header, text.c_str()), 0) << "usable as before";
}

TEST(Exceptions, WithoutCallbacksGiveTheSameResults) {
    EXPECT_EQ(hqf::flat::call(+[]() -> lmx::elmx_error { throw std::bad_alloc(); }), 42);
    EXPECT_EQ(CSharp_stringncompare("abc", "c", 4, 1), 0) << "the position lies behind the text";
    auto document = MAKE(Hqf);
    EXPECT_EQ(CSharp_Hqf_loadFile(document, L"no such archive.hqfz"), 1000);
}

// What we add

TEST(Additions, EndBehindTheLast) {
    listener ear;
    auto revision = MAKE(Revision);
    CSharp_Revision_append_any(revision, "<a/>");
    for (auto* part : {hqf_Revision_any_namespace, hqf_Revision_any_name, hqf_Revision_any_value}) {
        EXPECT_EQ(part(revision, 1), nullptr);
        EXPECT_EQ(ear.heard(), raised("index of a wildcard entry"));
    }
    const unsigned char bytes[] = {1, 0, 255};
    unsigned char copy[5] = {9, 9, 9, 9, 9};
    const auto value = MAKE_VALUE(c_binary, 2, bytes, 3);
    EXPECT_TRUE(hqf_c_binary_get(value, copy, 2) == 2 && copy[2] == 9) << "no more than asked";
    EXPECT_TRUE(hqf_c_binary_get(value, copy, 5) == 3 && copy[3] == 9) << "no more than there is";
}
