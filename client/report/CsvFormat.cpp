// The columns, and a row of each kind; every name is part of the format:
//
//   class,instance,name,kind,property,inventory,reference value,value,reference type,type
//   Disk,"Disk.Id=""sda""",sda,changed,Size,web02,500,250,uint64,uint64
//   Disk,"Disk.Id=""sdb""",sdb,changed,Model,web02,,A 1,string NULL,string
//   Disk,"Disk.Id=""sdc""",sdc,onlyInReference,,web02,,,,
//
// A null is an empty cell with "NULL" behind its type, so an empty text is another thing. A spreadsheet takes a cell that begins
// with = + - @, a tab or a line end for a formula, also in quotes. Such a text gets an apostrophe in front, and so does a text that
// begins with one, so dropping the first apostrophe of a text gives it back. Numbers stay as they are.
#include "client/report/CsvFormat.h"

#include <string>
#include <string_view>

#include "client/findings/TShortNames.h"
#include "client/report/JsonDifference.h"
#include "embedded/value/TUtf8.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

const char kHeader[] = "class,instance,name,kind,property,inventory,reference value,value,reference type,type\r\n";

bool MayBeginFormula(std::string_view text)
{
    return !text.empty() && std::string_view("=+-@'\t\r\n").find(text.front()) != std::string_view::npos;
}

// Bytes that are not UTF-8 become U+FFFD.
std::string AsUtf8(std::string_view text)
{
    std::string out;
    while (TUtf8::FindInvalid(text) < text.size()) {
        const std::size_t invalid = TUtf8::FindInvalid(text);
        out.append(text.substr(0, invalid)).append("\uFFFD");
        text.remove_prefix(invalid + 1);
    }
    return out.append(text);
}

std::string QuotedCell(const std::string& cell)
{
    if (cell.find_first_of(",\"\r\n") == std::string::npos) {
        return cell;
    }
    std::string quoted = "\"";
    for (const char character : cell) {
        quoted += character == '"' ? "\"\"" : std::string(1, character);
    }
    return quoted + "\"";
}

std::string TextCell(std::string_view text)
{
    return QuotedCell((MayBeginFormula(text) ? "'" : "") + AsUtf8(text));
}

bool IsText(const TCIMValue& value)
{
    const TCIMValue::TCIMType type = value.GetType();
    return type == TCIMValue::TCIMType::kString || type == TCIMValue::TCIMType::kChar16 || type == TCIMValue::TCIMType::kReference;
}

std::string ValueCell(const TCIMValue& value)
{
    if (value.IsNull()) {
        return std::string();
    }
    return IsText(value) ? TextCell(value.ToText()) : QuotedCell(AsUtf8(value.ToText()));
}

std::string TypeCell(const TCIMValue& value)
{
    return TValueText::DescribeType(value.GetType()) + (value.IsNull() ? " NULL" : "");
}

// Writes the rows of differences.
class TCsvRows {
  public:
    TCsvRows(const TComparisonReport& report, const TTextSink& sink) : fReport(report), fSink(sink), fNames(*report.inventories) {}

    void Write(const TDifference& difference)
    {
        fBegin = TextCell(difference.className) + "," + TextCell(difference.instance) + "," + TextCell(fNames.Of(difference)) +
                 "," + JsonOfKind(difference.kind) + ",";
        if (difference.kind == TDifference::kChanged) {
            return WriteChange(difference.values.front());
        }
        for (const std::size_t inventory : difference.inventories) {
            WriteRow(std::string(), inventory, ",,,");
        }
    }

  private:
    void WriteChange(const TValueDifference& change)
    {
        const std::string property = TextCell(change.property);
        const std::string reference = ValueCell(change.reference);
        const std::string referenceType = TypeCell(change.reference);
        for (const TValueDifference::TGroup& group : change.others) {
            const std::string values = reference + "," + ValueCell(group.value) + "," + referenceType + "," + TypeCell(group.value);
            for (const std::size_t inventory : group.inventories) {
                WriteRow(property, inventory, values);
            }
        }
    }

    void WriteRow(const std::string& property, std::size_t inventory, const std::string& values)
    {
        fSink(fBegin + property + "," + TextCell(fReport.labels[inventory]) + "," + values + "\r\n");
    }

    const TComparisonReport& fReport;
    const TTextSink& fSink;
    TShortNames fNames;
    std::string fBegin;  // of the rows of one difference
};

}  // namespace

void WriteCsvReport(const TComparisonReport& report, const TTextSink& sink)
{
    sink(kHeader);
    TCsvRows rows(report, sink);
    report.differences->ForEach([&rows](const TDifference& difference) { rows.Write(difference); });
}

}  // namespace NORVZEL20
