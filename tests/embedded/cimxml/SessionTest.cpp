#include <gtest/gtest.h>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

/// Several documents, read one after the other into one load.
class SessionTest : public testing::Test {
  protected:
    void Read(const std::string& name, const std::string& contents)
    {
        const std::string text = L::Group(contents);
        fDocuments.ReadMemory(text.data(), text.size(), name);
    }

    std::string CommitError()
    {
        return ErrorOf([this] { fSession->Commit(); });
    }

    template <class TAct>
    std::string ErrorOf(TAct act)
    {
        try {
            act();
            return "";
        } catch (const TPopulateError& error) {
            fSession.reset();
            return error.what();
        }
    }

    TLoading fLoading;
    std::unique_ptr<TLoadSession> fSession = std::make_unique<TLoadSession>(fLoading.GetNamespace(), "inventory");
    TCimXmlDocuments fDocuments{*fSession};
};

TEST_F(SessionTest, DocumentsComeInAnyOrder)
{
    Read("instances.xml", L::Instance("Disk", "sda"));
    Read("schema.xml", L::Class("Disk"));
    Read("more.xml", L::Instance("Disk", "sdb"));
    const TLoadReport report = fSession->Commit();
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"\nroot/cimv2:Disk.Id=\"sdb\"\n", fLoading.PathsOf("Disk"));
    EXPECT_EQ(1U, report.classes);
    EXPECT_EQ(2U, report.instances);
}

TEST_F(SessionTest, NothingStaysWithoutCommit)
{
    Read("a.xml", L::Class("Disk") + L::Instance("Disk", "sda"));
    fSession.reset();
    EXPECT_FALSE(fLoading.GetNamespace()->FindClass("Disk"));
}

TEST_F(SessionTest, ABadDocumentTakesTheOthersBack)
{
    Read("a.xml", L::Class("Disk") + L::Instance("Disk", "sda"));
    EXPECT_EQ("b.xml:2:1: found element <NONSENSE> in <DECLGROUP>",
              ErrorOf([this] { Read("b.xml", "<NONSENSE/>"); }).substr(0, 50));
    EXPECT_FALSE(fLoading.GetNamespace()->FindClass("Disk"));
}

TEST_F(SessionTest, WhatIsMissingAtTheEndIsReportedWhereItIsNeeded)
{
    Read("a.xml", L::Class("Disk"));
    Read("b.xml", "\n\n" + L::Instance("Tape", "st0"));
    Read("c.xml", L::Instance("Disk", "sda"));
    EXPECT_EQ("b.xml:4:", CommitError().substr(0, 8));
}

/// Each document numbers its tags anew: what was learnt of the tags of one does not hold for the next.
TEST_F(SessionTest, TagsOfOneDocumentSayNothingAboutThoseOfAnother)
{
    const auto size = [](const std::string& value) { return L::Property("Size", "string", value); };
    const auto name = [](const std::string& value) { return L::Property("Name", "string", value); };
    Read("schema.xml", L::Class("Disk", "<PROPERTY NAME=\"Size\" TYPE=\"string\"/><PROPERTY NAME=\"Name\" TYPE=\"string\"/>"));
    Read("a.xml", L::Instance("Disk", "1", size("10") + name("11")) + L::Instance("Disk", "2", size("20") + name("22")));
    // The tag of Name has the number that the tag of Size has in the other document.
    Read("b.xml", L::Instance("Disk", "3", name("33") + size("30")) + L::Instance("Disk", "4", name("44") + size("40")));
    fSession->Commit();
    for (const std::string id : {"1", "2", "3", "4"}) {
        EXPECT_EQ(id + "0", fLoading.ValueOf("Disk.Id=\"" + id + "\"", "Size"));
        EXPECT_EQ(id + id, fLoading.ValueOf("Disk.Id=\"" + id + "\"", "Name"));
    }
}

}  // namespace
}  // namespace NORVZEL20
