#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/rules/TRulesDocument.h"
#include "client/rules/TRulesText.h"
#include "engine/TCIMDiffEngine.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

/// Rules as the plug-in's own parser reads them, and the plug-in's own answers to what follows from them.
class TRules {
  public:
    /// `schema` is the reference. Errors: TClientError that names the rules, the line, what is wrong there and what can be done.
    TRules(boost::shared_ptr<ICIMNamespace> schema, const TRulesText& text);
    TRules(const TRules&) = delete;
    TRules& operator=(const TRules&) = delete;

    /// The properties to compare; empty if the class's instances are not compared.
    std::vector<std::string> PropertiesOf(const boost::shared_ptr<ICIMClass>& cls);

    /// The key under which an instance of class `className` is matched.
    std::string KeyOf(const std::string& className, const boost::shared_ptr<ICIMInstance>& instance);

    /// Whether the engine takes two values of a property of class `className` for different. The first one stands in the place of
    /// the reference's: if it is a bag, the order of the elements does not count. True for values that the engine refuses.
    bool Differ(const std::string& className, const TCIMValue& reference, const TCIMValue& other);

    /// The same number for values of one type that do not differ.
    std::size_t HashOf(const std::string& className, const TCIMValue& value);

    /// Whether the engine refuses to compare two such values: a reference with a value of another type.
    bool Refuse(const std::string& className, const TCIMValue& reference, const TCIMValue& other);

    /// The class's excluded keys, in the order of the rules.
    const std::vector<std::string>& ExcludedKeysOf(const std::string& className);

    /// Whether the rules of the class leave a key of that name out, of its instances and of the references that they hold.
    bool ExcludesKey(const std::string& className, const std::string& key);

    /// Whether an element of the file gives the class rules, its own or those of a class above it. Names count byte for byte.
    bool Reach(const std::string& className) const;

    /// Whether any class excludes any key.
    bool HasExcludedKeys() const;

    /// The rules as the plug-in reads them.
    const std::string& GetText() const { return fText; }

    /// What the rules say, element by element.
    const TRulesDocument& GetDocument() const { return fDocument; }

  private:
    boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> Find(const std::string& className);

    std::vector<boost::shared_ptr<ICIMNamespace>> fSchemas;
    TCIMDiffEngine fEngine;
    TCIMDiffEngine::TRuleset fRuleset;
    TRulesDocument fDocument;
    std::string fText;
    std::string fFoundName;  // the class looked up last; instances come class by class
    boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> fFound;
};

}  // namespace NORVZEL20
