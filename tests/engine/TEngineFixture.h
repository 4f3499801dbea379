#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "engine/TCIMDiffEngine.h"
#include "spec/TDiffClassRules.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

using TEngine = TCIMDiffEngine;

/// An engine over watched namespaces, without a specification. Tests call its operations one by one.
///
/// Each namespace holds Disk: keys Bus (uint32) and Id; Size (uint32), Owner (reference), Tags (array), DateTimeOfCollection.
class TEngineFixture : public testing::Test {
  protected:
    explicit TEngineFixture(EHost host = EHost::kPlain, std::size_t namespaceCount = 2);

    /// An engine over all namespaces.
    TEngine& Engine();
    TCallWatch& Watch() { return fComparison.GetWatch(); }

    /// Rules that exclude the keys of a white-space separated list.
    static boost::shared_ptr<TEngine::TDiffClassRules> RulesWithout(const std::string& excludedKeys);
    /// Adds a Disk to a namespace and returns it, watched.
    boost::shared_ptr<ICIMInstance> Disk(std::size_t index, const TNamespaceBuilder::TValues& values);
    /// A path to a Disk in the given namespace (empty: in none).
    TCIMReference PathTo(const std::string& namespaceName, unsigned int bus, const std::string& id);

    const TCallContext fNone;
    TCapturingLogger fLog;
    TComparisonRun fComparison;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces;
    std::unique_ptr<TEngine> fEngine;
};

/// The status of the TZELException that the call throws, such as `status 37`; empty if it throws nothing.
std::string OutcomeOf(const std::function<void()>& call);

}  // namespace NORVZEL20
