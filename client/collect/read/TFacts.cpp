#include "client/collect/read/TFacts.h"

#include <ctime>

#include "client/collect/read/ValidText.h"
#include "host/TCIMDateTime.h"

namespace NORVZEL20 {

TFacts& TFacts::Add(const char* name, TCIMValue value)
{
    fValues.emplace_back(name, std::move(value));
    return *this;
}

TFacts& TFacts::Text(const char* name, std::string_view text)
{
    return text.empty() ? *this : Key(name, text);
}

TFacts& TFacts::Key(const char* name, std::string_view text)
{
    return Add(name, TCIMValue(ValidText(text)));
}

TFacts& TFacts::Number(const char* name, std::uint64_t number)
{
    return Add(name, TCIMValue(number));
}

TFacts& TFacts::Signed(const char* name, std::int64_t number)
{
    return Add(name, TCIMValue(number));
}

TFacts& TFacts::Flag(const char* name, bool flag)
{
    return Add(name, TCIMValue(flag));
}

TFacts& TFacts::Texts(const char* name, const std::vector<std::string>& texts)
{
    std::vector<TCIMValue> values;
    values.reserve(texts.size());
    for (const std::string& text : texts) {
        values.emplace_back(ValidText(text));
    }
    return Add(name, TCIMValue(TCIMValue::TCIMType::kString, static_cast<unsigned int>(values.size()), values));
}

TFacts& TFacts::Time(const char* name, std::int64_t seconds)
{
    const std::time_t time = seconds;
    std::tm parts{};
    char text[64];
    TCIMDateTime value;
    if (gmtime_r(&time, &parts) == nullptr || std::strftime(text, sizeof text, "%Y%m%d%H%M%S.000000+000", &parts) == 0 ||
        !TCIMDateTime::Parse(text, value)) {
        return *this;  // a year that a datetime cannot hold
    }
    return Add(name, TCIMValue(value));
}

TCIMValue TFacts::Find(std::string_view name) const
{
    for (const TValue& value : fValues) {
        if (name == value.first) {
            return value.second;
        }
    }
    return TCIMValue();
}

}  // namespace NORVZEL20
