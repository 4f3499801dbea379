#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "embedded/load/EValueText.h"
#include "embedded/load/TBadValue.h"
#include "embedded/load/TLoadContext.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

class TCimXmlObjectReader;

/// A property, a qualifier or a qualifier's declaration while its value is read. One item serves many elements in turn.
///
/// A text that is no value of the item's type is a bad value; the item is null then, and TakeBad comes before Take.
/// Order of calls: Begin; for a simple value BeginValue and then SetText, SetReference or, for a null, nothing; for an array
/// BeginArray, any number of AddText, AddReference and AddNull, EndArray; at last Take. Without a value, Take returns a typed null.
/// Errors: fail through the context with the status that each operation names; the load then ends.
class TCimXmlItem {
  public:
    using TType = TCIMValue::TCIMType;

    /// Both arguments must outlive the item.
    TCimXmlItem(TLoadContext& context, TCimXmlObjectReader& objects) noexcept : fContext(context), fObjects(objects) {}

    /// Starts the item. `name` is for messages and must stay valid until Take. `type` is an array type if the element says so.
    void Begin(std::string_view name, TType type, EValueText text) noexcept
    {
        fName = name;
        fType = type;
        fText = text;
        fIsGiven = false;
    }

    /// Starts a value. Errors: kParseError (9) if the item has one.
    void BeginValue()
    {
        if (std::exchange(fIsGiven, true)) {
            FailSecond();
        }
    }
    /// Reads a simple value. Errors: those of TCimXmlObjectReader::Read for an embedded object, unless TLoadOptions::badValues let
    /// it pass.
    void SetText(std::string_view text) { Parse(text, fValue); }
    void SetReference(TCIMValue path) noexcept { fValue = std::move(path); }

    /// Starts an array. Errors: as BeginValue; kTypeMismatch (13) for references in an item of another type.
    void BeginArray(bool isOfReferences);
    /// Errors: as SetText.
    void AddText(std::string_view text) { Parse(text, fElements.emplace_back()); }
    void AddReference(TCIMValue path) { fElements.push_back(std::move(path)); }
    void AddNull() { fElements.push_back(TCIMValue::Null(fType.GetElementType())); }
    void EndArray();

    TType GetType() const noexcept { return fType; }
    EValueText GetText() const noexcept { return fText; }
    bool IsNull() const noexcept { return fValue.IsNull(); }
    /// Whether a text is no value of the item's type. The item is null then.
    bool IsBad() const noexcept { return !fBadTexts.empty(); }
    /// What it holds instead, once. Call it only if IsBad.
    TBadValue TakeBad();
    /// The value, which the caller may move away; null if there is none.
    TCIMValue& GetValue() noexcept { return fValue; }
    /// The value, or a null of the item's type. Errors: kTypeMismatch (13) if there is a bad value, which was not taken.
    TCIMValue Take();

  private:
    /// A text that is no value, with its position among the elements of an array.
    struct TBadText {
        std::size_t position;
        std::string text;
        const char* type;
        TLoadPlace place;
    };

    static constexpr std::size_t kNoMark = static_cast<std::size_t>(-1);

    void Parse(std::string_view text, TCIMValue& value);
    void NoteBad(std::string_view text, const char* type);
    void ReadObject(std::string_view text, TCIMValue& value);
    bool IsObject(std::string_view text) const;
    [[noreturn]] void FailSecond() const;
    [[noreturn]] void FailBad();

    TLoadContext& fContext;
    TCimXmlObjectReader& fObjects;
    std::string_view fName;
    TType fType = TType::kNone;
    EValueText fText = EValueText::kPlain;
    bool fIsGiven = false;
    TCIMValue fValue;
    std::vector<TCIMValue> fElements;  // of the array that is open; kept for its memory
    std::vector<TBadText> fBadTexts;   // in the order of the elements
    std::size_t fMark = kNoMark;       // of the bad values, in front of the array's first object
};

}  // namespace NORVZEL20
