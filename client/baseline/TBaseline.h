#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "client/comparison/TAcceptedDifference.h"

namespace NORVZEL20 {

/// Accepted differences, found by what they are about. No two of them say the same of the same inventory. The letter case of names
/// of classes, keys and properties does not count.
class TBaseline {
  public:
    /// Adds an entry. If there is one that differs in nothing but inventories, reason and comments, the two become one. If there is
    /// one that has another value for one of the inventories, adds nothing and returns its position.
    std::optional<std::size_t> Add(TAcceptedDifference entry);
    /// Adds a line that belongs to no entry.
    void AddComment(std::string line) { fComments.push_back(std::move(line)); }

    const std::vector<TAcceptedDifference>& GetEntries() const { return fEntries; }
    const std::vector<std::string>& GetComments() const { return fComments; }

    /// The position of the entry for that inventory. `property` is that of kChanged, otherwise empty.
    std::optional<std::size_t> Find(TDifference::EKind kind, const std::string& instance, const std::string& property,
                                    const std::string& label) const;

    /// The file: entries in the order of their instances. ReadBaseline reads it.
    std::string ToText() const;

  private:
    const std::vector<std::size_t>& About(TDifference::EKind kind, const std::string& instance, const std::string& property) const;
    static void Join(TAcceptedDifference& entry, const TAcceptedDifference& other);

    std::vector<TAcceptedDifference> fEntries;
    std::vector<std::string> fComments;
    std::unordered_map<std::string, std::vector<std::size_t>> fAbout;  // positions of entries that may differ in their values only
};

/// What the first line of a baseline begins with; the version follows.
inline constexpr char kBaselineMark[] = "cimdelta-baseline";
inline constexpr char kBaselineVersion[] = "1";

}  // namespace NORVZEL20
