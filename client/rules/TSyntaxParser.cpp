// The plug-in's parser asks its schema for each class and property that the rules name. Here the schema is a namespace that gets
// them just before they are asked for. What no schema can declare stays undeclared, and so is refused: an empty name, and a
// property of the pseudo-class above all classes.
#include "client/rules/TSyntaxParser.h"

#include "host/RootClassName.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

TSyntaxParser::TSyntaxParser() : TSyntaxParser(TInMemNamespace::Create("root/cimv2")) {}

TSyntaxParser::TSyntaxParser(const boost::shared_ptr<TInMemNamespace>& classes) : TRulesParser(classes), fClasses(classes) {}

void TSyntaxParser::StartElement(const char* name, std::map<std::string, std::string>& attrs)
{
    const auto named = attrs.find("name");
    const bool isName = IsInRoot() && named != attrs.end() && !named->second.empty() && named->second != kRootClassName;
    if (isName && !fClasses->FindClass(named->second)) {
        fClasses->AllocateInMemClass(named->second, nullptr)->AddToNamespace(TCallContext());
    }
    TRulesParser::StartElement(name, attrs);
}

void TSyntaxParser::EndElement(const char* name)
{
    const boost::shared_ptr<TInMemClass> cls = IsInValue() ? fClasses->FindClass(fCurrentRules->fClassName) : nullptr;
    if (cls && !fCharData.empty() && !cls->FindPropertyDecl(fCharData)) {
        cls->AddPropertyDecl(cls->AllocatePropertyDecl(fCharData, TCIMValue(""), TCallContext()));
    }
    TRulesParser::EndElement(name);
}

}  // namespace NORVZEL20
