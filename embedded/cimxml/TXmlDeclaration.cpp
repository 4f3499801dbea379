#include "embedded/cimxml/TXmlDeclaration.h"

#include <algorithm>
#include <cstddef>
#include <string_view>

#include "embedded/cimxml/TXmlCharacter.h"

namespace NORVZEL20 {

namespace {

/// Removes the blanks at the beginning; returns whether there were any.
bool TakeBlanks(std::string_view& text)
{
    std::size_t count = 0;
    while (count < text.size() && TXmlCharacter::IsBlank(text[count])) {
        ++count;
    }
    text.remove_prefix(count);
    return count > 0;
}

bool Take(std::string_view& text, std::string_view beginning)
{
    const bool isThere = text.substr(0, beginning.size()) == beginning;
    text.remove_prefix(isThere ? beginning.size() : 0);
    return isThere;
}

/// Removes `name = "value"` and returns the value; empty if that is not there.
std::string_view TakePart(std::string_view& text, std::string_view name)
{
    if (!Take(text, name)) {
        return {};
    }
    TakeBlanks(text);
    if (!Take(text, "=")) {
        return {};
    }
    TakeBlanks(text);
    const std::size_t close = text.empty() || (text[0] != '"' && text[0] != '\'') ? std::string_view::npos : text.find(text[0], 1);
    if (close == std::string_view::npos) {
        return {};
    }
    const std::string_view value = text.substr(1, close - 1);
    text.remove_prefix(close + 1);
    return value;
}

bool IsUtf8(std::string_view encoding)
{
    constexpr std::string_view kName = "utf-8";
    return std::equal(encoding.begin(), encoding.end(), kName.begin(), kName.end(),
                      [](char c, char lower) { return (c >= 'A' && c <= 'Z' ? static_cast<char>(c | 0x20) : c) == lower; });
}

/// Whether `text`, what stands between "<?xml" and "?>", is accepted.
bool IsAccepted(std::string_view text)
{
    if (!TakeBlanks(text) || TakePart(text, "version") != "1.0") {
        return false;
    }
    bool isApart = TakeBlanks(text);
    if (isApart && text.substr(0, 1) == "e") {
        if (!IsUtf8(TakePart(text, "encoding"))) {
            return false;
        }
        isApart = TakeBlanks(text);
    }
    if (isApart && text.substr(0, 1) == "s") {
        const std::string_view standalone = TakePart(text, "standalone");
        if (standalone != "yes" && standalone != "no") {
            return false;
        }
        TakeBlanks(text);
    }
    return text.empty();
}

}  // namespace

EXmlScan TXmlDeclaration::Pass(const char*& at, const char* end) noexcept
{
    constexpr std::size_t kLongest = 256;
    constexpr std::string_view kBegin = "<?xml";
    constexpr std::string_view kClose = "?>";
    const std::string_view text(at, std::min<std::size_t>(static_cast<std::size_t>(end - at), kLongest));
    if (text.size() == 1 && TXmlCharacter::IsBlank(text.front())) {
        return EXmlScan::kRefused;  // what the first bytes say of the encoding depends on whether Expat gets this one alone
    }
    if (text.substr(0, kBegin.size()) != kBegin.substr(0, text.size())) {
        return EXmlScan::kAccepted;  // another token
    }
    const std::size_t close = text.find(kClose);
    if (close == std::string_view::npos) {
        return text.size() < kLongest ? EXmlScan::kCutOff : EXmlScan::kRefused;
    }
    if (close < kBegin.size() || !IsAccepted(text.substr(kBegin.size(), close - kBegin.size()))) {
        return EXmlScan::kRefused;
    }
    at += close + kClose.size();
    return EXmlScan::kAccepted;
}

EXmlScan TXmlDeclaration::FindNext(const char* at, const char* end) noexcept
{
    constexpr std::string_view kBegin = "<?xml";
    const std::string_view bytes(at, static_cast<std::size_t>(end - at));
    for (const std::string_view mark : {"\xef\xbb\xbf", "\xfe\xff", "\xff\xfe"}) {
        if (bytes.substr(0, mark.size()) == mark) {
            return EXmlScan::kAccepted;
        }
        if (!bytes.empty() && mark.substr(0, bytes.size()) == bytes) {
            return EXmlScan::kCutOff;
        }
    }
    if (bytes.empty() || bytes[0] != '<') {
        return EXmlScan::kRefused;
    }
    if (bytes.size() <= kBegin.size() && kBegin.substr(0, bytes.size()) == bytes) {
        return EXmlScan::kCutOff;
    }
    const char next = bytes[1];
    const bool isTag = (next >= 'A' && next <= 'Z') || (next >= 'a' && next <= 'z') || next == '_' || next == ':';
    const bool isDeclaration = bytes.substr(0, kBegin.size()) == kBegin && TXmlCharacter::IsBlank(bytes[kBegin.size()]);
    return isTag || isDeclaration ? EXmlScan::kAccepted : EXmlScan::kRefused;
}

}  // namespace NORVZEL20
