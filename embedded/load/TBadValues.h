#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "embedded/load/TBadProperty.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Counts the values of a load that do not fit their types, property by property, and describes the first one.
///
/// What fits costs nothing here. Memory: one record for each property that has such values, and a number for each such value within
/// an embedded object. Errors: std::bad_alloc.
class TBadValues {
  public:
    /// `found` gets a record for each property, in the order of their first values. It must outlive this.
    explicit TBadValues(std::vector<TBadProperty>& found) noexcept : fFound(found) {}

    /// Counts a value of the property that `first` names. Its other fields are kept if it is the first one; `instance` can be left
    /// out, if `isInInstance` says that NameInstance is going to be called. `isEmbedded` says that TakeBack may be called.
    void Note(TBadProperty first, bool isInInstance, bool isEmbedded);
    /// How many embedded values were counted.
    std::size_t GetMark() const noexcept { return fEmbedded.size(); }
    /// Uncounts the embedded values since the mark. Call it only if no others were counted since then.
    void TakeBack(std::size_t mark) noexcept;
    /// Says that one of the values is that of a key, which cannot be NULL.
    void NoteKey() noexcept { fHasKey = true; }
    bool HasKey() const noexcept { return fHasKey; }
    bool HasAny() const noexcept { return !fFound.empty(); }

    /// Whether records still lack the instance that their first value stands in.
    bool LackInstance() const noexcept { return !fNameless.empty(); }
    /// Ends the instance that the values since the last call stand in.
    void NameInstance(const TCIMReference& path);
    /// The same if it has no name yet.
    void LeaveNameless() noexcept { fNameless.clear(); }

    /// What was found first, how many values there are, and what can be done; without the place. `isWhole` says whether the load
    /// has seen everything. Call it only if there are any.
    std::string Describe(bool isWhole) const;

  private:
    std::vector<TBadProperty>& fFound;
    std::map<std::pair<std::string, std::string>, std::size_t> fPositions;  // in fFound, by class and property
    std::vector<std::size_t> fNameless;                                     // positions in fFound
    std::vector<std::size_t> fEmbedded;                                     // likewise, of each embedded value
    bool fHasKey = false;
};

}  // namespace NORVZEL20
