#pragma once

#include <deque>
#include <functional>
#include <regex>
#include <string>
#include <vector>

#include "client/wbem/IHttpTransport.h"
#include "client/wbem/TWbemFault.h"

namespace NORVZEL20 {

/// The text of an answer to that operation.
inline std::string AnswerTo(const std::string& operation, const std::string& inner)
{
    return "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP><IMETHODRESPONSE "
           "NAME=\"" +
           operation + "\">" + inner + "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
}

inline std::string ErrorAnswer(const std::string& operation, const std::string& code, const std::string& words)
{
    return AnswerTo(operation, "<ERROR CODE=\"" + code + "\" DESCRIPTION=\"" + words + "\"/>");
}

/// Answers as a test has scripted, and keeps what was asked.
class TScriptedTransport : public IHttpTransport {
  public:
    using TAct = std::function<TAnswer(const TSink&)>;

    /// What is done for the next request that has no other script: the first time the first one, and so on.
    TScriptedTransport& Then(TAct act)
    {
        fActs.push_back(std::move(act));
        return *this;
    }
    TScriptedTransport& ThenAnswer(const std::string& body)
    {
        return Then([body](const TSink& sink) {
            sink(body);
            return Ok();
        });
    }
    TScriptedTransport& ThenStatus(long status, const std::string& reason, const std::string& cimError = "")
    {
        return Then([=](const TSink&) {
            TAnswer answer;
            answer.status = status;
            answer.reason = reason;
            answer.cimError = cimError;
            answer.location = "https://elsewhere/";
            return answer;
        });
    }
    TScriptedTransport& ThenFail(TWbemFault::EKind kind, const std::string& reason)
    {
        return Then([=](const TSink&) -> TAnswer { throw TWbemFault(kind, "https://array1:5989", reason); });
    }

    TAnswer Post(const TPost& post, const TSink& sink) override
    {
        fPosts.push_back(post);
        fCalls += NameCall(post.body) + "\n";
        if (fActs.empty()) {
            throw TWbemFault(TWbemFault::kFinal, "script", "nothing is scripted for " + NameCall(post.body));
        }
        const TAct act = fActs.front();
        fActs.pop_front();
        return act(sink);
    }

    void SetCredentials(const TWbemCredentials& credentials) override
    {
        fCalls += "as " + credentials.user + ":" + credentials.password + "\n";
    }

    static TAnswer Ok()
    {
        TAnswer answer;
        answer.status = 200;
        return answer;
    }

    std::vector<TPost> fPosts;
    std::string fCalls;  ///< a line for each: operation, class or context
    std::deque<TAct> fActs;

  private:
    static std::string NameCall(const std::string& body)
    {
        std::smatch found;
        std::string name = std::regex_search(body, found, std::regex("METHODCALL NAME=\"([^\"]*)\"")) ? found[1].str() : "?";
        if (std::regex_search(body, found, std::regex("<CLASSNAME NAME=\"([^\"]*)\""))) {
            name += " " + found[1].str();
        }
        if (std::regex_search(body, found, std::regex("EnumerationContext\"><VALUE>([^<]*)<"))) {
            name += " " + found[1].str();
        }
        return name;
    }
};

}  // namespace NORVZEL20
