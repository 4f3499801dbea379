#pragma once

#include <cstring>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// The attributes of an element, as the reader delivers them: names and values in turn, ended by null.
class TCimXmlAttributes {
  public:
    explicit TCimXmlAttributes(const char** attributes) noexcept : fAttributes(attributes) {}

    /// The value, or null where the element has no such attribute.
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

    /// Whether the attribute says "true", in any letter case; `absent` where it is not there.
    bool IsTrue(const char* name, bool absent) const noexcept
    {
        const char* value = Find(name);
        return value != nullptr ? TNameText::Equal(value, "true") : absent;
    }

  private:
    const char** fAttributes;
};

}  // namespace NORVZEL20
