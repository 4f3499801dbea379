#include "embedded/cimxml/TXmlKnownTags.h"

#include <algorithm>
#include <cstring>
#include <utility>

#include "embedded/cimxml/TXmlSearch.h"

namespace NORVZEL20 {

TXmlKnownTags::TKnown* TXmlKnownTags::Read(const char* from, const char* end, EXmlScan& scan)
{
    scan = EXmlScan::kAccepted;
    TKnown* known = Guess(from, end);
    if (known == nullptr) {
        known = Find(from, end);
    }
    if (known == nullptr) {
        scan = fTag.Read(from, end);
        if (scan != EXmlScan::kAccepted) {
            return nullptr;
        }
        known = Learn();
    }
    if (fLastButOne != nullptr) {
        fLastButOne->nextButOne = known;
    }
    if (fLast != nullptr) {
        fLast->next = known;
    }
    fLastButOne = fLast;
    fLast = known;
    return known;
}

/// Two tags say more than one: after <PROPERTY> and <VALUE>, it depends on the property what comes.
TXmlKnownTags::TKnown* TXmlKnownTags::Guess(const char* from, const char* end) const noexcept
{
    const auto isThere = [from, end](const TKnown* known) {
        if (known == nullptr) {
            return false;
        }
        const std::string_view bytes = known->tag.GetBytes();
        return bytes.size() <= static_cast<std::size_t>(end - from) && TXmlSearch::AreSame(from, bytes.data(), bytes.size());
    };
    TKnown* const afterTwo = fLastButOne != nullptr ? fLastButOne->nextButOne : nullptr;
    if (isThere(afterTwo)) {
        return afterTwo;
    }
    TKnown* const afterOne = fLast != nullptr ? fLast->next : nullptr;
    return isThere(afterOne) ? afterOne : nullptr;
}

/// Does not find a tag with a '>' in a value, because it looks only up to the first one.
TXmlKnownTags::TKnown* TXmlKnownTags::Find(const char* from, const char* end) const
{
    const std::size_t length = std::min<std::size_t>(static_cast<std::size_t>(end - from), kLongest);
    const void* const close = std::memchr(from, '>', length);
    if (close == nullptr) {
        return nullptr;
    }
    const auto known = fKnown.find(std::string_view(from, static_cast<std::size_t>(static_cast<const char*>(close) + 1 - from)));
    return known != fKnown.end() ? known->second.get() : nullptr;
}

/// A tag that Find has missed may be known all the same.
TXmlKnownTags::TKnown* TXmlKnownTags::Learn()
{
    const auto known = fKnown.find(fTag.GetBytes());
    if (known != fKnown.end()) {
        return known->second.get();
    }
    if (fTag.GetBytes().size() > kLongest || fKnown.size() == kMost) {
        fUnknown.tag.Assign(fTag);
        return &fUnknown;
    }
    auto learnt = std::make_unique<TKnown>();
    learnt->tag.Assign(fTag);
    learnt->number = fKnown.size();
    const std::string_view bytes = learnt->tag.GetBytes();
    return fKnown.emplace(bytes, std::move(learnt)).first->second.get();
}

}  // namespace NORVZEL20
