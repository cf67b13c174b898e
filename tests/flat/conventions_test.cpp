// How each kind of value crosses, who owns what comes out, and where a failure ends.

#include <algorithm>
#include <climits>
#include <new>
#include <span>
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

own<hqf_XMLDocumentResult> owned(hqf_XMLDocumentResult* result) {
    return {result, CSharp_delete_XMLDocumentResult};
}

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

TEST(Enumerations, TakeNumbersOfLiteralsAlone) {
    auto value = MAKE(FloatingPointValueType);
    for (const auto& [number, result, stored] :
         {std::tuple{2, 1, 2}, {0, 0, 2}, {4, 0, 2}, {INT_MIN, 0, 2}, {3, 1, 3}}) {
        EXPECT_EQ(CSharp_FloatingPointValueType_setenum_AxisNominalScale(value, number), result) << number;
        EXPECT_EQ(CSharp_FloatingPointValueType_getenum_AxisNominalScale(value), stored) << number;
    }
    EXPECT_EQ(taken(CSharp_FloatingPointValueType_get_AxisNominalScale(value)), L"Scale_Other");
    CSharp_FloatingPointValueType_unset_AxisNominalScale(value);
    EXPECT_EQ(CSharp_FloatingPointValueType_getenum_AxisNominalScale(value), hqf_FloatingPointValueType_e_Scale_Linear);
    EXPECT_EQ(CSharp_FloatingPointValueType_set_AxisNominalScale(value, nullptr), 38) << "null is the empty text";
}

// Objects

TEST(Objects, LieInTheirParents) {
    auto color = MAKE(ColorType);
    hqf_v2::ColorType& behind = inside<hqf_v2::ColorType>(color.get());
    hqf_sg_ColorSpace* const third = CSharp_ColorType_get_ColorSpace__SWIG_0(color, 2);
    EXPECT_EQ(CSharp_ColorType_size_ColorSpace(color), 3u) << "the form that is not const fills the list";
    EXPECT_EQ(static_cast<void*>(third), &behind.get_ColorSpace(2));
    EXPECT_EQ(CSharp_ColorType_back_ColorSpace(color), third);
    CSharp_ColorType_delete_ColorSpace(color, 1);
    EXPECT_EQ(CSharp_ColorType_get_ColorSpace__SWIG_0(color, 1), third);
    auto owner = MAKE(OwnerType);
    CSharp_OwnerType_append_Company(owner, L"Paint & Co.");
    hqf_OwnerType* const held = CSharp_ColorType_assign_Owner(color, owner);
    EXPECT_EQ(CSharp_ColorType_isset_Owner(color), 1);
    EXPECT_EQ(static_cast<void*>(held), &behind.get_Owner());
    EXPECT_EQ(taken(CSharp_OwnerType_get_Company(held, 0)), L"Paint & Co.");

    auto when = MAKE_VALUE(c_datetime, 1, "2025-01-31T12:00:00Z");
    EXPECT_EQ(CSharp_ColorType_append_ChangeHistory(color, when), 0);
    CSharp_c_datetime_set_year(when, 1999);
    lmx_c_datetime* const entry = CSharp_ColorType_get_ChangeHistory(color, 0);
    EXPECT_EQ(static_cast<const void*>(entry), &behind.get_ChangeHistory(0));
    EXPECT_EQ(CSharp_c_datetime_get_year(entry), 2025) << "a copy was stored";
}

