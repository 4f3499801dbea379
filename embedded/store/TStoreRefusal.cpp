#include "embedded/store/TStoreRefusal.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/value/TValueText.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestPath = 200;

/// Whether the byte continues a character of UTF-8.
bool IsContinuation(char c) noexcept
{
    return (static_cast<unsigned char>(c) & 0xC0U) == 0x80U;
}

}  // namespace

TStoreRefusal::~TStoreRefusal() noexcept = default;

boost::shared_ptr<const std::string> TStoreRefusal::Compose(const std::string& refused) const
{
    return boost::make_shared<const std::string>(std::string(TZELException::what()) + ": " + refused);
}

std::string TStoreRefusal::Shown(TCIMReference path)
{
    path.SetNamespaceName("");
    path.SetHost("");
    std::string text = path.ToText();
    if (text.size() <= kLongestPath) {
        return text;
    }
    std::size_t end = kLongestPath;
    while (end > 0 && IsContinuation(text[end])) {
        --end;
    }
    return text.substr(0, end) + "...";
}

std::string TStoreRefusal::OfOtherType(TCIMValue::TCIMType type, TCIMValue::TCIMType refused)
{
    return " is " + TValueText::DescribeType(type) + ", not " + TValueText::DescribeType(refused);
}

}  // namespace NORVZEL20
