#include "client/wbem/TAnswerStore.h"

#include <algorithm>

#include "embedded/cimxml/TCimXmlDocuments.h"

namespace NORVZEL20 {

void TAnswerStore::Begin(const std::string& name)
{
    fName = name;
    fBegin = fLength;
}

void TAnswerStore::End()
{
    fAnswers.push_back({fName, fBegin, fLength});
}

void TAnswerStore::Load(std::size_t first, TLoadSession& session) const
{
    TCimXmlDocuments documents(session);
    for (std::size_t i = first; i < fAnswers.size(); ++i) {
        const TAnswerPlace& answer = fAnswers[i];
        std::uint64_t at = answer.begin;
        const auto pull = [&](char* buffer, std::size_t size) {
            const std::size_t most = static_cast<std::size_t>(std::min<std::uint64_t>(size, answer.end - at));
            const std::size_t count = fText.ReadAt(at, buffer, most);
            at += count;
            return count;
        };
        documents.ReadSource(pull, answer.name);
    }
}

}  // namespace NORVZEL20
