// A start tag:
//
//     tag        '<' name (blanks attribute)* blanks? '/'? '>'
//     attribute  name blanks? '=' blanks? quote value quote
//
// Names are ASCII. A value has no '<', only references that TXmlReference knows, and only characters that XML allows. A name comes
// once. Whatever else there is, or would take much memory, is refused. Each function reads on at fAt; the NUL behind the last byte
// fits nowhere, so no function looks at the end first. Miss says whether it was that NUL.
#include "embedded/cimxml/TXmlStartTag.h"

#include <algorithm>

#include "embedded/cimxml/TXmlCharacter.h"
#include "embedded/cimxml/TXmlReference.h"
#include "embedded/cimxml/TXmlSearch.h"

namespace NORVZEL20 {

EXmlScan TXmlStartTag::Read(const char* from, const char* end)
{
    fAt = from + 1;
    fEnd = end;
    fAttributes.clear();
    EXmlScan scan = ReadName(fName);
    if (scan == EXmlScan::kAccepted) {
        scan = ReadAttributes();
    }
    if (scan != EXmlScan::kAccepted) {
        return scan;
    }
    fIsEmpty = *fAt == '/';
    fAt += fIsEmpty ? 1 : 0;
    if (*fAt != '>') {
        return Miss();
    }
    fBytes = std::string_view(from, static_cast<std::size_t>(fAt + 1 - from));
    return EXmlScan::kAccepted;
}

EXmlScan TXmlStartTag::ReadName(std::string_view& name)
{
    constexpr std::size_t kLongest = 128;
    const char* const begin = fAt;
    if (!TXmlCharacter::IsNameStart(*fAt)) {
        return Miss();
    }
    do {
        ++fAt;
    } while (TXmlCharacter::IsNamePart(*fAt));
    name = std::string_view(begin, static_cast<std::size_t>(fAt - begin));
    return name.size() <= kLongest ? EXmlScan::kAccepted : EXmlScan::kRefused;
}

/// Reads up to the '>', or the '/' in front of it.
EXmlScan TXmlStartTag::ReadAttributes()
{
    constexpr std::size_t kMost = 16;
    for (;;) {
        const bool isApart = SkipBlanks();
        if (*fAt == '>' || *fAt == '/') {
            return EXmlScan::kAccepted;
        }
        if (!isApart) {
            return Miss();
        }
        if (fAttributes.size() == kMost) {
            return EXmlScan::kRefused;
        }
        const EXmlScan scan = ReadAttribute();
        if (scan != EXmlScan::kAccepted) {
            return scan;
        }
    }
}

EXmlScan TXmlStartTag::ReadAttribute()
{
    TAttribute attribute{{}, {}, true};
    EXmlScan scan = ReadName(attribute.name);
    if (scan != EXmlScan::kAccepted) {
        return scan;
    }
    SkipBlanks();
    if (*fAt != '=') {
        return Miss();
    }
    ++fAt;
    SkipBlanks();
    if (*fAt != '"' && *fAt != '\'') {
        return Miss();
    }
    const char quote = *fAt++;
    scan = ReadValue(attribute, quote);
    if (scan == EXmlScan::kAccepted) {
        if (IsRepeated(attribute.name)) {
            return EXmlScan::kRefused;
        }
        fAttributes.push_back(attribute);
    }
    return scan;
}

EXmlScan TXmlStartTag::ReadValue(TAttribute& attribute, char quote)
{
    const char* const begin = fAt;
    for (;;) {
        fAt = TXmlSearch::FindSpecial(fAt, quote);
        if (*fAt == quote) {
            attribute.value = std::string_view(begin, static_cast<std::size_t>(fAt - begin));
            ++fAt;
            return EXmlScan::kAccepted;
        }
        attribute.isPlain = false;
        const EXmlScan scan = PassSpecial();
        if (scan != EXmlScan::kAccepted) {
            return scan;
        }
    }
}

/// Passes over a character of a value that is not just any character of ASCII.
EXmlScan TXmlStartTag::PassSpecial()
{
    if (TXmlCharacter::IsBlank(*fAt)) {
        ++fAt;
        return EXmlScan::kAccepted;
    }
    if (*fAt == '&') {
        const TXmlReference reference = TXmlReference::Read(fAt, fEnd);
        fAt += reference.scan == EXmlScan::kAccepted ? reference.length : 0;
        return reference.scan;
    }
    if (static_cast<unsigned char>(*fAt) < 0x80U) {
        return Miss();
    }
    return TXmlCharacter::Pass(fAt, fEnd);
}

bool TXmlStartTag::IsRepeated(std::string_view name) const noexcept
{
    return std::any_of(fAttributes.begin(), fAttributes.end(), [name](const TAttribute& other) { return other.name == name; });
}

/// Returns whether there were any.
bool TXmlStartTag::SkipBlanks() noexcept
{
    const char* const begin = fAt;
    while (TXmlCharacter::IsBlank(*fAt)) {
        ++fAt;
    }
    return fAt > begin;
}

}  // namespace NORVZEL20
