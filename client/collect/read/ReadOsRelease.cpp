#include "client/collect/read/ReadOsRelease.h"

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

// A value is written as in a shell script: alone, or in quotation marks with a backslash in front of some characters.
std::string ShellValue(std::string_view text)
{
    const char mark = text.empty() ? '\0' : text[0];
    const bool isQuoted = mark == '"' || mark == '\'';
    if (isQuoted) {
        text.remove_prefix(1);
    }
    std::string value;
    while (!text.empty() && !(isQuoted && text[0] == mark)) {
        if (text[0] == '\\' && mark != '\'' && text.size() > 1) {
            text.remove_prefix(1);
        }
        value += text[0];
        text.remove_prefix(1);
    }
    return value;
}

}  // namespace

std::map<std::string, std::string> ReadOsRelease(std::string_view text)
{
    std::map<std::string, std::string> values;
    TTextLines lines(text);
    while (lines.Next()) {
        const std::string_view line = Trimmed(lines.GetLine());
        const std::size_t equals = line.find('=');
        if (equals != std::string_view::npos && line[0] != '#') {
            values[std::string(line.substr(0, equals))] = ShellValue(line.substr(equals + 1));
        }
    }
    return values;
}

}  // namespace NORVZEL20
