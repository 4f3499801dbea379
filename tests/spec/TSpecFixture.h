#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "engine/TCIMDiffEngine.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

/// Reads specifications against a schema of three classes: Base (Id, Name and Kind are keys; A, B) > Sub (C), and Other (Id; A).
class TSpecFixture : public testing::Test {
  protected:
    explicit TSpecFixture(EHost host = EHost::kPlain);

    /// The rules that a document yields, or `status 9` if reading it throws kParseError (9).
    std::string Read(const std::string& document);
    /// The same, read from a file.
    std::string ReadFile(const std::string& path);
    /// What was logged since the last call; see TCapturingLogger.
    std::string TakeLog() { return fLog.Take(); }

    TCapturingLogger fLog;
    TComparisonRun fComparison;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces;
    std::unique_ptr<TCIMDiffEngine> fEngine;  // made without a specification; reads any number of them
};

/// The text of the status in log entries.
std::string TextOf(TZELStatusCode::EStatusCode status);

}  // namespace NORVZEL20
