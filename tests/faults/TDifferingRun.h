#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <ostream>
#include <string>
#include <vector>

#include "provider/TDeltaNamespace.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

/// A kind of comparison: host, number of namespaces, rules, flaw.
struct TDiffering {
    EHost host;
    std::size_t namespaces;
    bool excludesKeys;
    EFlaw flaw = EFlaw::kNone;

    /// The flaw of the namespace at that position.
    EFlaw FlawOf(std::size_t index) const { return index + 1 == namespaces ? flaw : EFlaw::kNone; }
    bool HasTwo() const { return namespaces == 2; }
    /// For example `Plain2WithExcludedKeys`.
    std::string GetName() const;
    /// Both hosts, two and three namespaces, with and without excluded keys.
    static std::vector<TDiffering> All();

    friend std::ostream& operator<<(std::ostream& out, const TDiffering& differing) { return out << differing.GetName(); }
};

/// A delta namespace, with its store and namespace 0 unwatched.
struct TCompared {
    boost::shared_ptr<TDeltaNamespace> delta;
    boost::shared_ptr<ICIMNamespace> store;
    boost::shared_ptr<ICIMNamespace> reference;  ///< namespace 0
};

/// The result of a run in which nothing is made to fail.
struct TUntouchedRun {
    std::string outcome;               ///< the text of OutcomeOf
    std::string log;                   ///< the text of TCapturingLogger
    std::vector<std::string> records;  ///< the texts of TraceRecords
    std::string before;                ///< namespace 0 before, the text of DumpDiffering
    std::string reference;             ///< namespace 0 afterwards
    std::string aliases;               ///< the text of DumpAliases
};

/// Makes differing namespaces and runs over them once.
TUntouchedRun RunUntouched(const TDiffering& differing);

/// Checks that the delta namespace still works: its schema, a wrapper, a query, and each of `deltas` records.
void ExpectThatItAnswers(const TDiffering& differing, TDeltaNamespace& delta, std::size_t deltas);

/// Checks that a second run after a failed one is complete. Its result must be that of a first run: `untouched`, or, if the failed
/// run has already changed namespace 0, the result of a first run over a copy of it.
void ExpectThatAnotherRunIsWhole(const TDiffering& differing, const TCompared& compared, const TUntouchedRun& untouched);

/// How many of the texts of TraceRecords describe a KALMO_Delta.
std::size_t CountDeltas(const std::vector<std::string>& records);

/// The first `count` of the texts.
std::vector<std::string> FirstOf(const std::vector<std::string>& texts, std::size_t count);

}  // namespace NORVZEL20
