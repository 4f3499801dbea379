// A value is
//
//   NULL
//   "text"                                 a string
//   uint16 5    boolean TRUE    real64 NaN
//   datetime "..."    reference "..."    char16 'x'    embedded object "..."
//   string[] {"a", NULL}                   an array of any of the types
//
// and may have " x2" behind it, if two or more instances have it. The type is checked, and what can be read of a type is read and
// written again, so an edited file may have other blanks and other spellings of a number than the program.
#include "client/baseline/TakeValue.h"

#include <algorithm>
#include <optional>
#include <string_view>

#include "client/text/DisplayText.h"
#include "client/text/NumberIn.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

constexpr char kValueExpected[] = "a value, such as \"text\", uint16 5 or NULL";
constexpr char kDigits[] = "0123456789";

// A number of instances as the program writes it; empty if it is none, or is less than two.
std::string CountText(std::string_view text)
{
    const std::optional<std::uint64_t> count = NumberIn(text);
    return count && *count > 1 ? std::to_string(*count) : std::string();
}

class TValueTaker {
  public:
    explicit TValueTaker(const TEntryScanner& scanner) : fScanner(scanner), fRest(scanner.GetRest()) {}

    std::string TakeAll()
    {
        std::string text = TakeCounted();
        while (NextIs('/')) {
            ++fAt;
            text += kBetweenValues + TakeCounted();
        }
        return text;
    }

    // Without a number of instances.
    std::string TakeSingle()
    {
        if (NextIs('"')) {
            return TakeQuoted('"');
        }
        const std::size_t begin = fAt;
        std::string type = TakeWord();
        if (type == "NULL") {
            return type;
        }
        const bool isEmbedded = type == "embedded" && TakeWord() == "object";
        type = isEmbedded ? "embedded object" : type;
        const TType element = isEmbedded ? TType(TType::kString) : TValueText::FindType(type);
        const bool isArray = fRest.substr(fAt, 2) == "[]";
        if (element == TType::kNone || (element == TType::kString && !isArray && !isEmbedded)) {
            Refuse(begin, kValueExpected);
        }
        fAt += isArray ? 2 : 0;
        return type + (isArray ? "[] " + TakeElements(element) : " " + TakeElement(element));
    }

    /// The characters that were taken.
    std::size_t GetLength() const { return fAt; }

  private:
    [[noreturn]] void Refuse(std::size_t at, const std::string& expected) const { fScanner.RefuseAt(at, expected); }

    void SkipBlanks() { fAt = std::min(fRest.find_first_not_of(" \t", fAt), fRest.size()); }

    // Whether that character comes next, behind any blanks.
    bool NextIs(char character)
    {
        SkipBlanks();
        return fAt < fRest.size() && fRest[fAt] == character;
    }

    std::string TakeWord()
    {
        SkipBlanks();
        const std::size_t begin = fAt;
        fAt = std::min(fRest.find_first_of(" \t,{}\"'[]#", fAt), fRest.size());
        return std::string(fRest.substr(begin, fAt - begin));
    }

    std::string TakeCounted()
    {
        std::string text = TakeSingle();
        if (NextIs('x')) {
            const std::size_t begin = fAt;
            const std::string count = CountText(TakeWord().substr(1));
            if (count.empty()) {
                Refuse(begin, "the number of instances that have the value, such as x2");
            }
            text += " x" + count;
        }
        return text;
    }

    std::string TakeElements(TType type)
    {
        if (!NextIs('{')) {
            Refuse(fAt, "the elements of an array in braces, such as {\"a\", \"b\"}");
        }
        ++fAt;
        std::string text;
        while (!NextIs('}') || !text.empty()) {
            text += (text.empty() ? "" : ", ") + (NextIs('N') && TakesNull() ? "NULL" : TakeElement(type));
            if (NextIs('}')) {
                break;
            }
            if (!NextIs(',')) {
                Refuse(fAt, "a comma and another element, or }");
            }
            ++fAt;
        }
        ++fAt;
        return "{" + text + "}";
    }

    bool TakesNull()
    {
        const std::size_t begin = fAt;
        const bool isNull = TakeWord() == "NULL";
        fAt = isNull ? fAt : begin;
        return isNull;
    }

    std::string TakeElement(TType type)
    {
        if (type == TType::kString || type == TType::kReference || type == TType::kChar16) {
            return TakeQuoted(type == TType::kChar16 ? '\'' : '"');
        }
        SkipBlanks();
        const std::size_t begin = fAt;
        const std::string word = type == TType::kDateTime ? TakeQuoted('"') : TakeWord();
        TCIMValue value;
        if (!TValueText::Parse(type, type == TType::kDateTime ? std::string_view(word).substr(1, word.size() - 2) : word, value)) {
            Refuse(begin, std::string("a value of type ") + TValueText::GetTypeName(type));
        }
        std::string text;
        value.AppendKeyText(text);
        return text;
    }

    std::string TakeQuoted(char quote)
    {
        if (!NextIs(quote)) {
            Refuse(fAt, std::string("a text in ") + (quote == '"' ? "quotes" : "single quotes"));
        }
        const std::size_t begin = fAt;
        fAt = fScanner.EndOfQuoted(begin);
        return std::string(fRest.substr(begin, fAt - begin));
    }

    const TEntryScanner& fScanner;
    const std::string_view fRest;
    std::size_t fAt = 0;
};

}  // namespace

std::string TakeValue(TEntryScanner& scanner)
{
    TValueTaker taker(scanner);
    std::string text = taker.TakeAll();
    scanner.Skip(taker.GetLength());
    return text;
}

std::string TakeSingleValue(TEntryScanner& scanner)
{
    TValueTaker taker(scanner);
    std::string text = taker.TakeSingle();
    scanner.Skip(taker.GetLength());
    return text;
}

std::string TakeCount(TEntryScanner& scanner)
{
    const std::string_view rest = scanner.GetRest();
    const std::size_t length = std::min(rest.find_first_not_of(kDigits), rest.size());
    std::string count = CountText(rest.substr(0, length));
    if (count.empty()) {
        scanner.Refuse("a number of instances, two or more");
    }
    scanner.Skip(length);
    return count;
}

}  // namespace NORVZEL20
