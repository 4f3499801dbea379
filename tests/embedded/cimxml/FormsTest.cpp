// The forms in which servers and their users keep what was asked for: each as a small document.
#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

const std::string kForms = CIMDELTA_TEST_DATA "/forms/";

/// Loads the files, separated by blanks, as one load. Returns how many classes and instances there are afterwards, or the message,
/// without the folder.
std::string Outcome(const std::string& files)
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    try {
        TLoadSession session(ns, "");
        TCimXmlDocuments documents(session);
        std::istringstream names(files);
        for (std::string name; names >> name;) {
            documents.ReadFile(kForms + name);
        }
        const TLoadReport report = session.Commit();
        return std::to_string(report.classes) + " classes, " + std::to_string(report.instances) + " instances";
    } catch (const TPopulateError& error) {
        EXPECT_TRUE(ns->GetClasses().empty()) << files;
        EXPECT_EQ(TZELStatusCode::kParseError, error.GetStatusCode().GetStatus()) << files;
        return std::string(error.what()).erase(0, kForms.size());
    }
}

struct TFormRow {
    const char* files;
    const char* outcome;
};

void ExpectOutcomes(const std::vector<TFormRow>& rows)
{
    for (const TFormRow& row : rows) {
        EXPECT_EQ(row.outcome, Outcome(row.files)) << row.files;
    }
}

TEST(FormsTest, EachFormOfDeclarationsAndInstancesLoads)
{
    ExpectOutcomes({
        {"declarations.xml", "1 classes, 0 instances"},
        {"enumerate-classes.xml", "2 classes, 0 instances"},
        {"declarations.xml get-class-own.xml", "2 classes, 0 instances"},
        {"declarations.xml get-class-whole.xml", "2 classes, 0 instances"},
        {"get-class-whole.xml declarations.xml", "2 classes, 0 instances"},
        {"declarations.xml enumerate-instances.xml", "1 classes, 2 instances"},
        {"enumerate-instances.xml declarations.xml", "1 classes, 2 instances"},
        {"declarations.xml enumerate-instances-empty.xml", "1 classes, 0 instances"},
        {"declarations.xml get-instance.xml", "1 classes, 1 instances"},
        {"declarations.xml associators.xml", "1 classes, 2 instances"},
        {"declarations.xml references.xml", "1 classes, 1 instances"},
        {"declarations.xml exec-query.xml", "1 classes, 2 instances"},
        {"declarations.xml open-whole.xml", "1 classes, 1 instances"},
        {"declarations.xml open.xml pull-last.xml", "1 classes, 2 instances"},
        {"declarations.xml open.xml pull.xml pull-last.xml", "1 classes, 3 instances"},
        {"declarations.xml pull-last.xml pull.xml open.xml", "1 classes, 3 instances"},
        {"declarations.xml pull-last.xml", "1 classes, 1 instances"},
        {"declarations.xml pull-last.xml pull.xml", "1 classes, 2 instances"},
        {"declarations.xml multirsp.xml", "1 classes, 2 instances"},
        {"several-answers.xml", "1 classes, 2 instances"},
        {"declarations.xml ireturnvalue.xml", "1 classes, 2 instances"},
        {"declarations.xml imethodresponse.xml", "1 classes, 1 instances"},
        {"declarations.xml declgroup.xml", "1 classes, 1 instances"},
        {"declarations.xml instances.xml", "1 classes, 2 instances"},
        {"declarations.xml named-instances.xml", "1 classes, 2 instances"},
        {"declarations.xml instances-with-path.xml", "1 classes, 3 instances"},
        {"class-and-instance.xml", "1 classes, 1 instances"},
        {"declarations.xml sections.xml", "1 classes, 3 instances"},
        {"declarations.xml instance-names.xml enumerate-instances.xml", "1 classes, 2 instances"},
        {"qualifiers.xml", "0 classes, 0 instances"},
        {"several-answers.xml instances.xml named-instances.xml", "1 classes, 2 instances"},
    });
}

