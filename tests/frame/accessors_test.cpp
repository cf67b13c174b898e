// What the accessors of every class do, shown on one class of each shape. Setters of checked values have their own test
// of every class, in tests/model.

#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "hqf/hqf.h"
#include "hqf/xml_in/c_xml_reader_local.h"

namespace {

using namespace hqf_v2;

/// A text that is no literal stays one that only a handler can bring in, and is carried along like any other.
TEST(accessors, a_text_beside_the_literals_is_kept) {
    class lenient : public lmx::c_xml_reader_memory {
    public:
        using c_xml_reader_memory::c_xml_reader_memory;
        lmx::elmx_error user_handle_error(lmx::elmx_error, const std::string&, const char*, int) override {
            return lmx::err_no_error;
        }
    };
    ColorSpaceSRGB made;
    made.append_ChangeHistory("2024-01-01T00:00:00Z");
    made.get_ColorSpaceSpecificationSpectrumTristimulus().setnil_ColorSpaceSpecificationSpectrumTristimulus();
    made.set_Red(0), made.set_Green(0), made.set_Blue(0);
    made.set_ColorDepth(L"ColorDepth_8");
    std::string text;
    ASSERT_EQ(made.marshal(&text), 0);
    text.replace(text.find("ColorDepth_8"), 12, "Depth &lt;3");
    lenient reader(text.data(), static_cast<unsigned int>(text.size()));
    ColorSpaceSRGB odd;
    ASSERT_EQ(odd.unmarshal(reader), 0);
    EXPECT_EQ(odd.get_ColorDepth(), L"Depth <3");
    EXPECT_EQ(odd.getenum_ColorDepth(), 0);
    ColorSpaceSRGB copy(odd);
    EXPECT_TRUE(hqf::equal(copy, odd));
    EXPECT_FALSE(hqf::equal(copy, made));
    std::string again;
    EXPECT_EQ(copy.marshal(&again), 0);
    EXPECT_EQ(again, text);
    copy.set_ColorDepth(L"ColorDepth_8");
    EXPECT_FALSE(hqf::equal(copy, odd)) << "a literal beside another text";
    EXPECT_EQ(odd.get_ColorDepth(), L"Depth <3") << "the copy is deep";
}

TEST(accessors, optional_and_defaulted_members) {
    ColorSpaceRGBType rgb;
    rgb.set_Alpha(0.5);
    rgb.unset_Alpha();
    EXPECT_FALSE(rgb.isset_Alpha());
    EXPECT_EQ(rgb.get_Alpha(), 0.5) << "the value stays";
    EXPECT_EQ(rgb.set_Alpha(1.5), 36);
    EXPECT_FALSE(rgb.isset_Alpha()) << "what is refused is not set";
    EXPECT_EQ(ToleranceType().getenum_PrimaryIlluminant(), 0) << "nothing stored is no literal";

    FloatingPointValueType axis;
    EXPECT_EQ(axis.get_AxisNominalScale(), L"Scale_Linear");
    EXPECT_FALSE(axis.isset_AxisNominalScale());
    axis.set_AxisNominalScale(L"Scale_Log");
    EXPECT_TRUE(axis.isset_AxisNominalScale());
    axis.unset_AxisNominalScale();
    EXPECT_EQ(axis.getenum_AxisNominalScale(), FloatingPointValueType::e_Scale_Linear);

    Preamble preamble;
    std::as_const(preamble).get_Owner();
    EXPECT_FALSE(preamble.isset_Owner());
    preamble.get_Owner();
    EXPECT_TRUE(preamble.isset_Owner()) << "looking through the form that can write is enough";
}

TEST(accessors, lists) {
    OwnerType owner;
    owner.append_Company(L"a");
    owner.append_Company(L"b");
    owner.set_Company(5, L"c");
    owner.insert_Company(10, L"d");
    owner.insert_Company(0, L"z");
    owner.set_Company(1, L"A");
    owner.delete_Company(2);
    std::wstring all;
    for (unsigned int i = 0; i < owner.size_Company(); ++i)
        all += owner.get_Company(i);
    EXPECT_EQ(all, L"zAcd");

    Person* const fourth = &owner.get_Person(3);
    EXPECT_EQ(owner.size_Person(), 4u) << "default objects fill the list up";
    EXPECT_EQ(fourth, &owner.back_Person());
    owner.back_Person().set_Name(L"last");
    Person* const last = &owner.back_Person();
    owner.insert_Person(10);
    EXPECT_EQ(owner.size_Person(), 5u);
    EXPECT_EQ(&owner.get_Person(3), last) << "children keep their place while the list grows";
    owner.insert_Person(0);
    owner.delete_Person(0);
    EXPECT_EQ(owner.get_Person(3).get_Name(), L"last");
    Person other;
    other.set_Name(L"other");
    EXPECT_EQ(owner.assign_Person(7, other).get_Name(), L"other");
    EXPECT_EQ(owner.size_Person(), 8u);
    owner.clear_Person();
    EXPECT_EQ(owner.size_Person(), 0u);

    Revision revision;
    revision.append_any("<b/>");
    revision.insert_any(0, "<a/>");
    std::string ns = "?";
    std::string name = "?";
    std::string value;
    revision.get_any(0, &ns, &name, &value);
    EXPECT_EQ(ns + name + value, "<a/>");
    revision.get_any(1, nullptr, nullptr, &value);
    EXPECT_EQ(value, "<b/>");
}

TEST(accessors, choices) {
    GeometryChoiceType geometry;
    EXPECT_EQ(geometry.getchosen(), GeometryChoiceType::chosen_none);
    EXPECT_FALSE(geometry.is_occurs_ok());
    geometry.set_Angle(45);
    EXPECT_EQ(geometry.set_SphereGeometry(L"sphere"), 38);
    EXPECT_EQ(geometry.getchosen(), 0) << "the option is chosen before the value is checked";
    EXPECT_TRUE(geometry.get_SphereGeometry().empty());
    EXPECT_EQ(geometry.get_Angle(), 0) << "what was held is gone";
    EXPECT_EQ(geometry.set_SphereGeometry(L"Sphere_Included"), 0);
    EXPECT_EQ(geometry.set_SphereGeometry(L"sphere"), 38);
    EXPECT_EQ(geometry.get_SphereGeometry(), L"Sphere_Included");
    EXPECT_EQ(geometry.set_UnknownGeometry(geometry.get_SphereGeometry()), 0) << "the argument is what is given up";
    EXPECT_EQ(geometry.get_UnknownGeometry(), L"Sphere_Included");
    EXPECT_EQ(geometry.set_UnknownGeometry(L""), 20);
    EXPECT_EQ(geometry.getchosen(), 2);

    AxisValueChoice axis;
    axis.get_AxisFloatingPointValue().set_FloatingPointValueType(7);
    const AxisValueChoice copy(axis);
    axis.set_AxisStringValue(L"x");
    EXPECT_EQ(copy.get_AxisFloatingPointValue().get_FloatingPointValueType(), 7);
    EXPECT_EQ(axis.getchosen(), 1);
}

TEST(accessors, groups) {
    sg_Sample sample;
    EXPECT_EQ(sample.getchosen(), 3);
    sample.get_SampleSpot().get_Specification().set_SampleWidth(2);
    auto copy = std::make_unique<sg_Sample>(sample);
    sample.get_SampleTarget();
    EXPECT_EQ(sample.getchosen(), sg_Sample::chosen_SampleTarget);
    sample = *copy;
    copy.reset();
    EXPECT_EQ(std::as_const(sample).get_SampleSpot().get_Specification().get_SampleWidth(), 2);

    sg_Function function;
    auto* const de94 = new FunctionDE94Type;
    for (const auto set :
         {&FunctionDE94Type::set_Param_l, &FunctionDE94Type::set_Param_c, &FunctionDE94Type::set_Param_h})
        (de94->*set)(1);
    EXPECT_EQ(&function.assign_Function(de94), de94);
    EXPECT_EQ(function.getchosen(), 0);
    const sg_Function second(function);
    EXPECT_STREQ(second.get_Function().getid(), "FunctionDE94Type") << "a copy is of the object's own class";
    EXPECT_TRUE(hqf::equal(function, second));
    de94->set_Param_l(2);
    EXPECT_FALSE(hqf::equal(function, second));
    EXPECT_EQ(&function.assign_Function(de94), de94) << "what is held already stays";
    EXPECT_EQ(function.assign_FunctionDE94(*de94).get_Param_l(), 2) << "the source is what is given up";
    function.assign_Function(static_cast<FunctionType*>(nullptr));
    EXPECT_EQ(function.getchosen(), 0);
    EXPECT_FALSE(hqf::equal(function, second));
}

struct open_platform : PlatformType {
    using PlatformType::unmarshal_body;
};

struct open_lab : ColorSpaceCIELabType {
    using ColorSpaceCIELabType::marshal_child_elements;
};

// A reader that stands behind the first name of a text.
struct started : lmx::c_read_string, lmx::c_xml_reader {
    explicit started(const std::string& text)
        : c_read_string(text)
        , c_xml_reader(static_cast<c_read&>(*this))
        , scope((set_ns_map(map), this)) {
        next();
    }
    void next() { get_element_event(nullptr, &error, &name); }

