#pragma once

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// How the instances of one class are compared. A plain record; rules that a ruleset keeps are shared.
class TCIMDiffEngine::TDiffClassRules {
  public:
    /// Rules that exclude everything.
    TDiffClassRules();
    TDiffClassRules(propType def, std::map<std::string, propType> props, std::vector<std::string> excludedKeys);

    /// Takes over the default and the listed properties of `other` (not null), whose treatment prevails; properties listed here
    /// alone stay. Excluded keys are neither taken over nor lost.
    void updateRules(boost::shared_ptr<TDiffClassRules> other);

    /// Adds the names of a list separated by white space. Repeated names are kept.
    void excludeKeys(std::string list);

    bool hasExcludedKeys();

    /// Whether `name`, byte for byte, is among the excluded keys.
    bool isKeyExcluded(const std::string& name);

    std::string fClassName;                       ///< set while a specification is read; empty in a ruleset
    std::map<std::string, propType> fProperties;  ///< the listed properties
    propType fDefault;                            ///< every other property
    bool fFinal;                                  ///< the class's own rules are merged; later ones are ignored
    std::vector<std::string> fExcludedKeys;       ///< keys left out of an instance's identity, in the order read
};

}  // namespace NORVZEL20
