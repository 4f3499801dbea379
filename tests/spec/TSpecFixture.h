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

    /// The rules that a document gives, or `status 9` for the exception that it ends with.
    std::string Read(const std::string& document);
    /// The same for a file.
    std::string ReadFile(const std::string& path);
    /// What was logged since the last call; see TCapturingLogger.
    std::string TakeLog() { return fLog.Take(); }

    TCapturingLogger fLog;
    TComparisonRun fComparison;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces;
    std::unique_ptr<TCIMDiffEngine> fEngine;  // made without a specification; reads any number of them
};

/// The text of the status, as it stands in log entries.
std::string TextOf(TZELStatusCode::EStatusCode status);

}  // namespace NORVZEL20
