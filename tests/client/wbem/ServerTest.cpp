#include <chrono>
#include <optional>

#include "tests/client/wbem/TServerFixture.h"

namespace NORVZEL20 {
namespace {

const char kOne[] = "<IRETURNVALUE><VALUE.NAMEDINSTANCE/></IRETURNVALUE>";

class WbemServerTest : public TServerFixture {
  protected:
    std::string AskForDisks(TAnswerStore* store = nullptr) { return Ask(EnumerateInstances("root/cimv2", "CIM_Disk"), store); }
    static std::string Disks() { return AnswerTo("EnumerateInstances", kOne); }
};

TEST_F(WbemServerTest, ARequestSaysWhatItAsksForInHeaders)
{
    fTransport.ThenAnswer(Disks());
    EXPECT_EQ("1", AskForDisks());
    EXPECT_EQ((std::vector<std::string>{"Content-Type: application/xml; charset=\"utf-8\"", "CIMOperation: MethodCall",
                                        "CIMMethod: EnumerateInstances", "CIMObject: root/cimv2"}),
              fTransport.fPosts.at(0).headers);
}

TEST_F(WbemServerTest, FailedConnectionsAndBusyServersAreTriedAgainAfterPauses)
{
    TAnswerStore store;
    fTransport.ThenFail(TWbemFault::kUnreachable, "refused")
        .ThenStatus(503, "Busy")
        .ThenAnswer(Disks().substr(0, 100))
        .ThenAnswer(Disks());
    EXPECT_EQ("1", AskForDisks(&store));
    EXPECT_EQ("500 1000 2000 ", fPauses);
    EXPECT_EQ(1u, store.CountAnswers());
}

TEST_F(WbemServerTest, TriesEnd)
{
    for (int i = 0; i < 4; ++i) {
        fTransport.ThenStatus(503, "Busy");
    }
    EXPECT_EQ("https://array1:5989: EnumerateInstances of CIM_Disk: the server is busy (HTTP 503 Busy)", AskForDisks());
    EXPECT_EQ("500 1000 2000 ", fPauses);
    EXPECT_TRUE(fTransport.fActs.empty());
}

TEST_F(WbemServerTest, WhatMovesAnEnumerationOnIsAskedOnce)
{
    fTransport.ThenFail(TWbemFault::kBroken, "cut");
    EXPECT_EQ("https://array1:5989: cut", Ask(PullInstancesWithPath("root", "CIM_Disk", "1", 5)));
    EXPECT_EQ("", fPauses);
}

struct TFaultRow {
    const char* what;
    std::function<void(TScriptedTransport&)> script;
    TWbemFault::EKind kind;
    std::string message;
};

/// None of these is tried again.
TEST_F(WbemServerTest, OtherFaultsEndARequestAtOnce)
{
    const std::string server = "https://array1:5989: ";
    const std::string request = server + "EnumerateInstances of CIM_Disk: ";
    const auto status = [](long number, const char* reason, const char* cimError = "") {
        return [=](TScriptedTransport& transport) { transport.ThenStatus(number, reason, cimError); };
    };
    const auto answer = [](const std::string& text) { return [=](TScriptedTransport& transport) { transport.ThenAnswer(text); }; };
    const std::vector<TFaultRow> rows = {
        {"error of CIM", answer(ErrorAnswer("EnumerateInstances", "1", "crashed")), TWbemFault::kStatus,
         request + "CIM_ERR_FAILED (1), \"crashed\""},
        {"error of CIM without words", answer(ErrorAnswer("EnumerateInstances", "99", "")), TWbemFault::kStatus,
         request + "status \"99\""},
        {"another answer", answer(AnswerTo("GetClass", "")), TWbemFault::kAnswer, request + "found the answer to \"GetClass\""},
        {"no XML", answer("no"), TWbemFault::kAnswer,
         request + "found an answer that is no XML (syntax error in line 1), expected CIM-XML: \"no\""},
        {"501", status(501, "Not Implemented"), TWbemFault::kStatus,
         request + "CIM_ERR_NOT_SUPPORTED (7), HTTP 501 Not Implemented"},
        {"unsupported", status(400, "Bad", "unsupported-operation"), TWbemFault::kStatus,
         request + "CIM_ERR_NOT_SUPPORTED (7), HTTP 400 Bad, CIMError: unsupported-operation"},
        {"400", status(400, "Bad Request", "request-not-valid"), TWbemFault::kAnswer,
         request + "found HTTP 400 Bad Request, CIMError: request-not-valid, expected an answer of CIM"},
        {"500", status(500, ""), TWbemFault::kAnswer, request + "found HTTP 500, expected an answer of CIM"},
        {"401", status(401, "Unauthorized"), TWbemFault::kFinal,
         server + "the server wants a user name and a password (HTTP 401 Unauthorized); give them with --netrc, or in CIMDELTA_USER"
                  " and CIMDELTA_PASSWORD"},
        {"403", status(403, "Forbidden"), TWbemFault::kFinal,
         server + "the user may not ask (HTTP 403 Forbidden); ask as another one"},
        {"404", status(404, "Not Found"), TWbemFault::kFinal,
         "https://array1:5989/cimom: found nothing there (HTTP 404 Not Found); if the server answers at another path than /cimom,"
         " name it behind the port, and the namespace with --namespace"},
        {"302", status(302, "Found"), TWbemFault::kFinal,
         server +
             "the server redirects to \"https://elsewhere/\" (HTTP 302 Found); if you trust that address, name it with --from"},
    };
    for (const TFaultRow& row : rows) {
        row.script(fTransport);
        EXPECT_EQ(row.message, AskForDisks()) << row.what;
        EXPECT_EQ(row.kind, fKind) << row.what;
        EXPECT_EQ("", fPauses) << row.what;
        EXPECT_TRUE(fTransport.fActs.empty()) << row.what;
    }
}

TEST_F(WbemServerTest, ARefusedUserIsNamedWithWhereThePasswordCameFrom)
{
    fSettings.credentials = {"me", "secret"};
    fSettings.credentialsOrigin = "CIMDELTA_USER and CIMDELTA_PASSWORD";
    fTransport.ThenStatus(401, "No");
    EXPECT_EQ("https://array1:5989: the server refuses user \"me\" with this password (HTTP 401 No); correct CIMDELTA_USER and"
              " CIMDELTA_PASSWORD",
              AskForDisks());
    EXPECT_EQ("as me:secret\nEnumerateInstances CIM_Disk\n", fTransport.fCalls);
}

TEST_F(WbemServerTest, APersonIsAskedOnceAndOnlyIfTheServerWantsAUser)
{
    int asked = 0;
    fSettings.askPerson = [&asked](const TWbemCredentials&) {
        ++asked;
        return std::optional<TWbemCredentials>({"me", "typed"});
    };
    fTransport.ThenAnswer(Disks()).ThenStatus(401, "No").ThenAnswer(Disks()).ThenStatus(401, "No");
    EXPECT_EQ("1", AskForDisks());
    EXPECT_EQ(0, asked);
    EXPECT_EQ("1", AskForDisks());
    EXPECT_EQ("https://array1:5989: the server refuses user \"me\" with this password (HTTP 401 No); correct what was typed",
              AskForDisks());
    EXPECT_EQ(1, asked);
}

TEST_F(WbemServerTest, WithoutAnybodyToAskTheServersWishIsTheMessage)
{
    fSettings.askPerson = [](const TWbemCredentials&) { return std::nullopt; };
    fTransport.ThenStatus(401, "No");
    EXPECT_EQ("https://array1:5989: the server wants a user name and a password (HTTP 401 No); give them with --netrc, or in"
              " CIMDELTA_USER and CIMDELTA_PASSWORD",
              AskForDisks());
}

TEST_F(WbemServerTest, AnAnswerThatIsTooLargeEndsWhileItComes)
{
    fSettings.limits.answerBytes = 1U << 20U;
    std::size_t pieces = 0;
    fTransport.Then([&pieces](const IHttpTransport::TSink& sink) {
        sink(AnswerTo("EnumerateInstances", kOne).substr(0, 60));
        for (;;) {
            ++pieces;
            sink(std::string(1U << 16U, ' '));
        }
        return TScriptedTransport::Ok();
    });
    EXPECT_EQ("https://array1:5989: EnumerateInstances of CIM_Disk: found an answer of more than 1 MiB", AskForDisks());
    EXPECT_EQ(TWbemFault::kAnswer, fKind);
    EXPECT_EQ(16u, pieces);
}

TEST_F(WbemServerTest, AllAnswersTogetherAreLimited)
{
    fSettings.limits.totalBytes = 1U << 20U;
    const std::string half = AnswerTo("EnumerateInstances", std::string(600000, ' '));
    fTransport.ThenAnswer(half).ThenAnswer(half);
    EXPECT_EQ("0", AskForDisks());
    EXPECT_EQ("https://array1:5989: found answers of more than 1 MiB; allow more with --size-limit MIB", AskForDisks());
    EXPECT_EQ(TWbemFault::kFinal, fKind);
}

TEST_F(WbemServerTest, InstancesAreLimited)
{
    fSettings.limits.instances = 2;
    fTransport.ThenAnswer(Disks()).ThenAnswer(Disks()).ThenAnswer(Disks());
    EXPECT_EQ("1", AskForDisks());
    EXPECT_EQ("1", AskForDisks());
    EXPECT_EQ("https://array1:5989: found more than 2 instances; allow more with --instance-limit NUMBER", AskForDisks());
    EXPECT_EQ(TWbemFault::kFinal, fKind);
}

TEST_F(WbemServerTest, TheCollectionAsAWholeIsLimited)
{
    fSettings.limits.total = std::chrono::milliseconds(0);
    EXPECT_EQ("https://array1:5989: the collection took more than 0 s; allow more with --time-limit SECONDS", AskForDisks());
    EXPECT_EQ("", fTransport.fCalls);
}

TEST_F(WbemServerTest, ARequestGetsTheTimeThatIsLeft)
{
    fSettings.limits.total = std::chrono::minutes(5);
    fTransport.ThenAnswer(Disks());
    AskForDisks();
    EXPECT_LE(fTransport.fPosts.at(0).most, std::chrono::minutes(5));
    EXPECT_GT(fTransport.fPosts.at(0).most.count(), 0);
}

TEST_F(WbemServerTest, WhatIsReceivedIsCounted)
{
    fTransport.ThenAnswer(Disks()).ThenAnswer(Disks());
    AskForDisks();
    AskForDisks();
    EXPECT_EQ(2u, Server().GetCounts().instances);
    EXPECT_EQ(2 * Disks().size(), Server().GetCounts().bytes);
}

}  // namespace
}  // namespace NORVZEL20
