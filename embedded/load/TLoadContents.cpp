#include "embedded/load/TLoadContents.h"

#include "embedded/load/MessageText.h"

namespace NORVZEL20 {

namespace {

bool BeginsWith(std::string_view text, std::string_view beginning)
{
    return text.substr(0, beginning.size()) == beginning;
}

}  // namespace

void TLoadContents::NoteOther(std::string_view what, const TLoadPlace& place)
{
    if (!fOther) {
        fOther = TFault{"found " + std::string(what), place};
    }
}

void TLoadContents::BeginAnswer(std::string_view operation, const TLoadPlace& place)
{
    fOperation = operation;
    fPlace = place;
    fIsEnd = false;
    if (!fAnswer) {
        fAnswer = TFault{"found an answer to " + Quote(operation) +
                             " without any class or instance; load the answers that have them, or declarations and instances",
                         place};
    }
}

void TLoadContents::EndAnswer()
{
    const bool isFirst = BeginsWith(fOperation, "Open");
    if (!isFirst && !BeginsWith(fOperation, "Pull")) {
        return;
    }
    fOpened += isFirst ? 1 : 0;
    fEnded += fIsEnd ? 1 : 0;
    if (!fIsEnd) {
        fUnfinished = TFault{"found an answer to " + Quote(fOperation) +
                                 " that does not end its sequence (EndOfSequence is not TRUE), but not the ones after it; pull"
                                 " until the end, and load all the answers together",
                             fPlace};
    }
}

std::optional<TLoadContents::TFault> TLoadContents::FindFault() const
{
    if (IsUnfinished()) {
        return fUnfinished;
    }
    if (fHasObjects) {
        return std::nullopt;
    }
    if (fOther || fAnswer) {
        return fOther ? fOther : fAnswer;
    }
    return TFault{"found no class and no instance, so this is no inventory; expected declarations with instances, or the answers"
                  " of a server",
                  TLoadPlace()};
}

}  // namespace NORVZEL20
