// The client must not guess what rules mean: the plug-in's own parser reads them, and the plug-in's own engine answers what they
// compare.

#include "client/rules/TRules.h"

#include <algorithm>
#include <functional>

#include "client/inventory/HashValue.h"
#include "client/rules/TRulesParser.h"
#include "host/TCIMReference.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

TRules::TRules(boost::shared_ptr<ICIMNamespace> schema, const TRulesText& text)
    // With a single namespace the engine neither checks operating systems nor reads a file; it only answers questions.
    : fSchemas(1, schema), fEngine(boost::shared_ptr<ICIMNamespace>(), fSchemas, std::string())
{
    TRulesParser parser(schema);
    parser.Read(text);
    fRuleset = parser.getRuleset();
    fDocument = parser.GetDocument();
    fText = text.text;
}

std::vector<std::string> TRules::PropertiesOf(const boost::shared_ptr<ICIMClass>& cls)
{
    return fEngine.buildPropList(Find(cls->GetName(TCallContext())), cls);
}

std::string TRules::KeyOf(const std::string& className, const boost::shared_ptr<ICIMInstance>& instance)
{
    return fEngine.buildPath(Find(className), instance);
}

bool TRules::Differ(const std::string& className, const TCIMValue& reference, const TCIMValue& other)
{
    // It refuses no values of one type.
    const bool isRefused = reference.GetType() != other.GetType() && Refuse(className, reference, other);
    return isRefused || fEngine.IsDifferent(Find(className), reference, other);
}

std::size_t TRules::HashOf(const std::string& className, const TCIMValue& value)
{
    if (value.IsNull() || value.GetType() != TCIMValue::TCIMType::kReference) {
        return HashValue(value);
    }
    const TCIMReference path = value;
    return std::hash<std::string>()(fEngine.buildPath(Find(className), path));
}

bool TRules::Refuse(const std::string& className, const TCIMValue& reference, const TCIMValue& other)
{
    try {
        fEngine.IsDifferent(Find(className), reference, other);
        return false;
    } catch (const TZELException& error) {
        if (error.GetStatusCode() != TZELStatusCode::kTypeMismatch) {
            throw;
        }
        return true;
    }
}

const std::vector<std::string>& TRules::ExcludedKeysOf(const std::string& className)
{
    return Find(className)->fExcludedKeys;
}

bool TRules::ExcludesKey(const std::string& className, const std::string& key)
{
    return Find(className)->isKeyExcluded(key);
}

bool TRules::Reach(const std::string& className) const
{
    return fRuleset.fRules.count(className) > 0;
}

bool TRules::HasExcludedKeys() const
{
    return std::any_of(fRuleset.fRules.begin(), fRuleset.fRules.end(),
                       [](const auto& entry) { return entry.second->hasExcludedKeys(); });
}

boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> TRules::Find(const std::string& className)
{
    // A look-up costs a search by name, and keys are asked for instance by instance.
    if (!fFound || fFoundName != className) {
        fFound = fRuleset.getClassRules(className);
        fFoundName = className;
    }
    return fFound;
}

}  // namespace NORVZEL20
