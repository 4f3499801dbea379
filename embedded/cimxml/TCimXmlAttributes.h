#pragma once

#include <cstring>

#include "embedded/cimxml/TCimXmlElement.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/value/TNameText.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// An element that starts: which one it is, and its attributes. Valid during the start's event, as the XML reader's attributes are.
class TCimXmlAttributes {
  public:
    /// `attributes` alternates names and values and ends with null.
    TCimXmlAttributes(const TLoadContext& context, TCimXmlElement::EElement element, const char** attributes) noexcept
        : fContext(context), fElement(element), fAttributes(attributes)
    {}

    TCimXmlElement::EElement GetElement() const noexcept { return fElement; }

    /// The value, or null if the element has no such attribute.
    const char* Find(const char* name) const noexcept
    {
        for (const char** next = fAttributes; *next != nullptr; next += 2) {
            if (*next[0] == *name && std::strcmp(next[0], name) == 0) {  // mostly the first character decides
                return next[1];
            }
        }
        return nullptr;
    }

    /// The value, or empty text.
    const char* Get(const char* name) const noexcept
    {
        const char* value = Find(name);
        return value != nullptr ? value : "";
    }

    /// Whether the attribute says "true", in any letter case; `absent` if the element has no such attribute.
    bool IsTrue(const char* name, bool absent) const noexcept
    {
        const char* value = Find(name);
        return value != nullptr ? TNameText::Equal(value, "true") : absent;
    }

    /// The value. Errors: fails with kParseError (9) if it is missing or empty.
    const char* Require(const char* name) const
    {
        const char* value = Find(name);
        if (value == nullptr || *value == '\0') {
            FailMissing(name);
        }
        return value;
    }

    /// The CIM type called `text`. Errors: fails with kParseError (9) if there is none.
    TCIMValue::TCIMType ReadType(const char* text) const;
    /// The CIM type that the attribute TYPE names. Errors: fails with kParseError (9) if it is missing or unknown.
    TCIMValue::TCIMType RequireType() const { return ReadType(Require("TYPE")); }

  private:
    [[noreturn]] void FailMissing(const char* name) const;

    const TLoadContext& fContext;
    TCimXmlElement::EElement fElement;
    const char** fAttributes;
};

}  // namespace NORVZEL20
