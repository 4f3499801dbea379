#include <gtest/gtest.h>

#include <cstdio>
#include <string>
#include <vector>

#include "embedded/load/TTextPool.h"
#include "embedded/value/TValueAccess.h"
#include "tests/embedded/cimxml/TLoading.h"
#include "tests/support/HeapInUse.h"

namespace NORVZEL20 {
namespace {

/// A document of packages of 13 properties: two keys, a class name and a vendor that repeat, three longer texts, six numbers.
std::string Packages(int count)
{
    const std::vector<std::string> texts = {"Name", "Version", "Vendor", "Description", "Path", "Checksum"};
    std::string contents = "<VALUE.OBJECT><CLASS NAME=\"Package\">";
    const std::string key = "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
    contents += "<PROPERTY NAME=\"CreationClassName\" TYPE=\"string\">" + key + "</PROPERTY>";
    for (const std::string& name : texts) {
        contents += "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\">" + (name == "Name" ? key : "") + "</PROPERTY>";
    }
    for (int number = 0; number < 6; ++number) {
        contents += "<PROPERTY NAME=\"Number" + std::to_string(number) + "\" TYPE=\"uint32\"/>";
    }
    contents += "</CLASS></VALUE.OBJECT>\n";
    for (int number = 0; number < count; ++number) {
        const std::string digits = std::to_string(100000 + number);
        contents += "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Package\">";
        contents += TLoading::Property("CreationClassName", "string", "LINUX_SoftwarePackage");
        contents += TLoading::Property("Name", "string", "package-00" + digits);
        contents += TLoading::Property("Version", "string", "1.2." + digits);
        contents += TLoading::Property("Vendor", "string", "Vendor " + std::to_string(number % 200) + " Incorporated");
        contents += TLoading::Property("Description", "string",
                                       "a description of about seventy characters, which is that of package " + digits);
        contents += TLoading::Property("Path", "string", "/usr/lib/packages/" + digits + "/module-0001.so");
        contents += TLoading::Property("Checksum", "string", "0123456789abcdef0123456789abcdef01" + digits);
        for (int property = 0; property < 6; ++property) {
            contents += TLoading::Property("Number" + std::to_string(property), "uint32", digits);
        }
        contents += "</INSTANCE></VALUE.OBJECT>\n";
    }
    return TLoading::Group(contents);
}

TEST(LoadedMemory, AnInstanceOfThirteenPropertiesTakesAtMostSixHundredAndEightyBytes)
{
    constexpr int kCount = 20000;
    const std::string document = Packages(kCount);
    TLoading loading;
    const std::size_t before = HeapInUse();
    EXPECT_EQ("", loading.ErrorOf(document));
    const std::size_t each = (HeapInUse() - before) / kCount;
    RecordProperty("BytesPerInstance", static_cast<int>(each));
    std::printf("%zu bytes per instance\n", each);
    EXPECT_GT(each, 400U);
    EXPECT_LE(each, 680U);
}

TEST(LoadedMemory, AValueOutlivesItsNamespaceAndKeepsNoMoreThanAPageAlive)
{
    std::string document = Packages(2000);
    const std::size_t before = HeapInUse();
    TCIMValue value;
    {
        TLoading loading;
        EXPECT_EQ("", loading.ErrorOf(document));
        const auto instance = loading.Find("Package.CreationClassName=\"LINUX_SoftwarePackage\",Name=\"package-00101000\"");
        value = instance->GetProperty("Path", TCallContext())->GetValue(TCallContext());
    }
    EXPECT_EQ("/usr/lib/packages/101000/module-0001.so", value.GetString());
    EXPECT_EQ(TValueAccess::kRunText, TValueAccess::GetForm(value));
    const std::size_t kept = HeapInUse();
    // What the process initialised meanwhile may be part of this.
    EXPECT_LE(kept - before, 64000U);
    value = TCIMValue();
    EXPECT_GE(kept - HeapInUse(), TTextRun::kSize);
    EXPECT_LE(kept - HeapInUse(), TTextRun::kSize + 16);
}

TEST(TextPool, TextsOfAllLengthsComeBack)
{
    std::vector<TCIMValue> values;
    {
        TTextPool pool;
        for (std::size_t length = 0; length < 600; ++length) {
            values.push_back(pool.MakeValue(std::string(length, static_cast<char>('a' + length % 26))));
        }
    }
    for (std::size_t length = 0; length < 600; ++length) {
        EXPECT_EQ(std::string(length, static_cast<char>('a' + length % 26)), values[length].GetString());
        const auto form = length <= TValueAccess::kShortTextSize ? TValueAccess::kShortText
                          : length <= TTextRun::kLongestText     ? TValueAccess::kRunText
                                                                 : TValueAccess::kSharedText;
        EXPECT_EQ(form, TValueAccess::GetForm(values[length])) << length;
    }
}

TEST(TextPool, ATextThatRepeatsIsSharedFromTheSecondTimeOn)
{
    TTextPool pool;
    const std::string text = "a text that repeats";
    const TCIMValue first = pool.MakeValue(text);
    const TCIMValue second = pool.MakeValue(text);
    const TCIMValue third = pool.MakeValue(text);
    EXPECT_NE(second.GetString().data(), first.GetString().data());
    EXPECT_EQ(second.GetString().data(), third.GetString().data());
    EXPECT_EQ(text, first.GetString());
    EXPECT_EQ(text, third.GetString());
}

TEST(TextPool, TextsGoIntoTheRunThatIsToBeFilled)
{
    TTextPool pool;
    TTextRun::TPointer run;
    const TCIMValue before = pool.MakeValue("a text before all others");
    pool.FillRun(&run);
    const TCIMValue first = pool.MakeValue("a text in a run given");
    EXPECT_EQ(first.GetString().data(), run->GetText(0, 1).data());
    pool.FillRun(nullptr);
    const TCIMValue after = pool.MakeValue("a text after them");
    EXPECT_EQ(before.GetString().data() + before.GetString().size(), after.GetString().data());
    pool.FillRun(&run);
    const TCIMValue second = pool.MakeValue("another text in it");
    EXPECT_EQ(first.GetString().data() + first.GetString().size(), second.GetString().data());
    // A run that is full gets a successor.
    const TTextRun::TPointer full = run;
    for (int number = 1000; full == run; ++number) {
        EXPECT_EQ("one of many texts " + std::to_string(number),
                  pool.MakeValue("one of many texts " + std::to_string(number)).GetString());
    }
    EXPECT_LT(full->GetSize(), run->GetSize());
}

// Documents may list the instances of many classes in any order. The text of an instance lies behind that of the instance of its
// class before.
TEST(LoadedMemory, TextsOfOneClassLieSideBySide)
{
    constexpr int kOfEachClass = 200;
    std::string contents = TLoading::Class("Disk") + TLoading::Class("Tape");
    const auto idOf = [](const std::string& className, int number) {
        return "an identity of a " + className + " " + std::to_string(1000 + number);
    };
    for (int number = 0; number < kOfEachClass; ++number) {
        for (const std::string className : {"Disk", "Tape"}) {
            contents += TLoading::Instance(className, idOf(className, number));
        }
    }
    TLoading loading;
    ASSERT_EQ("", loading.ErrorOf(TLoading::Group(contents)));
    int neighbours = 0;
    const char* end = nullptr;
    for (int number = 0; number < kOfEachClass; ++number) {
        const auto instance = loading.Find("Disk.Id=\"" + idOf("Disk", number) + "\"");
        const std::string_view id = instance->GetProperty("Id", TCallContext())->GetValue(TCallContext()).GetString();
        neighbours += id.data() == end ? 1 : 0;
        end = id.data() + id.size();
    }
    EXPECT_LE(kOfEachClass * 9 / 10, neighbours);
}

}  // namespace
}  // namespace NORVZEL20