TEST(Objects, OfACallerAreCopiesOrMadeAnew) {
    auto lab = MAKE(ColorSpaceCIELab);
    hqf_ColorSpaceCIELabType* const type = CSharp_ColorSpaceCIELabUpcast(lab);
    EXPECT_EQ(static_cast<void*>(type), static_cast<void*>(lab.get()));
    CSharp_ColorSpaceCIELabType_set_L(type, 50);
    auto copy = own<hqf_ColorSpaceCIELabType>(CSharp_ColorSpaceCIELab_clone(lab), CSharp_delete_ColorSpaceCIELabType);
    CSharp_ColorSpaceCIELabType_set_L(type, 60);
    EXPECT_EQ(CSharp_ColorSpaceCIELabType_get_L(copy), 50);

    auto other = MAKE(ColorSpaceCIELab);
    CSharp_ColorSpaceCIELab_swap(lab, other);
    EXPECT_EQ(CSharp_ColorSpaceCIELabType_get_L(CSharp_ColorSpaceCIELabUpcast(other)), 60);
    CSharp_ColorSpaceCIELab_reset(other);
    EXPECT_EQ(CSharp_ColorSpaceCIELab_is_occurs_ok(other), 0);
    for (const auto& [id, class_name, makes] : {std::tuple{1000, "ColorSpaceCIELabType", true},
                                                {1000, "ColorSpaceType", false},
                                                {5, "ColorSpaceCIELabType", false}}) {
        auto made =
            own<hqf_ColorSpaceType>(CSharp_ColorSpaceType_factory(id, class_name), CSharp_delete_ColorSpaceType);
        EXPECT_EQ(made != nullptr && CSharp_ColorSpaceType_getid(made) == CSharp_ColorSpaceCIELabType_id_get(), makes)
            << id << ' ' << class_name;
    }
}

TEST(Objects, OfTheFunctionGroupAreCopiedOrTakenOver) {
    auto group = MAKE(sg_Function);
    EXPECT_EQ(CSharp_sg_Function_getchosen(group), hqf_sg_Function_chosen_none);
    hqf_FunctionDE94Type* const made = CSharp_new_FunctionDE94Type__SWIG_0();
    hqf_FunctionType* const base = CSharp_FunctionDE94TypeUpcast(made);
    EXPECT_EQ(CSharp_sg_Function_assign_Function__SWIG_1(group, base), base) << "the object itself, now the group's";
    EXPECT_EQ(CSharp_sg_Function_getchosen(group), hqf_sg_Function_chosen_Function);
    auto plain = MAKE(FunctionType);
    EXPECT_EQ(CSharp_sg_Function_assign_Function__SWIG_0(group, plain), CSharp_sg_Function_get_Function__SWIG_0(group));
    EXPECT_NE(CSharp_sg_Function_get_Function__SWIG_0(group), plain.get());
}

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

TEST(Documents, ForwardToTheirOperations) {
    CSharp_delete_Hqf(nullptr);
    CSharp_delete_XMLDocumentResult(nullptr);
    auto document = MAKE(Hqf);
    EXPECT_EQ(CSharp_Hqf_loadFile(document, nullptr), 1) << "no file has an empty name";
    EXPECT_EQ(CSharp_Hqf_writeFile(document, nullptr), 1001) << "nor the suffix of a document";
    EXPECT_EQ(CSharp_Hqf_loadString(document, nullptr), CSharp_Hqf_loadString(document, L""));
    auto unwritten = owned(CSharp_Hqf_writeString(document));
    EXPECT_EQ(CSharp_XMLDocumentResult_getElmxError(unwritten), 46);
    auto made = owned(CSharp_new_XMLDocumentResult(nullptr, 12));
    EXPECT_EQ(CSharp_XMLDocumentResult_getElmxError(made), 12);
    EXPECT_EQ(taken(CSharp_XMLDocumentResult_getXmlDocument(made)), L"");

    const support::folder place;
    const std::string path = place / "document";
    EXPECT_EQ(CSharp_Hqf_loadFile(document, wide(archives + "rendition-chart.hqfz").c_str()), 0);
    for (const char* suffix : {".hqfz", ".hqf"}) { // packing takes the plain file
        EXPECT_EQ(CSharp_Hqf_writeFile(document, wide(path + suffix).c_str()), 0) << suffix;
        auto again = MAKE(Hqf);
        EXPECT_EQ(CSharp_Hqf_loadFile(again, wide(path + suffix).c_str()), 0) << suffix;
        EXPECT_EQ(hqf_Hqf_equal(document, again), 1) << suffix;
        CSharp_Hqf_append_Color(again);
        EXPECT_EQ(hqf_Hqf_equal(document, again), 0) << suffix;
    }
    // By narrow path and from memory: the forms of every global element.
    auto by_path = MAKE(Hqf);
    EXPECT_EQ(CSharp_Hqf_unmarshal__SWIG_0(by_path, (path + ".hqf").c_str()), 0);
    EXPECT_EQ(CSharp_Hqf_marshal__SWIG_0(by_path, (path + ".copy").c_str()), 0);
    const std::string bytes = support::bytes_of(path + ".copy");
    auto from_memory = MAKE(Hqf);
    EXPECT_EQ(CSharp_Hqf_unmarshal__SWIG_1(from_memory, bytes.data(), static_cast<std::uint32_t>(bytes.size())), 0);
    EXPECT_EQ(hqf_Hqf_equal(by_path, from_memory), 1);
    EXPECT_NE(CSharp_Hqf_unmarshal__SWIG_1(from_memory, bytes.data(), 0), 0) << "the size counts";
}

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

