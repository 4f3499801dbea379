#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "client/files/TSpooledText.h"
#include "embedded/load/TLoadSession.h"

namespace NORVZEL20 {

/// The bodies of answers, one behind the other. They take no more memory than a TSpooledText.
class TAnswerStore {
  public:
    /// Begins the next answer. Messages call it `name`.
    void Begin(const std::string& name);
    /// Appends to that answer. Errors: std::bad_alloc.
    void Append(std::string_view piece)
    {
        fText.Append(piece);
        fLength += piece.size();
    }
    /// Ends that answer, which counts from now on.
    void End();
    /// Forgets what was begun and not ended.
    void DropUnfinished() { fBegin = fLength; }

    std::size_t CountAnswers() const noexcept { return fAnswers.size(); }
    /// Forgets all answers but the first ones.
    void KeepFirst(std::size_t count) { fAnswers.resize(count); }

    /// Reads the answers from that one on into a load. Errors: TPopulateError; TClientError if the temporary file cannot be read.
    void Load(std::size_t first, TLoadSession& session) const;

  private:
    struct TAnswerPlace {
        std::string name;
        std::uint64_t begin;
        std::uint64_t end;
    };

    TSpooledText fText;
    std::vector<TAnswerPlace> fAnswers;
    std::string fName;
    std::uint64_t fBegin = 0;
    std::uint64_t fLength = 0;
};

}  // namespace NORVZEL20
