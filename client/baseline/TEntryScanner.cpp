#include "client/baseline/TEntryScanner.h"

#include <algorithm>
#include <utility>

#include "client/baseline/FindBadEscape.h"
#include "client/baseline/FindEndOfQuoted.h"
#include "client/baseline/ForEachUnquoted.h"
#include "client/process/TClientError.h"
#include "client/text/CutText.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

constexpr char kBlanks[] = " \t";
constexpr std::size_t kMostShown = 60;

}  // namespace

TEntryScanner::TEntryScanner(std::string_view text, std::string file, std::size_t line)
    : fText(text), fFile(std::move(file)), fLine(line)
{
    Advance();
}

std::string TEntryScanner::Take()
{
    std::string field = std::move(fField);
    Advance();
    return field;
}

void TEntryScanner::Advance()
{
    fBegin = std::min(fText.find_first_not_of(kBlanks, fEnd), fText.size());
    fEnd = fBegin;
    fField.clear();
    if (fBegin == fText.size() || fText[fBegin] == '#') {
        return;
    }
    fEnd = fText.size();
    const std::string_view rest = fText.substr(fBegin);
    int braces = 0;  // open ones: an array is one field, also as a key
    const std::size_t open = ForEachUnquoted(rest, [&](std::size_t at) {
        braces += rest[at] == '{' ? 1 : rest[at] == '}' ? -1 : 0;
        if (braces <= 0 && (rest[at] == ' ' || rest[at] == '\t')) {
            fEnd = fBegin + at;
            return false;
        }
        return true;
    });
    CheckQuotes(fBegin, fEnd, open);
    fField = fText.substr(fBegin, fEnd - fBegin);
}

// `open` is where ForEachUnquoted found a quote that is not closed.
void TEntryScanner::CheckQuotes(std::size_t begin, std::size_t end, std::size_t open) const
{
    if (open != std::string_view::npos) {
        RefusePlace(begin + open, "found a text without the quote at its end; a quote in a text has a \\ before it");
    }
    if (const std::size_t bad = FindBadEscape(fText.substr(begin, end - begin)); bad != std::string_view::npos) {
        RefusePlace(begin + bad, "found a \\ that begins no escape; write \\\\ for a backslash");
    }
}

std::size_t TEntryScanner::EndOfQuoted(std::size_t offset) const
{
    const std::size_t begin = fBegin + offset;
    const std::size_t end = FindEndOfQuoted(fText, begin);
    const bool isClosed = end != std::string_view::npos;
    CheckQuotes(begin, isClosed ? end + 1 : begin, isClosed ? std::string_view::npos : 0);
    return end + 1 - fBegin;
}

std::string_view TEntryScanner::GetRest() const
{
    return fField.empty() ? std::string_view() : fText.substr(fBegin);
}

void TEntryScanner::Skip(std::size_t length)
{
    fEnd = fBegin + length;
    Advance();
}

std::string TEntryScanner::GetReason() const
{
    const std::size_t begin = fText.find_first_not_of(kBlanks, std::min(fBegin + 1, fText.size()));
    if (begin == std::string_view::npos) {
        return std::string();
    }
    return std::string(fText.substr(begin, fText.find_last_not_of(kBlanks) + 1 - begin));
}

void TEntryScanner::Refuse(const std::string& expected) const
{
    RefuseFound(fBegin, fField.empty() ? WordAt(fBegin) : fField, expected);
}

void TEntryScanner::RefuseAt(std::size_t offset, const std::string& expected) const
{
    const std::string_view rest = GetRest();
    const std::size_t begin = std::min(rest.find_first_not_of(kBlanks, offset), rest.size());
    RefuseFound(fBegin + begin, WordAt(fBegin + begin), expected);
}

// Empty at the end and at the # of a reason, which has a blank in front.
std::string TEntryScanner::WordAt(std::size_t position) const
{
    const std::string_view rest = fText.substr(position);
    const bool isReason = rest.substr(0, 1) == "#" && fText.substr(0, position).find_last_of(kBlanks) + 1 == position;
    return isReason ? std::string() : std::string(rest.substr(0, rest.find_first_of(kBlanks)));
}

void TEntryScanner::RefuseFound(std::size_t position, const std::string& field, const std::string& expected) const
{
    const std::string found = field.empty() ? "the end of the entry" : EscapeForDisplay(CutText(field, kMostShown));
    RefusePlace(position, "found " + found + ", expected " + expected);
}

void TEntryScanner::RefusePlace(std::size_t position, const std::string& what) const
{
    throw TClientError(fFile + ":" + std::to_string(fLine) + ":" + std::to_string(position + 1) + ": " + what);
}

}  // namespace NORVZEL20
