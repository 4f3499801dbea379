// An entry is one line:
//
//   ~ INSTANCE PROPERTY: VALUE -> VALUE in LABEL, LABEL        a property with another value than the reference's
//   + INSTANCE PROPERTY: VALUE, PROPERTY: VALUE in LABEL       an instance that the reference lacks, and what it holds
//   - INSTANCE in LABEL                                        an instance that only the reference has
//
// and may end with "# REASON". INSTANCE is a class and a key as in a path; VALUE is what ValueIdentity writes. If the rules exclude
// keys, several instances of an inventory may share one: then "(instances): 2" stands among the values of +, and " x2" behind a
// VALUE of other inventories that so many of them have. Different values have " / " between them. TakeValue.cpp shows what a VALUE
// is.
#include "client/baseline/ParseEntry.h"

#include <algorithm>
#include <cctype>
#include <utility>

#include "client/baseline/EntryText.h"
#include "client/baseline/FindEndOfQuoted.h"
#include "client/baseline/ForEachUnquoted.h"
#include "client/baseline/KeysOfInstance.h"
#include "client/baseline/TDifferenceStates.h"
#include "client/baseline/TEntryScanner.h"
#include "client/baseline/TakeValue.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

constexpr char kLabelsExpected[] = "\"in\" and the labels of inventories";

// Names are letters, digits and underscores; what is not ASCII passes.
bool IsName(std::string_view text)
{
    return !text.empty() && std::all_of(text.begin(), text.end(), [](char character) {
        const auto byte = static_cast<unsigned char>(character);
        return byte >= 0x80 || std::isalnum(byte) != 0 || character == '_';
    });
}

// Whether it is what a path can have as the value of a key. An array as a key is passed as it is.
bool IsKeyValue(std::string_view value)
{
    using TType = TCIMValue::TCIMType;
    if (!value.empty() && (value.front() == '"' || value.front() == '\'')) {
        return FindEndOfQuoted(value, 0) + 1 == value.size();
    }
    if (!value.empty() && value.front() == '{') {
        return value.back() == '}';
    }
    TCIMValue read;
    return value == "NULL" || TValueText::Parse(TType::kBoolean, value, read) || TValueText::Parse(TType::kReal64, value, read);
}

// Reads one entry.
class TEntryParser {
  public:
    TEntryParser(std::string_view text, const std::string& file, std::size_t line) : fScanner(text, file, line), fLine(line) {}

    TAcceptedDifference Parse()
    {
        TAcceptedDifference entry{Kind(), {}, {}, {}};
        entry.line = fLine;
        entry.instance = Instance();
        if (entry.kind == TDifference::kChanged) {
            entry.values.push_back(Change());
            Expect("in", kLabelsExpected);
        } else {
            entry.values = Contents(entry.kind);
        }
        entry.inventories = Labels();
        entry.reason = fScanner.GetReason();
        return entry;
    }

  private:
    TDifference::EKind Kind()
    {
        const std::string& sign = fScanner.Peek();
        if (sign != "-" && sign != "+" && sign != "~") {
            fScanner.Refuse("an entry, which begins with -, + or ~, or a comment, which begins with #");
        }
        const char kind = fScanner.Take().front();
        return kind == '-' ? TDifference::kOnlyInReference : kind == '+' ? TDifference::kOnlyInOthers : TDifference::kChanged;
    }

    // A class is in quotes if it is called "in".
    std::string Instance()
    {
        const std::string& field = fScanner.Peek();
        if (field == "in" || (field != FieldText("in") && !IsName(field.substr(0, field.find('.'))))) {
            fScanner.Refuse("an instance, such as Disk.Id=\"sda\"");
        }
        CheckKeys(field);
        return fScanner.Take();
    }

    void CheckKeys(const std::string& instance) const
    {
        for (const TKeyText& key : KeysOfInstance(instance)) {
            if (!IsName(key.name) || !IsKeyValue(key.value)) {
                fScanner.RefuseAt(key.position, "a key and its value, such as Id=\"sda\" or Bus=1");
            }
        }
    }

