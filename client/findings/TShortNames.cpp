#include "client/findings/TShortNames.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <iterator>

#include "client/findings/FindTellingKey.h"
#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"
#include "client/text/InlineText.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

bool IsText(const TCIMValue& value)
{
    return value.GetType() == TCIMValue::TCIMType::kString && !value.IsNull();
}

// CIM's schema has such keys in many classes: CreationClassName, SystemCreationClassName.
bool RepeatsClass(const std::string& key)
{
    return boost::algorithm::iends_with(key, "CreationClassName");
}

}  // namespace

std::string TShortNames::Of(const TDifference& difference)
{
    if (difference.keys.empty()) {
        return difference.hasKeys ? "(any instance)" : "(the only instance)";
    }
    if (fAreWhole) {
        return EscapeForDisplay(difference.GetKeyText());
    }
    const TKeys left = KeysLeft(difference.className, difference.keys);
    if (left.size() > 1) {
        const std::string& telling = TellingKey(difference.className, left);
        const auto found = std::find_if(left.begin(), left.end(), [&telling](const auto& key) { return key.first == telling; });
        if (found != left.end() && IsText(found->second)) {
            return InlineText(found->second);
        }
    }
    return Join(difference.className, left);
}

const TDistinctKeys& TShortNames::Distinct(const std::string& className)
{
    const auto known = fClasses.find(className);
    return known != fClasses.end() ? known->second : fClasses.try_emplace(className, fInventories, className).first->second;
}

// The keys that are left are the same for all instances of the class.
const std::string& TShortNames::TellingKey(const std::string& className, const TKeys& left)
{
    const auto known = fTellingKeys.find(className);
    if (known != fTellingKeys.end()) {
        return known->second;
    }
    std::vector<std::string> names;
    for (const auto& key : left) {
        names.push_back(key.first);
    }
    return fTellingKeys.emplace(className, FindTellingKey(fInventories, className, names)).first->second;
}

// If all keys are common, there is only one instance. It then goes by the keys that do not merely repeat a class.
TShortNames::TKeys TShortNames::KeysLeft(const std::string& className, const TKeys& keys)
{
    const TDistinctKeys& distinct = Distinct(className);
    TKeys left;
    for (const auto& key : keys) {
        if (!distinct.IsCommon(key.first, key.second)) {
            left.push_back(key);
        }
    }
    if (left.empty()) {
        std::copy_if(keys.begin(), keys.end(), std::back_inserter(left), [](const auto& key) { return !RepeatsClass(key.first); });
    }
    return left.empty() ? keys : left;
}

std::string TShortNames::Join(const std::string& className, const TKeys& left)
{
    const TDistinctKeys& distinct = Distinct(className);
    if (left.size() == 1 && IsText(left.front().second)) {
        return Text(distinct, left.front().first, left.front().second);
    }
    std::string name;
    for (const auto& [key, value] : left) {
        name += (name.empty() ? "" : ",") + EscapeForDisplay(key) + "=" + Text(distinct, key, value);
    }
    return name;
}

// A reference into the inventory itself by the short name of its instance, behind the name of its class if that is not always the
// same.
std::string TShortNames::Text(const TDistinctKeys& distinct, const std::string& key, const TCIMValue& value)
{
    if (value.IsNull() || value.GetType() != TCIMValue::TCIMType::kReference) {
        return InlineText(value);
    }
    const TCIMReference path = value;
    TKeys keys;
    path.EnumerateKeyBindings([&keys](const std::pair<std::string, TCIMValue>& binding) {
        keys.push_back(binding);
        return true;
    });
    if (keys.empty() || !path.GetNamespaceName().empty() || !path.GetHost().empty()) {
        return DisplayContents(value);
    }
    const std::string name = Join(path.GetClassName(), KeysLeft(path.GetClassName(), keys));
    // Several keys of its own stand in brackets, so that they are not taken for those around it.
    const std::string inner = name.find(',') == std::string::npos ? name : "(" + name + ")";
    return distinct.HasCommonClass(key) ? inner : EscapeForDisplay(path.GetClassName()) + ":" + inner;
}

}  // namespace NORVZEL20
