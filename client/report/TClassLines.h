#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/findings/TClassFindings.h"
#include "client/report/TInventoryNames.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// The lines of one class in a grouped report, without the name of the class.
class TClassLines {
  public:
    /// A line, and the kind of difference that colours it. What an instance holds is kept apart, property by property, because it
    /// stands in a column and as much is shown as fits.
    struct TLine {
        std::string text;
        TDifference::EKind kind;
        std::vector<std::string> contents = {};
    };

    /// Of each group, at most `most` members are shown; a group of no more is shown whole. All arguments must outlive this.
    TClassLines(const TClassFindings& findings, const TInventoryNames& names, const TTextOptions& options, bool isPair,
                std::size_t most)
        : fFindings(findings), fNames(names), fOptions(options), fIsPair(isPair), fMost(most)
    {}

    /// `-2 +1 ~43`: what a class with several inventories begins with.
    std::string Counts() const;
    /// The lines, those of instances that one side lacks first.
    std::vector<TLine> Write();
    /// The lines of one of the findings.
    std::vector<TLine> WriteOne(const TPresenceFinding& presence);
    std::vector<TLine> WriteOne(const TPropertyFinding& property);

    /// As many of the contents as fit into a line in which so many columns are `used`, and "..." for the others.
    static std::string JoinContents(const std::vector<std::string>& contents, const TTextOptions& options, std::size_t used);

  private:
    void AddPresences(TDifference::EKind kind);
    void AddPresence(const TPresenceFinding& presence);
    void AddPresenceOfFleet(const TPresenceFinding& presence);
    void AddOtherPresences(TDifference::EKind kind, std::size_t instances);
    std::string Disagreement(const TPresenceFinding& presence) const;
    void AddPresenceOfPair(const TPresenceFinding& presence);
    void AddProperties(std::vector<const TPropertyFinding*> ofOne);
    void AddProperty(const TPropertyFinding& property);
    void AddOtherChanges(const std::vector<const TPropertyFinding*>& rest);
    void AddChange(const TChangeFinding& change);
    void AddManyChanges(const TPropertyFinding& property);
    static std::string First(const TChangeFinding& change);
    std::string MoreChanges(const TPropertyFinding& property) const;
    std::string ExampleOf(const TPropertyFinding& property) const;
    std::string Change(const TChangeFinding& change, bool isPair) const;
    std::string Shorten(const std::vector<std::string>& names, std::size_t count) const;
    std::vector<std::string> Contents(const TPresenceFinding::TExample& example) const;

    const TClassFindings& fFindings;
    const TInventoryNames& fNames;
    const TTextOptions& fOptions;
    const bool fIsPair;
    const std::size_t fMost;
    std::vector<TLine> fLines;
};

}  // namespace NORVZEL20
