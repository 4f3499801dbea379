#include "embedded/cimxml/TXmlTag.h"

#include "embedded/cimxml/TXmlCharacter.h"
#include "embedded/cimxml/TXmlReference.h"
#include "embedded/cimxml/TXmlSearch.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

void TXmlTag::Assign(const TXmlStartTag& tag)
{
    fBytes = tag.GetBytes();
    fLength = fBytes.size();
    fBytes.append(TXmlSearch::kReadsBeyond, '\0');
    fText.clear();
    // No text is longer than in the tag, and its NUL takes the place of '=' or a quote. So nothing below moves the texts.
    fText.reserve(fLength);
    fAttributes.clear();
    fNameLength = tag.GetName().size();
    AddText(tag.GetName());
    for (const TXmlStartTag::TAttribute& attribute : tag.GetAttributes()) {
        fAttributes.push_back(AddText(attribute.name));
        fAttributes.push_back(attribute.isPlain ? AddText(attribute.value) : AddValue(attribute.value));
    }
    fAttributes.push_back(nullptr);
    fIsEmpty = tag.IsEmpty();
}

const char* TXmlTag::AddText(std::string_view text)
{
    const char* const begin = fText.data() + fText.size();
    fText += text;
    fText += '\0';
    return begin;
}

/// Replaces references by their characters. A line end and any other white space becomes one blank, unless a reference stands for
/// it.
const char* TXmlTag::AddValue(std::string_view value)
{
    const char* const begin = fText.data() + fText.size();
    for (std::size_t at = 0; at < value.size();) {
        if (value[at] == '&') {
            const TXmlReference reference = TXmlReference::Read(value.data() + at, value.data() + value.size());
            TUtf8::Append(fText, reference.code);
            at += reference.length;
            continue;
        }
        const bool isPair = value.substr(at, 2) == "\r\n";
        fText += TXmlCharacter::IsBlank(value[at]) ? ' ' : value[at];
        at += isPair ? 2 : 1;
    }
    fText += '\0';
    return begin;
}

}  // namespace NORVZEL20