TEST(Additions, GiveTheEntriesOfAWildcard) {
    listener ear;
    auto revision = MAKE(Revision);
    EXPECT_EQ(CSharp_Revision_append_any(revision, "<a:b xmlns:a='u'>\xC3\xA9</a:b>"), 0);
    EXPECT_EQ(CSharp_Revision_insert_any(revision, 0, "<first/>"), 0);
    EXPECT_EQ(CSharp_Revision_size_any(revision), 2u);
    EXPECT_EQ(taken(hqf_Revision_any_value(revision, 0)), "<first/>");
    EXPECT_EQ(taken(hqf_Revision_any_value(revision, 1)), "<a:b xmlns:a='u'>\xC3\xA9</a:b>");
    EXPECT_EQ(taken(hqf_Revision_any_name(revision, 1)), "") << "the caller's entries have none";
    CSharp_Revision_get_any(revision, 99, "ns", "name", "value");
    EXPECT_EQ(ear.heard(), nothing());
    for (auto* part : {hqf_Revision_any_namespace, hqf_Revision_any_name, hqf_Revision_any_value}) {
        EXPECT_EQ(part(revision, 2), nullptr);
        EXPECT_EQ(ear.heard().size(), 1u);
    }
    auto document = MAKE(Hqf);
    EXPECT_EQ(CSharp_Hqf_unmarshal__SWIG_0(document, HQF_TEST_DATA "/documents/everything.hqf"), 0);
    hqf_Revision* const read = CSharp_Header_get_Revision__SWIG_0(
        CSharp_Preamble_get_Header__SWIG_0(CSharp_Hqf_get_Preamble__SWIG_0(document)), 0);
    EXPECT_EQ(taken(hqf_Revision_any_namespace(read, 0)), "urn:example:note");
    EXPECT_EQ(taken(hqf_Revision_any_name(read, 0)), "note");
}

TEST(Additions, GiveTheBytesOfAProfile) {
    const unsigned char bytes[] = {1, 0, 255};
    auto value = own<lmx_c_binary>(CSharp_new_c_binary__SWIG_2(bytes, 3), CSharp_delete_c_binary);
    auto profile = MAKE(ProfileFile);
    EXPECT_EQ(CSharp_ProfileFile_set_ProfileFile(profile, value), 0);
    lmx_c_binary* const held = CSharp_ProfileFile_get_ProfileFile(profile);
    unsigned char copy[5] = {9, 9, 9, 9, 9};
    EXPECT_EQ(hqf_c_binary_get(held, copy, 2), 2u);
    EXPECT_EQ(copy[2], 9) << "no more than asked";
    EXPECT_EQ(hqf_c_binary_get(held, copy, 5), 3u);
    EXPECT_TRUE(std::ranges::equal(bytes, std::span(copy, 3)));
    EXPECT_EQ(copy[3], 9) << "no more than there is";
    EXPECT_EQ(hqf_c_binary_get(held, nullptr, 0), 0u);
}
