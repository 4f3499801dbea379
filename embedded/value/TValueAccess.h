#pragma once

#include <cstring>

#include "embedded/value/TSharedText.h"
#include "embedded/value/TTextRun.h"
#include "host/Export.h"
#include "host/TCIMDateTime.h"
#include "host/TCIMReference.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Unchecked access to the contents of a value, for this library only.
class CIMDELTA_INTERNAL_EXPORT TValueAccess {
  public:
    /// How a value holds its contents. From kSharedText on, that is a pointer to a block that begins with TCounted.
    enum EForm : unsigned char {
        kNull = 0,
        kNumber,      ///< boolean, integer, real or char16: 64 bits
        kDateTime,    ///< the parts of a TCIMDateTime
        kShortText,   ///< length and up to kShortTextSize bytes
        kSharedText,  ///< TSharedText
        kRunText,     ///< length and offset of a text in a TTextRun
        kObject,      ///< TCountedObject
        kArray,       ///< TCountedArray
        kBag,         ///< TCountedArray, compared as a multiset
        kPath         ///< the contents of a TCIMReference; a null pointer for the empty path
    };
    static constexpr std::size_t kShortTextSize = 13;

    static EForm GetForm(const TCIMValue& value) noexcept { return static_cast<EForm>(value.fForm); }

    /// A string that shares `text`, or has a copy of a short one. `text` must not be null.
    static TCIMValue FromSharedText(const TSharedText::TPointer& text) noexcept;

    /// A string whose text is the one at `offset` of `run`, and uses the run.
    static TCIMValue FromRun(const TTextRun& run, std::uint16_t offset, std::uint16_t length) noexcept;

    /// The text of a value for which IsText is true.
    static std::string_view GetText(const TCIMValue& value) noexcept;
    // The forms of text follow each other.
    static bool IsText(const TCIMValue& value) noexcept { return value.fForm >= kShortText && value.fForm <= kRunText; }

    /// Moves `from`, which is null then, to a value that is null.
    static void MoveToNull(TCIMValue& to, TCIMValue& from) noexcept
    {
        std::memcpy(static_cast<void*>(&to), static_cast<const void*>(&from), sizeof to);
        from.fForm = kNull;
    }

    /// Whether type, form and contents have the same bytes. Equal values may have different ones.
    static bool HasSameBytes(const TCIMValue& a, const TCIMValue& b) noexcept
    {
        std::uint64_t words[2][2];
        static_assert(sizeof words[0] == sizeof(TCIMValue), "a value is two words");
        std::memcpy(words[0], static_cast<const void*>(&a), sizeof words[0]);
        std::memcpy(words[1], static_cast<const void*>(&b), sizeof words[1]);
        return ((words[0][0] ^ words[1][0]) | (words[0][1] ^ words[1][1])) == 0;
    }

    /// Whether a is written like b in everything, so that no reader could say which of the two it reads. False for embedded objects
    /// that are not the same one. Cost: of a path or an array, that of their parts.
    static bool IsIndistinguishable(const TCIMValue& a, const TCIMValue& b) noexcept;
    /// Whether both are paths, and alike in all but the values of their keys.
    static bool HasSameFrame(const TCIMValue& a, const TCIMValue& b) noexcept;
    /// Lets `value` use the memory for what it has in common with `other`. Both must have the same frame. Errors: std::bad_alloc,
    /// and then nothing has changed.
    static void ShareFrame(TCIMValue& value, const TCIMValue& other);
    /// Whether a value holds a block of its own or shares one.
    static bool HasBlock(const TCIMValue& value) noexcept { return value.fForm >= kSharedText; }

    /// The bits of a value of form kNumber: a signed integer sign-extended, a real as a double, a char16 as its unit.
    static std::uint64_t GetBits(const TCIMValue& value) noexcept { return Load<std::uint64_t>(value); }
    /// The number of a real.
    static double GetReal(const TCIMValue& value) noexcept { return Load<double>(value); }
    /// A value of form kNumber. `type` must be boolean, an integer, a real or char16; `bits` are as in GetBits and in range.
    static TCIMValue FromBits(TCIMValue::TCIMType type, std::uint64_t bits) noexcept;
    static TCIMValue FromReal(TCIMValue::TCIMType type, double number) noexcept;

    /// The path of a value of form kPath, without a copy. Valid until the value changes.
    static const TCIMReference& GetPath(const TCIMValue& value) noexcept;

    /// Makes a key that holds references nested too deeply for a path into text, with which the path has the same text: a path into
    /// its path text, an embedded object into TEmbeddedObject::GetKeyText. Other keys stay as they are. `above` says how many
    /// paths the path may be in itself.
    static void LimitDepth(TCIMValue& key, unsigned int above);

    /// Frees the memory of paths that have ended, which the calling thread keeps for its next ones: for a caller that accounts for
    /// each block.
    static void FreeSparePaths() noexcept;

  private:
    friend class TCIMValue;

    // A number or a pointer is at offset 8 of the value, which is aligned to 8.
    static constexpr std::size_t kPayload = 6;
    // Of a text in a run, in front of the pointer.
    static constexpr std::size_t kRunLength = 0;
    static constexpr std::size_t kRunOffset = 2;

    template <class T>
    static T Load(const TCIMValue& value, std::size_t offset = kPayload) noexcept
    {
        T result;
        std::memcpy(&result, value.fBytes + offset, sizeof result);
        return result;
    }

    template <class T>
    static void Store(TCIMValue& value, const T& part, std::size_t offset = kPayload) noexcept
    {
        std::memcpy(value.fBytes + offset, &part, sizeof part);
    }

    static const TCounted* GetBlock(const TCIMValue& value) noexcept { return Load<const TCounted*>(value); }
    static void StoreText(TCIMValue& value, std::string_view text) noexcept;
    static void StoreDateTime(TCIMValue& value, const TCIMDateTime& time) noexcept;
    static TCIMDateTime LoadDateTime(const TCIMValue& value) noexcept;
    static const TCounted* AcquirePath(const TCIMReference& path) noexcept;
    static void DropBlock(const TCIMValue& value) noexcept;
};

}  // namespace NORVZEL20
