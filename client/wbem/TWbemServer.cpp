#include "client/wbem/TWbemServer.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <thread>
#include <utility>

#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/wbem/TAnswerScan.h"
#include "embedded/cimxml/DescribeCimStatus.h"

namespace NORVZEL20 {

namespace {

const char kNotSupported[] = "7";

// Transfers may end a little before their time.
const std::chrono::milliseconds kNearTheEnd(100);

// "EnumerateInstances of CIM_Disk", "EnumerateClasses of root/cimv2".
std::string NameRequest(const TWbemRequest& request)
{
    return request.operation + " of " + EscapeForDisplay(request.subject.empty() ? request.namespaceName : request.subject);
}

// "HTTP 404 Not Found, CIMError: request-not-valid".
std::string NameStatus(const IHttpTransport::TAnswer& answer)
{
    return "HTTP " + std::to_string(answer.status) + (answer.reason.empty() ? "" : " " + EscapeForDisplay(answer.reason)) +
           (answer.cimError.empty() ? "" : ", CIMError: " + EscapeForDisplay(answer.cimError));
}

std::string Mebibytes(std::uint64_t bytes)
{
    return std::to_string(bytes >> 20U) + " MiB";
}

}  // namespace

TWbemServer::TWbemServer(IHttpTransport& transport, TSettings settings)
    : fTransport(transport), fSettings(std::move(settings)), fEnd(std::chrono::steady_clock::now() + fSettings.limits.total)
{
    if (!fSettings.credentials.user.empty() && !fSettings.askPerson) {
        fTransport.SetCredentials(fSettings.credentials);
    }
}

TWbemAnswer TWbemServer::Ask(const TWbemRequest& request, TAnswerStore* store)
{
    for (unsigned int tries = 1;; ++tries) {
        try {
            return AskOnce(request, store);
        } catch (const TWbemFault& fault) {
            if (store != nullptr) {
                store->DropUnfinished();
            }
            if (!fault.MayPass() || !request.isRepeatable || tries >= fSettings.limits.tries) {
                throw;
            }
        }
        Pause(tries);
    }
}

TWbemAnswer TWbemServer::AskOnce(const TWbemRequest& request, TAnswerStore* store)
{
    const std::string place = fSettings.address.server + ": " + NameRequest(request);
    if (store != nullptr) {
        store->Begin("the answer to " + NameRequest(request));
    }
    std::uint64_t bytes = 0;
    TAnswerScan scan([this] { CountInstance(); });
    const auto sink = [&](std::string_view piece) {
        CountBytes(piece.size(), bytes);
        if (bytes > fSettings.limits.answerBytes) {
            throw TWbemFault(TWbemFault::kAnswer, place, "found an answer of more than " + Mebibytes(fSettings.limits.answerBytes));
        }
        scan.Read(piece);
        if (store != nullptr) {
            store->Append(piece);
        }
    };
    CheckStatus(Post(request, sink), place);
    const TWbemAnswer& answer = scan.Finish();
    if (!answer.errorCode.empty()) {
        const std::string words = answer.description.empty() ? "" : ", " + QuoteForDisplay(answer.description);
        throw TWbemFault(TWbemFault::kStatus, place, DescribeCimStatus(answer.errorCode) + words, answer.errorCode);
    }
    if (const std::string fault = scan.DescribeFault(); !fault.empty()) {
        throw TWbemFault(scan.IsCutOff() ? TWbemFault::kBroken : TWbemFault::kAnswer, place, fault);
    }
    if (!boost::algorithm::iequals(answer.operation, request.operation)) {
        throw TWbemFault(TWbemFault::kAnswer, place, "found the answer to " + QuoteForDisplay(answer.operation));
    }
    if (store != nullptr) {
        store->End();
    }
    return answer;
}

IHttpTransport::TAnswer TWbemServer::Post(const TWbemRequest& request, const IHttpTransport::TSink& sink)
{
    const IHttpTransport::TPost post{{"Content-Type: application/xml; charset=\"utf-8\"", "CIMOperation: MethodCall",
                                      "CIMMethod: " + request.operation, "CIMObject: " + EncodeForHeader(request.namespaceName)},
                                     WriteWbemRequest(request),
                                     GetRest()};
    try {
        const IHttpTransport::TAnswer answer = fTransport.Post(post, sink);
        return answer.status == 401 && TryOtherCredentials() ? fTransport.Post(post, sink) : answer;
    } catch (const TWbemFault& fault) {
        if (fault.GetKind() == TWbemFault::kSilent) {
            GetRest(kNearTheEnd);  // if the time is up, that is the reason
        }
        throw;
    }
}

bool TWbemServer::TryOtherCredentials()
{
    if (!fSettings.askPerson) {
        return false;
    }
    const std::optional<TWbemCredentials> credentials = fSettings.askPerson(fSettings.credentials);
    fSettings.askPerson = nullptr;
    if (!credentials) {
        return false;
    }
    fSettings.credentials = *credentials;
    fSettings.credentialsOrigin = "what was typed";
    fTransport.SetCredentials(*credentials);
    return true;
}

void TWbemServer::CheckStatus(const IHttpTransport::TAnswer& answer, const std::string& place) const
{
    const std::string& server = fSettings.address.server;
    const std::string status = NameStatus(answer);
    if (answer.status / 100 == 2) {
        return;
    }
    if (answer.status == 501 || boost::algorithm::iequals(answer.cimError, "unsupported-operation")) {
        throw TWbemFault(TWbemFault::kStatus, place, DescribeCimStatus(kNotSupported) + ", " + status, kNotSupported);
    }
    switch (answer.status) {
    case 401:
        throw TWbemFault(TWbemFault::kFinal, server, DescribeRefusedUser(answer));
    case 403:
        throw TWbemFault(TWbemFault::kFinal, server, "the user may not ask (" + status + "); ask as another one");
    case 404:
        throw TWbemFault(TWbemFault::kFinal, fSettings.address.url,
                         "found nothing there (" + status +
                             "); if the server answers at another path than /cimom, name it behind the port, and the namespace"
                             " with --namespace");
    case 503:
        throw TWbemFault(TWbemFault::kBroken, place, "the server is busy (" + status + ")");
    default:
        break;
    }
    if (answer.status / 100 == 3) {
        throw TWbemFault(TWbemFault::kFinal, server,
                         "the server redirects to " + QuoteForDisplay(answer.location) + " (" + status +
                             "); if you trust that address, name it with --from");
    }
    throw TWbemFault(TWbemFault::kAnswer, place, "found " + status + ", expected an answer of CIM");
}

std::string TWbemServer::DescribeRefusedUser(const IHttpTransport::TAnswer& answer) const
{
    const std::string status = " (" + NameStatus(answer) + ")";
    if (fSettings.credentials.user.empty() && fSettings.credentialsOrigin.empty()) {
        return "the server wants a user name and a password" + status +
               "; give them with --netrc, or in CIMDELTA_USER and CIMDELTA_PASSWORD";
    }
    if (fSettings.credentials.user.empty()) {
        return "the server refuses user and password of " + EscapeForDisplay(fSettings.credentialsOrigin) +
               ", or there are none for this host" + status;
    }
    return "the server refuses user " + QuoteForDisplay(fSettings.credentials.user) + " with this password" + status +
           "; correct " + EscapeForDisplay(fSettings.credentialsOrigin);
}

void TWbemServer::CountInstance()
{
    if (++fCounts.instances > fSettings.limits.instances) {
        throw TWbemFault(TWbemFault::kFinal, fSettings.address.server,
                         "found more than " + Counted(fSettings.limits.instances, "instance") +
                             "; allow more with --instance-limit NUMBER");
    }
}

void TWbemServer::CountBytes(std::size_t count, std::uint64_t& ofAnswer)
{
    ofAnswer += count;
    fCounts.bytes += count;
    if (fCounts.bytes > fSettings.limits.totalBytes) {
        throw TWbemFault(TWbemFault::kFinal, fSettings.address.server,
                         "found answers of more than " + Mebibytes(fSettings.limits.totalBytes) +
                             "; allow more with --size-limit MIB");
    }
}

std::chrono::milliseconds TWbemServer::GetRest(std::chrono::milliseconds least) const
{
    const auto rest = std::chrono::duration_cast<std::chrono::milliseconds>(fEnd - std::chrono::steady_clock::now());
    if (rest <= least) {
        const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(fSettings.limits.total).count();
        throw TWbemFault(TWbemFault::kFinal, fSettings.address.server,
                         "the collection took more than " + std::to_string(seconds) + " s; allow more with --time-limit SECONDS");
    }
    return rest;
}

void TWbemServer::Pause(unsigned int tries)
{
    const std::chrono::milliseconds pause = std::min(GetRest(), fSettings.limits.pause * (1U << (tries - 1)));
    if (fSettings.sleep) {
        fSettings.sleep(pause);
    } else {
        std::this_thread::sleep_for(pause);
    }
}

}  // namespace NORVZEL20
