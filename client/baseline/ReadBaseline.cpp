#include "client/baseline/ReadBaseline.h"

#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <utility>
#include <vector>

#include "client/baseline/FindBadCharacter.h"
#include "client/baseline/ParseEntry.h"
#include "client/files/TInputFile.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "client/text/QuoteForShell.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kBlockSize = 64 * 1024;
constexpr std::size_t kMostBytes = static_cast<std::size_t>(1) << 30;
constexpr char kByteOrderMark[] = "\xEF\xBB\xBF";
constexpr char kMergeAdvice[] = " of a merge that is not finished; keep the entries of both sides, but one for a difference, "
                                "and remove the lines with the marks, and those between ||||||| and =======";

// The mark of a merge conflict at the beginning of the line; null if there is none.
const char* FindMergeMark(std::string_view text)
{
    for (const char* const mark : {"<<<<<<<", "|||||||", "=======", ">>>>>>>"}) {
        if (text.find(mark) == 0) {
            return mark;
        }
    }
    return nullptr;
}

// Whether the line is the mark of a baseline, of whatever version.
bool IsMark(std::string_view text)
{
    return text.substr(0, text.find_first_of(" \t")) == kBaselineMark;
}

// Reads a file line by line.
class TBaselineParser {
  public:
    explicit TBaselineParser(std::string file) : fFile(std::move(file)) {}

    void AddLine(std::string_view text)
    {
        ++fLine;
        const std::size_t end = text.find_last_not_of(" \t\r");
        CheckCharacters(text.substr(0, end + 1));
        const std::size_t begin = text.find_first_not_of(" \t");
        if (end == std::string_view::npos) {
            return EndComments();
        }
        text = text.substr(0, end + 1);
        if (text[begin] == '#') {
            fComments.emplace_back(text.substr(begin));
        } else if (const char* const mark = FindMergeMark(text)) {
            Refuse(1, "found " + std::string(mark) + kMergeAdvice);
        } else if (IsMark(text.substr(begin))) {
            CheckVersion(text.substr(begin + sizeof kBaselineMark - 1), begin + sizeof kBaselineMark);
        } else {
            AddEntry(text);
        }
    }

    TBaseline Take()
    {
        if (!fHasMark) {
            fLine = 1;
            RefuseWithoutMark();
        }
        EndComments();
        return std::move(fBaseline);
    }

  private:
    [[noreturn]] void Refuse(std::size_t column, const std::string& what) const
    {
        throw TClientError(fFile + ":" + std::to_string(fLine) + ":" + std::to_string(column) + ": " + what);
    }

    [[noreturn]] void RefuseWithoutMark() const
    {
        Refuse(1, "found no line \"" + std::string(kBaselineMark) + " " + kBaselineVersion +
                      "\" in front, expected a baseline; make one with --accept");
    }

    void CheckCharacters(std::string_view text) const
    {
        const std::size_t bad = FindBadCharacter(text);
        if (bad == text.size()) {
            return;
        }
        const std::string shown = EscapeForDisplay(text.substr(bad, 1));
        Refuse(bad + 1, bad == TUtf8::FindInvalid(text)
                            ? "found the byte " + shown + ", which is no UTF-8; save the file as UTF-8"
                            : "found the control character " + shown + "; remove it, or write it within quotes as " + shown);
    }

    // Comments with a blank line behind them belong to the file. Files that were joined have the same ones.
    void EndComments()
    {
        for (std::string& comment : fComments) {
            const std::vector<std::string>& known = fBaseline.GetComments();
            if (std::find(known.begin(), known.end(), comment) == known.end()) {
                fBaseline.AddComment(std::move(comment));
            }
        }
        fComments.clear();
    }

    void CheckVersion(std::string_view rest, std::size_t column)
    {
        const std::size_t begin = rest.find_first_not_of(" \t");
        const std::string_view version = begin == std::string_view::npos ? std::string_view() : rest.substr(begin);
        if (version != kBaselineVersion) {
            Refuse(column + (begin == std::string_view::npos ? 0 : begin),
                   "found version " + QuoteForDisplay(version) + " of baselines, expected " + kBaselineVersion +
                       "; use a cimdelta that knows it, or make the file anew with --accept");
        }
        fHasMark = true;
    }

    void AddEntry(std::string_view text)
    {
        if (!fHasMark) {
            RefuseWithoutMark();
        }
        TAcceptedDifference entry = ParseEntry(text, fFile, fLine);
        entry.comments = std::move(fComments);
        fComments.clear();
        if (const std::optional<std::size_t> other = fBaseline.Add(std::move(entry))) {
            const TAcceptedDifference& earlier = fBaseline.GetEntries()[*other];
            Refuse(1, "found another value for an inventory that line " + std::to_string(earlier.line) +
                          " has, expected one value; keep one of the two lines");
        }
    }

    const std::string fFile;
    std::size_t fLine = 0;
    bool fHasMark = false;
    std::vector<std::string> fComments;  // those that may belong to the next entry
    TBaseline fBaseline;
};

std::string ReadText(const std::string& path)
{
    TInputFile file(path);
    std::string text;
    std::vector<char> block(kBlockSize);
    while (const std::size_t count = file.Read(block.data(), block.size())) {
        text.append(block.data(), count);
        if (text.size() > kMostBytes) {
            throw TClientError(path + ": is larger than " + std::to_string(kMostBytes) +
                               " bytes, the most that a baseline may have");
        }
    }
    return text;
}

}  // namespace

TBaseline ParseBaseline(std::string_view text, const std::string& file)
{
    if (text.substr(0, sizeof kByteOrderMark - 1) == kByteOrderMark) {
        text.remove_prefix(sizeof kByteOrderMark - 1);
    }
    TBaselineParser parser(file);
    while (!text.empty()) {
        const std::size_t end = text.find('\n');
        parser.AddLine(text.substr(0, end));
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    }
    return parser.Take();
}

void CheckBaseline(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) != 0 && errno == ENOENT) {
        throw TClientError(path + ": there is no such file; make it with --accept " + QuoteForShell(path) +
                           " in place of --baseline, which accepts the present differences");
    }
    const TInputFile readable(path);
}

TBaseline ReadBaseline(const std::string& path)
{
    return ParseBaseline(ReadText(path), path);
}

TBaseline ReadBaselineIfAny(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) != 0) {
        return TBaseline();
    }
    // What cannot be replaced is not read either: a pipe would be waited for.
    if (!S_ISREG(status.st_mode)) {
        throw TClientError(path + ": is no ordinary file; name one that accepted differences can be kept in");
    }
    // An empty one has been made for it, by mktemp for instance.
    return status.st_size == 0 ? TBaseline() : ReadBaseline(path);
}

}  // namespace NORVZEL20
