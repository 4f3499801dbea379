#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

std::string InProperty(const std::string& text)
{
    return "<PROPERTY NAME=\"E\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>" + text + "</VALUE></PROPERTY>";
}

/// The properties with values that do not fit, each with how many it has.
std::string CountsOf(EBadValues choice, const std::string& contents)
{
    TLoadOptions options;
    options.badValues = choice;
    const std::string document = L::Group(contents);
    TLoadSession session(TLoading().GetNamespace(), "doc.xml", options);
    TCimXmlDocuments(session).ReadMemory(document.data(), document.size(), "doc.xml");
    std::string found;
    for (const TBadProperty& bad : session.Commit().badProperties) {
        found += (found.empty() ? "" : " ") + bad.className + "." + bad.property + " " + std::to_string(bad.count);
    }
    return found;
}

const std::string kBadInside =
    "&lt;INSTANCE CLASSNAME=\"B\"&gt;&lt;PROPERTY NAME=\"N\" TYPE=\"uint8\"&gt;&lt;VALUE&gt;300&lt;/VALUE&gt;"
    "&lt;/PROPERTY&gt;&lt;PROPERTY NAME=\"M\" TYPE=\"uint8\"&gt;&lt;VALUE&gt;3&lt;/VALUE&gt;&lt;/PROPERTY&gt;"
    "&lt;/INSTANCE&gt;";

/// The object is discarded with the values in it.
TEST(BadObjectsTest, WhatIsInsideOfABadObjectDoesNotCount)
{
    const std::string broken = kBadInside.substr(0, kBadInside.rfind("&lt;/INSTANCE")) + "&lt;oops/&gt;";
    const auto array = [](const std::vector<std::string>& texts) {
        std::string elements = L::Array("E", "string", texts);
        return elements.insert(elements.find(" TYPE"), " EmbeddedObject=\"instance\"");
    };
    const std::string arrays = L::Class("A", "<PROPERTY.ARRAY NAME=\"E\" TYPE=\"string\"/>");
    const struct {
        const char* what;
        std::string contents;
        std::string found;
    } rows[] = {
        {"at the start", L::Class("A", "<PROPERTY NAME=\"E\" TYPE=\"string\"/>") + L::Instance("A", "1", InProperty(broken)),
         "A.E 1"},
        {"behind another one",
         L::Class("A", "<PROPERTY NAME=\"E\" TYPE=\"string\"/>") + L::Instance("A", "1", InProperty(kBadInside)) +
             L::Instance("A", "2", InProperty(broken)) + L::Instance("A", "3", InProperty(kBadInside)),
         "B.N 2 A.E 1"},
        {"in front of one",
         L::Class("A", "<PROPERTY NAME=\"E\" TYPE=\"string\"/>") + L::Instance("A", "1", InProperty(broken)) +
             L::Instance("A", "2", InProperty(kBadInside)),
         "A.E 1 B.N 1"},
        {"element of an array", arrays + L::Instance("A", "1", array({kBadInside, broken, kBadInside})), "A.E 1"},
        {"array behind another one",
         arrays + L::Instance("A", "1", array({kBadInside, kBadInside})) + L::Instance("A", "2", array({kBadInside, broken})),
         "B.N 2 A.E 1"},
        {"array in front of its class", L::Instance("A", "1", array({kBadInside, broken})) + arrays, "A.E 1"},
    };
    for (const auto& row : rows) {
        for (const EBadValues choice : {EBadValues::kNull, EBadValues::kText}) {
            EXPECT_EQ(row.found, CountsOf(choice, row.contents)) << row.what;
        }
    }
}

/// The class, which comes last, says that the texts are objects.
TEST(BadObjectsTest, NorInAnArrayThatIsReadAtTheEnd)
{
    const std::string broken = kBadInside.substr(0, kBadInside.rfind("&lt;/INSTANCE")) + "&lt;oops/&gt;";
    const std::string contents =
        L::Instance("A", "1", L::Array("E", "string", {kBadInside, broken})) +
        L::Class("A", "<PROPERTY.ARRAY NAME=\"E\" TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedInstance\" TYPE=\"string\">"
                      "<VALUE>B</VALUE></QUALIFIER></PROPERTY.ARRAY>");
    EXPECT_EQ("A.E 1", CountsOf(EBadValues::kText, contents));
}

}  // namespace
}  // namespace NORVZEL20
