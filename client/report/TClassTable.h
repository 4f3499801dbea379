#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/findings/TClassFindings.h"
#include "client/report/TClassLines.h"
#include "client/report/TInventoryNames.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// The findings of classes as lines of a report: the name of each class, and behind and below it what was found.
class TClassTable {
  public:
    /// The arguments must outlive this. With `isPair`, nobody needs to be named.
    TClassTable(const std::vector<TClassFindings>& classes, const TInventoryNames& names, const TTextOptions& options, bool isPair)
        : fClasses(classes), fNames(names), fOptions(options), fIsPair(isPair)
    {}

    /// The lines, without their ends. Of each group, at most `most` members are shown.
    std::vector<std::string> Write(std::size_t most) const;

    /// No more lines than `mostLines`, or as few as there are classes; 0 for no limit. Large groups are shortened first, as far as
    /// needed, then the classes with most lines become one line each, with their counts.
    std::vector<std::string> WriteWithin(std::size_t mostLines) const;

    /// How many members of a group are shown: the first of these with which the lines fit.
    static std::vector<std::size_t> MostMembers(const TTextOptions& options);

  private:
    using TLines = std::vector<std::string>;

    std::vector<TLines> WriteClasses(std::size_t most) const;
    TClassLines ClassLines(const TClassFindings& findings, std::size_t most) const;
    std::vector<std::string> Heads() const;
    void AppendPair(TLines& all, const std::string& head, const std::vector<TClassLines::TLine>& lines, std::size_t column) const;
    void AppendMany(TLines& all, const std::string& head, const std::vector<TClassLines::TLine>& lines) const;
    void Collapse(std::vector<TLines>& classes, std::size_t mostLines) const;
    std::string Bold(const std::string& text) const;
    std::string Colored(const TClassLines::TLine& line) const;

    const std::vector<TClassFindings>& fClasses;
    const TInventoryNames& fNames;
    const TTextOptions& fOptions;
    const bool fIsPair;
};

}  // namespace NORVZEL20
