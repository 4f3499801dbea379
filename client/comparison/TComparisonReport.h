#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "client/comparison/IDifferences.h"
#include "client/comparison/TBaselineOutcome.h"
#include "client/comparison/TCoverage.h"
#include "client/comparison/TNotShown.h"
#include "client/rules/TRules.h"
#include "embedded/load/TLoadReport.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// The result of a comparison, ready to be shown. The order of everything in it depends on the inventories' contents alone.
struct TComparisonReport {
    std::vector<std::string> labels;  ///< of the inventories; the first one is the reference
    std::vector<std::string> paths;   ///< of the inventories, in the same order
    std::vector<TLoadReport> loads;   ///< what was found when they were loaded, in the same order
    std::string rules;                ///< what messages call the rules
    std::string rulesText;            ///< their whole document
    bool areRulesMade = false;        ///< whether the person named no rules
    std::string options;              ///< what messages call the options that narrow the rules; empty if there are none
    std::shared_ptr<TRules> meaning;  ///< the rules of the run, options included
    TCoverage coverage;
    std::vector<std::string> idleRules;  ///< the classes that a rules file names although no inventory has instances of their trees
    const std::vector<TInventory>* inventories;    ///< those that were compared; they must outlive this
    boost::shared_ptr<TDeltaNamespace> records;    ///< the delta namespace of the run
    std::shared_ptr<IDifferences> differences;     ///< what the records stand for; reads the inventories
    std::shared_ptr<IDifferences> allDifferences;  ///< the same with those that a baseline or an option leaves out
    std::optional<TBaselineOutcome> baseline;      ///< if `differences` are what a baseline does not accept
    TNotShown notShown;                            ///< the differences of the run that `differences` leaves out
    /// If the reference is what most inventories have (see SeeFromMajority): the report of the run, which says what was compared,
    /// and `inventories`. Otherwise null.
    std::shared_ptr<const TComparisonReport> run = nullptr;
    std::shared_ptr<const std::vector<TInventory>> majority = nullptr;
};

}  // namespace NORVZEL20
