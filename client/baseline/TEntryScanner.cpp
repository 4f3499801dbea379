#include "client/baseline/TEntryScanner.h"

#include <algorithm>
#include <utility>

#include "client/baseline/ForEachUnquoted.h"
#include "client/process/TClientError.h"
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
    const std::size_t open = ForEachUnquoted(rest, [&](std::size_t at) {
        if (rest[at] == ' ' || rest[at] == '\t') {
            fEnd = fBegin + at;
            return false;
        }
        return true;
    });
    if (open != std::string_view::npos) {
        RefuseAt(fBegin + open, "found a text without the quote at its end; a quote in a text has a \\ before it");
    }
    fField = fText.substr(fBegin, fEnd - fBegin);
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
    const bool isCut = fField.size() > kMostShown;
    const std::string found =
        fField.empty() ? "the end of the entry" : EscapeForDisplay(fField.substr(0, kMostShown)) + (isCut ? "..." : "");
    RefuseAt(fBegin, "found " + found + ", expected " + expected);
}

void TEntryScanner::RefuseAt(std::size_t position, const std::string& what) const
{
    throw TClientError(fFile + ":" + std::to_string(fLine) + ":" + std::to_string(position + 1) + ": " + what);
}

}  // namespace NORVZEL20