    static constexpr lmx::s_ns_map map[] = {{1000, "Hqf", "http://hqf.example/v2"}, {0, nullptr, nullptr}};
    lmx::c_xml_reader_local scope;
    lmx::elmx_error error = lmx::err_no_error;
    std::string name;
};

TEST(accessors, parts_of_reading_and_writing) {
    const std::string format = " xmlns:Hqf='http://hqf.example/v2' "
                               "xmlns:xsi='http://www.w3.org/2001/XMLSchema-instance'";
    const std::string options =
        "<Hqf:I" + format + "><Hqf:Illuminant CustomName='n'>Illuminant_A</Hqf:Illuminant></Hqf:I>";
    IlluminationOptionsType choice;
    for (int round = 0; round < 2; ++round) {
        started reader(options);
        EXPECT_EQ(choice.unmarshal(reader, reader.name), 0) << "the option that is read is a new one";
    }
    const std::string systems = "<Hqf:OperatingSystem>a</Hqf:OperatingSystem><Hqf:OperatingSystemVersion>b"
                                "</Hqf:OperatingSystemVersion>";
    const std::string text = "<Hqf:P" + format + ">" + systems + "</Hqf:P>";
    started reader(text);
    while (reader.get_attribute_event(nullptr, &reader.error, &reader.name))
        reader.skip_attribute_value();
    const lmx::c_xml_reader_local inner(&reader);
    reader.next();
    open_platform platform;
    EXPECT_TRUE(platform.unmarshal_body(reader, &reader.name, &reader.error)) << "with a name of the caller's";
    EXPECT_EQ(platform.get_OperatingSystemVersion(), L"b");
    EXPECT_EQ(reader.name, "Hqf:P");
    const std::string type = "<xsi:type" + format + "/><x/>";
    started at_type(type);
    const int event = at_type.get_current_event();
    EXPECT_FALSE(sg_ColorSpace::is_member(at_type, at_type.name)) << "an element with an attribute's name";
    EXPECT_EQ(at_type.get_current_event(), event);
    sg_ColorSpace group;
    EXPECT_TRUE(group.unmarshal(at_type, &at_type.name, &at_type.error)) << at_type.error;
    std::ostringstream stream;
    lmx::c_xml_writer writer(stream, "", "");
    EXPECT_EQ(ColorSpaceCIELab().marshal(writer, "c"), 46);
    EXPECT_STREQ(writer.get_namespace_prefix("http://hqf.example/v2"), "Hqf") << "known before the refusal";
    EXPECT_EQ(open_lab().marshal_child_elements(writer), 46) << "a child that nobody touched is an incomplete one";
}

TEST(accessors, copies_count_as_set) {
    const Header empty;
    const Header copy(empty);
    EXPECT_FALSE(copy.is_occurs_ok()) << "the list still lacks its minimum";
    const DeviceType device{DeviceType()};
    EXPECT_FALSE(device.is_occurs_ok()) << "no copy is made of a temporary";
    const DeviceType source;
    EXPECT_TRUE(DeviceType(source).is_occurs_ok());
    EXPECT_FALSE(DeviceType(source).isset_DeviceClass());

    DeviceFilter filter;
    filter.set_DeviceFilterType(L"Filter_None");
    filter.set_CustomOrPartial(L"x");
    filter.setnil_DeviceFilter();
    const DeviceFilter nil(filter);
    EXPECT_TRUE(nil.isnil_DeviceFilter());
    EXPECT_FALSE(nil.isset_CustomOrPartial()) << "of a nil object nothing else is taken";
    EXPECT_TRUE(nil.get_DeviceFilterType().empty());
    filter.set_DeviceFilterType(L"Filter_UVD65");
    EXPECT_TRUE(filter.isnil_DeviceFilter()) << "the base's setter knows no flag";

    Hqf unstamped;
    unstamped.get_Preamble().get_Header().unset_ReadSDKInformation();
    EXPECT_FALSE(Hqf(unstamped).get_Preamble().get_Header().isset_ReadSDKInformation())
        << "a copy has no stamp of its own";

    SDKVersion version;
    version.setnil_SDKVersion();
    EXPECT_TRUE(version.is_occurs_ok());
    version.set_SDKVersion(L"2");
    EXPECT_FALSE(version.isnil_SDKVersion());
}

TEST(accessors, swap_reset_and_equality) {
    ColorType made;
    made.set_ColorName(L"a");
    made.append_ColorSpace();
    made.back_ColorSpace().get_ColorSpaceCIELab().set_L(1);
    made.get_Substrate().get_SubstratePaper().get_Color().set_ColorName(L"paper");
    ColorType a(made);
    ColorType b(a);
    EXPECT_FALSE(hqf::equal(made, a)) << "in a copy what is mandatory counts as set";
    EXPECT_TRUE(hqf::equal(a, b));
    b.get_Substrate().get_SubstratePaper().get_Color().set_ColorName(L"metal");
    EXPECT_FALSE(hqf::equal(a, b)) << "a difference three objects down";
    b = a;
    b.back_ColorSpace().get_ColorSpaceCIELab().set_A(-0.0);
    a.back_ColorSpace().get_ColorSpaceCIELab().set_A(0.0);
    EXPECT_FALSE(hqf::equal(a, b)) << "the sign of zero";
    ColorType c;
    c.swap(a);
    EXPECT_EQ(c.get_ColorName(), L"a");
    EXPECT_TRUE(hqf::equal(a, ColorType()));
    c.reset();
    EXPECT_TRUE(hqf::equal(c, a));
}

/// Distinct documents need no lock, and several threads may look at one, at children that are made for it too.
TEST(accessors, threads) {
    std::string text;
    Hqf shared;
    auto& header = shared.get_Preamble().get_Header();
    header.set_Creator(L"c");
    header.set_CreatorVersion(L"1");
    header.set_Purpose(L"p");
    header.append_ChangeHistory("2024-01-01T00:00:00Z");
    ASSERT_EQ(shared.marshal(&text), 0);
    std::vector<const void*> seen(4);
    std::vector<std::thread> threads;
    for (const void*& mine : seen)
        threads.emplace_back([&text, &mine, &looked_at = std::as_const(shared)] {
            for (int round = 0; round < 50; ++round) {
                Hqf own;
                std::string again;
                if (own.unmarshal(text) == 0 && own.marshal(&again) == 0 && again == text && hqf::equal(own, looked_at))
                    mine = &looked_at.get_Preamble().get_Owner();
            }
        });
    for (std::thread& thread : threads)
        thread.join();
    for (const void* const address : seen)
        EXPECT_EQ(address, &std::as_const(shared).get_Preamble().get_Owner()) << "all saw the one child";
}

/// A class of the application that asks the pieces of its base.
class my_colour : public ColorType {
public:
    using ColorType::marshal_attributes;
    using ColorType::marshal_child_elements;
};

TEST(accessors, pieces_for_derived_classes) {
    my_colour colour;
    colour.set_ColorName(L"<x>");
    colour.append_ChangeHistory("2024-01-01T00:00:00Z");
    std::ostringstream stream;
    lmx::c_xml_writer writer(stream, "\t", "\n");
    colour.marshal_attributes(writer);
    EXPECT_EQ(colour.marshal_child_elements(writer), 0);
    EXPECT_EQ(stream.str(), " ColorName=\"&lt;x>\"<Hqf:ChangeHistory>2024-01-01T00:00:00Z</Hqf:ChangeHistory>\n");
}

} // namespace
