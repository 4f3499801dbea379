#pragma once

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// How the instances of one class are compared: which properties are compared, and which keys identify an instance.
class TCIMDiffEngine::TDiffClassRules {
  public:
    /// Rules that exclude everything.
    TDiffClassRules();
    TDiffClassRules(propType def, std::map<std::string, propType> props, std::vector<std::string> excludedKeys);

    /// Takes over the default and the listed properties of `other`, which must not be null. If both list a property, `other`
    /// prevails. The excluded keys stay as they are; those of `other` are not taken over.
    void updateRules(boost::shared_ptr<TDiffClassRules> other);

    /// Adds the names in `list`, which are separated by white space, to the excluded keys. Repeated names are kept.
    void excludeKeys(std::string list);

    bool hasExcludedKeys();

    /// Whether `name`, byte for byte, is among the excluded keys.
    bool isKeyExcluded(const std::string& name);

    std::string fClassName;                       ///< set while a specification is read; empty in a ruleset
    std::map<std::string, propType> fProperties;  ///< the properties listed by name
    propType fDefault;                            ///< the treatment of all other properties
    bool fFinal;                                  ///< later rules are ignored (see TRuleset::addToRuleset)
    std::vector<std::string> fExcludedKeys;       ///< keys by which instances are not matched, in the order read
};

}  // namespace NORVZEL20
