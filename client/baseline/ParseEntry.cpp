// An entry is one line:
//
//   ~ INSTANCE PROPERTY: VALUE -> VALUE in LABEL, LABEL        a property with another value than the reference's
//   + INSTANCE PROPERTY: VALUE, PROPERTY: VALUE in LABEL       an instance that the reference lacks, and what it holds
//   - INSTANCE in LABEL                                        an instance that only the reference has
//
// and may end with "# REASON". INSTANCE is a class and a key as in a path; VALUE is what ValueIdentity writes. If the rules exclude
// keys, several instances of an inventory may share one: then "(instances): 2" stands among the values of +, and " x2" behind a
// VALUE that so many of them have. Different values have " / " between them. Values are compared as texts, so nothing is read from
// them but where they end: blanks within them count as one, those within quotes as they are.
#include "client/baseline/ParseEntry.h"

#include <algorithm>

#include "client/baseline/ForEachUnquoted.h"
#include "client/baseline/TEntryScanner.h"

namespace NORVZEL20 {

namespace {

// The number of braces that are open behind the field.
int BracesAfter(const std::string& field, int open)
{
    ForEachUnquoted(field, [&](std::size_t at) {
        open += field[at] == '{' ? 1 : field[at] == '}' ? -1 : 0;
        return true;
    });
    return open;
}

std::vector<std::string> SplitAtCommas(const std::string& field)
{
    std::vector<std::string> parts;
    std::size_t begin = 0;
    ForEachUnquoted(field, [&](std::size_t at) {
        if (field[at] == ',') {
            parts.push_back(field.substr(begin, at - begin));
            begin = at + 1;
        }
        return true;
    });
    parts.push_back(field.substr(begin));
    return parts;
}

// Reads one entry.
class TEntryParser {
  public:
    TEntryParser(std::string_view text, const std::string& file, std::size_t line) : fScanner(text, file, line), fLine(line) {}

    TAcceptedDifference Parse()
    {
        TAcceptedDifference entry{Kind(), {}, {}, {}};
        entry.line = fLine;
        if (fScanner.Peek().empty()) {
            fScanner.Refuse("an instance, such as Disk.Id=\"sda\"");
        }
        entry.instance = fScanner.Take();
        if (entry.kind == TDifference::kChanged) {
            entry.values.push_back({Property(), Until("->"), Until("in")});
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
            const bool isConflict = sign.find("<<<<<<<") == 0 || sign.find("=======") == 0 || sign.find(">>>>>>>") == 0;
            fScanner.Refuse(isConflict ? "an entry; keep the entries of both sides of the merge and remove its marks"
                                       : "an entry, which begins with -, + or ~, or a comment, which begins with #");
        }
        const char kind = fScanner.Take().front();
        return kind == '-' ? TDifference::kOnlyInReference : kind == '+' ? TDifference::kOnlyInOthers : TDifference::kChanged;
    }

    std::string Property()
    {
        if (fScanner.Peek().size() < 2 || fScanner.Peek().back() != ':') {
            fScanner.Refuse("a property with a colon behind it, such as Size:");
        }
        std::string property = fScanner.Take();
        property.pop_back();
        return property;
    }

    // The fields up to `end`, which is taken too.
    std::string Until(const std::string& end)
    {
        std::string value;
        while (fScanner.Peek() != end) {
            if (fScanner.Peek().empty() || fScanner.Peek() == "->" || fScanner.Peek() == "in") {
                break;
            }
            value += (value.empty() ? "" : " ") + fScanner.Take();
        }
        if (value.empty()) {
            fScanner.Refuse("a value, such as \"text\", uint16 5 or NULL");
        }
        if (fScanner.Peek() != end) {
            fScanner.Refuse(end == "in" ? "\"in\" and the labels of inventories" : "\"->\" and the value of other inventories");
        }
        fScanner.Take();
        return value;
    }

    // Only an instance that the reference lacks has any.
    std::vector<TAcceptedDifference::TValue> Contents(TDifference::EKind kind)
    {
        std::vector<TAcceptedDifference::TValue> values;
        while (fScanner.Peek() != "in") {
            if (kind == TDifference::kOnlyInReference || fScanner.Peek().empty()) {
                fScanner.Refuse("\"in\" and the labels of inventories");
            }
            values.push_back({Property(), std::string(), ListedValue()});
        }
        fScanner.Take();
        std::sort(values.begin(), values.end(), [](const auto& one, const auto& other) { return one.property < other.property; });
        return values;
    }

    // A value of several, which ends with a comma that is in no braces, or with "in".
    std::string ListedValue()
    {
        std::string value;
        int open = 0;
        while (!fScanner.Peek().empty() && fScanner.Peek() != "in") {
            std::string field = fScanner.Take();
            open = BracesAfter(field, open);
            const bool isLast = open <= 0 && field.back() == ',';
            if (isLast) {
                field.pop_back();
            }
            value += (value.empty() ? "" : " ") + field;
            if (isLast) {
                break;
            }
        }
        if (value.empty()) {
            fScanner.Refuse("a value, such as \"text\", uint16 5 or NULL");
        }
        return value;
    }

    std::vector<std::string> Labels()
    {
        std::vector<std::string> labels;
        while (!fScanner.Peek().empty()) {
            for (const std::string& label : SplitAtCommas(fScanner.Take())) {
                if (!label.empty()) {
                    labels.push_back(Unquoted(label));
                }
            }
        }
        if (labels.empty()) {
            fScanner.Refuse("the label of an inventory");
        }
        std::sort(labels.begin(), labels.end());
        labels.erase(std::unique(labels.begin(), labels.end()), labels.end());
        return labels;
    }

    static std::string Unquoted(const std::string& field)
    {
        if (field.size() < 2 || field.front() != '"' || field.back() != '"') {
            return field;
        }
        std::string text;
        for (std::size_t i = 1; i + 1 < field.size(); ++i) {
            i += field[i] == '\\' && i + 2 < field.size() ? 1 : 0;
            text += field[i];
        }
        return text;
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