    // A number of instances stands in the place of a property only in an instance that the reference lacks.
    std::string Property(TDifference::EKind kind)
    {
        std::string property = fScanner.Peek().substr(0, fScanner.Peek().find(':'));
        const bool isCount = kind == TDifference::kOnlyInOthers && property == kInstancesMark;
        if (fScanner.Peek() != property + ":" || (!isCount && !IsName(property))) {
            fScanner.Refuse("a property with a colon behind it, such as Size:");
        }
        fScanner.Take();
        return property;
    }

    void Expect(const std::string& mark, const char* expected)
    {
        if (fScanner.Peek() != mark) {
            fScanner.Refuse(expected);
        }
        fScanner.Take();
    }

    bool TakesComma()
    {
        const bool isComma = !fScanner.Peek().empty() && fScanner.Peek().front() == ',';
        if (isComma) {
            fScanner.Skip(1);
        }
        return isComma;
    }

    TAcceptedDifference::TValue Change()
    {
        TAcceptedDifference::TValue change{Property(TDifference::kChanged), TakeSingleValue(fScanner), std::string()};
        Expect("->", "\"->\" and the value of other inventories");
        change.after = TakeValue(fScanner);
        return change;
    }

    // Only an instance that the reference lacks has any.
    std::vector<TAcceptedDifference::TValue> Contents(TDifference::EKind kind)
    {
        TNameMap<std::string> contents;
        bool isMore = kind == TDifference::kOnlyInOthers && fScanner.Peek() != "in";
        while (isMore) {
            if (contents.count(fScanner.Peek().substr(0, fScanner.Peek().find(':'))) > 0) {
                fScanner.Refuse("each property once; remove one of them");
            }
            const std::string property = Property(kind);
            contents[property] = property == kInstancesMark ? TakeCount(fScanner) : TakeValue(fScanner);
            isMore = TakesComma();
        }
        Expect("in", contents.empty() ? kLabelsExpected : "a comma and another property, or \"in\" and the labels of inventories");
        std::vector<TAcceptedDifference::TValue> values;
        for (auto& [property, value] : contents) {
            values.push_back({property, std::string(), std::move(value)});
        }
        return values;
    }

    std::vector<std::string> Labels()
    {
        std::vector<std::string> labels;
        do {
            labels.push_back(Label());
        } while (TakesComma());
        if (!fScanner.Peek().empty()) {
            fScanner.Refuse("a comma and another label, or # and the reason");
        }
        std::sort(labels.begin(), labels.end());
        labels.erase(std::unique(labels.begin(), labels.end()), labels.end());
        return labels;
    }

    // A field, or a part of one in front of a comma.
    std::string Label()
    {
        const std::string_view rest = fScanner.GetRest();
        if (!rest.empty() && rest.front() == '"') {
            return QuotedLabel(rest);
        }
        std::size_t length = rest.size();
        ForEachUnquoted(rest, [&](std::size_t at) {
            if (rest[at] == '#') {
                fScanner.RefuseAt(at, "a blank in front of the reason, or the label in quotes");
            }
            const bool isEnd = rest[at] == ' ' || rest[at] == '\t' || rest[at] == ',';
            length = isEnd ? at : length;
            return !isEnd;
        });
        if (length == 0) {
            fScanner.Refuse("the label of an inventory");
        }
        std::string label(rest.substr(0, length));
        fScanner.Skip(length);
        return label;
    }

    std::string QuotedLabel(std::string_view rest)
    {
        const std::size_t end = fScanner.EndOfQuoted(0);
        std::string label;
        for (std::size_t i = 1; i + 1 < end; ++i) {
            if (rest[i] == '\\' && rest[++i] != '"' && rest[i] != '\\') {
                fScanner.RefuseAt(i - 1, "\\\\ or \\\", the escapes that a label can have");
            }
            label += rest[i];
        }
        fScanner.Skip(end);
        return label;
    }

    TEntryScanner fScanner;
    const std::size_t fLine;
};

}  // namespace

TAcceptedDifference ParseEntry(std::string_view text, const std::string& file, std::size_t line)
{
    return TEntryParser(text, file, line).Parse();
}

}  // namespace NORVZEL20
