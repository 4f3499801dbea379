#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <vector>

#include "tests/faults/DifferingNamespaces.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TScratchFile.h"

namespace NORVZEL20 {

/// Small differing namespaces of the embedded host, with rules and delta namespaces for them.
class TSmallComparison {
  public:
    TSmallComparison(std::size_t namespaces, bool excludesKeys) : fRules(RulesForDiffering(excludesKeys))
    {
        for (std::size_t index = 0; index < namespaces; ++index) {
            TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
            FillDiffering(builder.OperatingSystem(), index);
            fNamespaces.push_back(builder.GetNamespace());
        }
    }

    /// A delta namespace that is ready to run.
    boost::shared_ptr<TDeltaNamespace> MakeDelta() const
    {
        const auto delta = MakeDeltaNamespace(EHost::kInmem);
        for (const auto& ns : fNamespaces) {
            delta->AddNamespaceToCompareList(ns);
        }
        delta->SetSpecFileName(fRules.GetPath());
        return delta;
    }

  private:
    TScratchFile fRules;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces;
};

}  // namespace NORVZEL20