TEST(FormsTest, WhatIsNoInventoryIsRefusedForWhatItIs)
{
    ExpectOutcomes({
        {"nothing.xml", "nothing.xml:1:1: found no class and no instance, so this is no inventory; expected declarations with "
                        "instances, or the answers of a server"},
        {"enumerate-instances-empty.xml", "enumerate-instances-empty.xml:3:12: found an answer to \"EnumerateInstances\" without "
                                          "any class or instance; load the answers that have them, or declarations and instances"},
        {"delete-instance.xml", "delete-instance.xml:3:12: found an answer to \"DeleteInstance\" without any class or instance; "
                                "load the answers that have them, or declarations and instances"},
        {"class-names.xml", "class-names.xml:5:1: found a list of names; names have no values, so load the objects instead, for "
                            "instance the answer to EnumerateInstances instead of the one to EnumerateInstanceNames"},
        {"instance-names.xml", "instance-names.xml:5:1: found a list of names; names have no values, so load the objects instead, "
                               "for instance the answer to EnumerateInstances instead of the one to EnumerateInstanceNames"},
        {"associator-names.xml",
         "associator-names.xml:5:1: found a list of names; names have no values, so load the objects instead, for instance the "
         "answer to EnumerateInstances instead of the one to EnumerateInstanceNames"},
        {"get-property.xml", "get-property.xml:5:1: found a value without its class and key; load the instance that it belongs to, "
                             "as GetInstance returns it"},
        {"value.xml",
         "value.xml:1:1: found a value without its class and key; load the instance that it belongs to, as GetInstance returns it"},
        {"method.xml",
         "method.xml:3:12: found the answer to the call of a method, which holds no inventory; load answers with instances"},
    });
}

TEST(FormsTest, ErrorsAndRequestsAreRefusedForWhatTheyAre)
{
    ExpectOutcomes({
        {"error.xml", "error.xml:4:1: found an error as the answer to \"GetInstance\": CIM_ERR_NOT_FOUND (6), \"no such disk\"; "
                      "expected an answer with objects; correct the name in the request"},
        {"error-unknown.xml", "error-unknown.xml:4:1: found an error as the answer to \"Stop\": status \"4711\", \"\"; expected an "
                              "answer with objects; ask the server again"},
        {"request.xml", "request.xml:3:12: found a request to a server (\"EnumerateInstances\"), which is no inventory; load the "
                        "server's answer instead"},
        {"declarations.xml request-with-instance.xml",
         "request-with-instance.xml:3:12: found a request to a server (\"ModifyInstance\"), which is no inventory; load the "
         "server's answer instead"},
        {"requests.xml",
         "requests.xml:3:22: found a request to a server (\"Stop\"), which is no inventory; load the server's answer instead"},
    });
}

TEST(FormsTest, ASequenceOfAnswersMustEnd)
{
    ExpectOutcomes({
        {"declarations.xml open.xml",
         "open.xml:3:12: found an answer to \"OpenEnumerateInstances\" that does not end its sequence (EndOfSequence is not TRUE), "
         "but not the ones after it; pull until the end, and load all the answers together"},
        {"declarations.xml open.xml pull.xml",
         "pull.xml:3:12: found an answer to \"PullInstancesWithPath\" that does not end its sequence (EndOfSequence is not TRUE), "
         "but not the ones after it; pull until the end, and load all the answers together"},
        {"declarations.xml pull.xml",
         "pull.xml:3:12: found an answer to \"PullInstancesWithPath\" that does not end its sequence (EndOfSequence is not TRUE), "
         "but not the ones after it; pull until the end, and load all the answers together"},
        {"declarations.xml open-whole.xml open.xml",
         "open.xml:3:12: found an answer to \"OpenEnumerateInstances\" that does not end its sequence (EndOfSequence is not TRUE), "
         "but not the ones after it; pull until the end, and load all the answers together"},
    });
}

TEST(FormsTest, OtherFilesAreRefusedWithTheirPlace)
{
    ExpectOutcomes({
        {"truncated.xml", "truncated.xml:19:1: found malformed XML: unclosed token; the document ends within <IRETURNVALUE>, so it "
                          "was cut off: fetch or write it again"},
        {"page.html", "page.html:2:1: found element <html> as the outermost element, expected <CIM>, or a part of it such as "
                      "<IRETURNVALUE>, <INSTANCE> or <CLASS>"},
        {"several-answers.xml truncated.xml", "truncated.xml:19:1: found malformed XML: unclosed token; the document ends within "
                                              "<IRETURNVALUE>, so it was cut off: fetch or write it again"},
        {"declarations.xml other-class.xml",
         "other-class.xml:4:1: found class \"Disk\" behind the name of \"Device\", expected the same class in both"},
        {"declarations.xml other-name.xml", "other-name.xml:7:1: found \"sda\" in the key \"Id\" of an instance of class \"Disk\", "
                                            "but the name in front of it says \"sdb\"; correct one of the two"},
    });
}

}  // namespace
}  // namespace NORVZEL20
