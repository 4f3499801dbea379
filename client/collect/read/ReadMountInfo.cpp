// The kernel's list of mounts. A line has six fields, any number of further ones up to a lone hyphen, and three behind it:
//
//   36 35 98:0 /mnt1 /mnt2 rw,noatime master:1 - ext3 /dev/root rw,errors=continue
//          folder^  ^path  ^options              ^type ^source ^options of the file system
//
// Blanks, tabs, line ends and backslashes within a field are a backslash and three octal digits.
#include "client/collect/read/ReadMountInfo.h"

#include <algorithm>

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"
#include "client/collect/read/WithoutPassword.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

std::string Unescaped(std::string_view text)
{
    std::string result;
    while (!text.empty()) {
        const std::optional<std::uint64_t> code =
            text[0] == '\\' && text.size() > 3 ? NumberIn(text.substr(1, 3), 8) : std::nullopt;
        const bool isCode = code && *code <= 0xFF;
        result += isCode ? static_cast<char>(*code) : text[0];
        text.remove_prefix(isCode ? 4 : 1);
    }
    return result;
}

std::vector<std::string> OptionsIn(std::string_view text)
{
    std::vector<std::string> options;
    for (const std::string_view option : SplitAt(text, ',')) {
        options.push_back(Unescaped(option));
    }
    return WithoutPasswords(options);
}

}  // namespace

std::vector<TMount> ReadMountInfo(std::string_view text, TReadFaults& faults)
{
    constexpr std::size_t kFirstOptional = 6;
    std::vector<TMount> mounts;
    TTextLines lines(text);
    while (lines.Next()) {
        // Two blanks with nothing between them are an empty source.
        const std::vector<std::string_view> fields = SplitAt(lines.GetLine(), ' ');
        const auto begin = fields.begin() + static_cast<std::ptrdiff_t>(std::min(kFirstOptional, fields.size()));
        const auto hyphen = std::find(begin, fields.end(), "-");
        if (fields.end() - hyphen < 4) {
            // The line is not shown: its source and options may hold a password.
            faults.Add(lines.GetNumber(), "found no mount, expected one with its type, source and options");
            continue;
        }
        mounts.push_back({Unescaped(fields[4]), Unescaped(hyphen[1]), WithoutPassword(Unescaped(hyphen[2])), Unescaped(fields[3]),
                          OptionsIn(fields[5]), OptionsIn(hyphen[3])});
    }
    return mounts;
}

}  // namespace NORVZEL20
