#include "client/files/HttpLines.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <cctype>

namespace NORVZEL20 {

namespace {

bool IsBlankOf(char c)
{
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// What editors and recorders may put in front of a file: a byte order mark, and empty lines.
std::size_t FindFirstLine(std::string_view beginning)
{
    const std::size_t mark = boost::algorithm::starts_with(beginning, kByteOrderMark) ? kByteOrderMark.size() : 0;
    return std::min(beginning.find_first_not_of("\r\n", mark), beginning.size());
}

}  // namespace

std::size_t FindHeaderName(std::string_view line)
{
    const std::string_view signs = "!#$%&'*+-.^_`|~";
    std::size_t length = 0;
    while (length < line.size() &&
           (std::isalnum(static_cast<unsigned char>(line[length])) != 0 || signs.find(line[length]) != std::string_view::npos)) {
        ++length;
    }
    return length < line.size() && line[length] == ':' ? length : 0;
}

bool IsFirstHeader(std::string_view line)
{
    const std::string_view name = line.substr(0, FindHeaderName(line));
    const auto isOfWord = [](char c) { return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '-'; };
    return name.size() > 1 && std::isalpha(static_cast<unsigned char>(name[0])) != 0 &&
           std::all_of(name.begin(), name.end(), isOfWord);
}

bool IsRequestLine(std::string_view line)
{
    return boost::algorithm::starts_with(line, "POST ") || boost::algorithm::starts_with(line, "M-POST ");
}

std::string_view FindChunkLength(std::string_view line)
{
    std::size_t length = 0;
    while (length < line.size() && std::isxdigit(static_cast<unsigned char>(line[length])) != 0) {
        ++length;
    }
    const bool ends = length == line.size() || line[length] == ';' || IsBlankOf(line[length]);
    return ends && length <= kMostDigitsOfLength ? line.substr(0, length) : std::string_view();
}

bool IsHttp(std::string_view file)
{
    const std::string_view beginning = file.substr(FindFirstLine(file));
    if (boost::algorithm::starts_with(beginning, "HTTP/") || IsRequestLine(beginning) || IsFirstHeader(beginning)) {
        return true;
    }
    // A length alone could be anything, so it must be in front of XML.
    const std::string_view digits = FindChunkLength(beginning.substr(0, beginning.find('\n')));
    const std::size_t next = beginning.find('\n');
    return !digits.empty() && next != std::string_view::npos && beginning.substr(next + 1, 1) == "<";
}

}  // namespace NORVZEL20
