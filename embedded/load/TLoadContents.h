#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "embedded/load/TLoadPlace.h"

namespace NORVZEL20 {

/// What kind of things the documents of a load hold, so a load of something that is no inventory is refused for what it is: an
/// empty load would look like an inventory without instances.
///
/// A server gives many instances in several answers: one to an Open operation and those to Pull operations, of which the last one
/// says that it ends the sequence. If that one is missing, instances are missing too. The answers may come in any order, since
/// folders sort 10 in front of 2; if none is to an Open operation, one end is enough.
class TLoadContents {
  public:
    /// A class, an instance or the declaration of a qualifier.
    void NoteObject() noexcept { fHasObjects = true; }
    /// Something that cannot be loaded. `what` says what it is and what to do, for a load that holds nothing else.
    void NoteOther(std::string_view what, const TLoadPlace& place);

    /// The answer to an intrinsic operation begins. Order of calls: NoteEndOfSequence (if it says so), EndAnswer.
    void BeginAnswer(std::string_view operation, const TLoadPlace& place);
    void NoteEndOfSequence() noexcept { fIsEnd = true; }
    void EndAnswer();

    /// Why what was read is no inventory, with the place; empty if it is one. Call it when all documents have been read.
    struct TFault {
        std::string message;
        TLoadPlace place;
    };
    std::optional<TFault> FindFault() const;

  private:
    bool IsUnfinished() const noexcept { return fOpened > 0 ? fEnded < fOpened : fUnfinished && fEnded == 0; }

    bool fHasObjects = false;
    std::optional<TFault> fOther;       // the first thing that is no object
    std::optional<TFault> fAnswer;      // the first answer
    std::string fOperation;             // of the answer that is open
    TLoadPlace fPlace;                  // of that answer
    bool fIsEnd = false;                // that answer ends its sequence
    std::size_t fOpened = 0;            // sequences whose first answer was read
    std::size_t fEnded = 0;             // sequences whose last answer was read
    std::optional<TFault> fUnfinished;  // the last answer that does not end its sequence
};

}  // namespace NORVZEL20
