#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <ostream>
#include <string>
#include <vector>

#include "provider/TDeltaNamespace.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

/// Which comparison of differing namespaces.
struct TDiffering {
    EHost host;
    std::size_t namespaces;
    bool excludesKeys;
    EFlaw flaw = EFlaw::kNone;

    /// That of the namespace at that position.
    EFlaw FlawOf(std::size_t index) const { return index + 1 == namespaces ? flaw : EFlaw::kNone; }
    bool HasTwo() const { return namespaces == 2; }
    /// `Plain2WithExcludedKeys`
    std::string GetName() const;
    /// Hosts by two and three namespaces by excluded keys.
    static std::vector<TDiffering> All();

    friend std::ostream& operator<<(std::ostream& out, const TDiffering& differing) { return out << differing.GetName(); }
};

/// A delta namespace, and its store and its namespace 0 without a watch around them.
struct TCompared {
    boost::shared_ptr<TDeltaNamespace> delta;
    boost::shared_ptr<ICIMNamespace> store;
    boost::shared_ptr<ICIMNamespace> reference;  ///< namespace 0
};

/// What a run over differing namespaces comes to when nothing is made to fail.
struct TUntouchedRun {
    std::string outcome;               ///< as OutcomeOf tells it
    std::string log;                   ///< as TCapturingLogger tells it
    std::vector<std::string> records;  ///< as TraceRecords tells them
    std::string before;                ///< namespace 0 before, as DumpDiffering tells it
    std::string reference;             ///< namespace 0 afterwards
    std::string aliases;               ///< as DumpAliases tells them
};

/// Makes differing namespaces, runs over them once, and tells what came of it.
TUntouchedRun RunUntouched(const TDiffering& differing);

/// Checks that the delta namespace answers: the schema's classes, a wrapper, a query, each of `deltas` records.
void ExpectThatItAnswers(const TDiffering& differing, TDeltaNamespace& delta, std::size_t deltas);

/// Checks that after a run that failed another one is whole, and comes to what a run comes to that nothing went before: to
/// `untouched`, or, where the failed run has brought namespace 0 in line with the other one, to a run over a copy of it.
void ExpectThatAnotherRunIsWhole(const TDiffering& differing, const TCompared& compared, const TUntouchedRun& untouched);

/// How many of the texts of TraceRecords tell a KALMO_Delta.
std::size_t CountDeltas(const std::vector<std::string>& records);

/// The first `count` of the texts.
std::vector<std::string> FirstOf(const std::vector<std::string>& texts, std::size_t count);

}  // namespace NORVZEL20
