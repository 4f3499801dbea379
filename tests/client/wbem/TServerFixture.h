#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "client/wbem/TWbemServer.h"
#include "tests/client/wbem/TScriptedTransport.h"

namespace NORVZEL20 {

/// A server whose answers are scripted and whose pauses take no time.
class TServerFixture : public ::testing::Test {
  protected:
    TServerFixture()
    {
        fSettings.address = ReadWbemAddress("https://array1");
        fSettings.sleep = [this](std::chrono::milliseconds time) { fPauses += std::to_string(time.count()) + " "; };
    }

    TWbemServer& Server()
    {
        if (!fServer) {
            fServer = std::make_unique<TWbemServer>(fTransport, fSettings);
        }
        return *fServer;
    }

    /// What becomes of a request: how many instances, or the message.
    std::string Ask(const TWbemRequest& request, TAnswerStore* store = nullptr)
    {
        try {
            return std::to_string(Server().Ask(request, store).instances);
        } catch (const TWbemFault& fault) {
            fKind = fault.GetKind();
            fReason = fault.GetReason();
            fStatus = fault.GetStatus();
            return fault.what();
        }
    }

    TScriptedTransport fTransport;
    TWbemServer::TSettings fSettings;
    std::unique_ptr<TWbemServer> fServer;
    std::string fPauses;
    TWbemFault::EKind fKind = TWbemFault::kFinal;
    std::string fReason;
    std::string fStatus;
};

}  // namespace NORVZEL20
