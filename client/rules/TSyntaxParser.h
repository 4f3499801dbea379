#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>

#include "client/rules/TRulesParser.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Reads rules without an inventory: every class and property that they name counts as declared, each class without superclass.
/// Everything else is as in TRulesParser.
class TSyntaxParser : public TRulesParser {
  public:
    TSyntaxParser();

    void StartElement(const char* name, std::map<std::string, std::string>& attrs) override;
    void EndElement(const char* name) override;

    /// The classes that the rules have named so far.
    const boost::shared_ptr<TInMemNamespace>& GetNamedClasses() const { return fClasses; }

  private:
    explicit TSyntaxParser(const boost::shared_ptr<TInMemNamespace>& classes);

    boost::shared_ptr<TInMemNamespace> fClasses;
};

}  // namespace NORVZEL20
