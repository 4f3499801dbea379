#pragma once

#include <map>
#include <string>
#include <vector>

#include "engine/TCIMDiffEngine.h"
#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespace.h"
#include "spec/TDiffXMLParser.h"

namespace NORVZEL20 {

/// Shows tests the state of the plug-in's objects that no operation returns. A friend of the types that are not installed.
struct TTestAccess {
    using TClassCache = std::vector<std::map<std::string, boost::shared_ptr<TDeltaClass>>>;

    static const std::string& SpecFileName(const TDeltaNamespace& ns);
    static const TClassCache& ClassCache(const TDeltaNamespace& ns);
    /// A wrapper holds its delta namespace, which holds the wrapper: forgetting the wrappers lets both go.
    static void ForgetWrappers(TDeltaNamespace& ns);
    static void PutWrapper(TDeltaNamespace& ns, std::size_t index, const std::string& name, boost::shared_ptr<TDeltaClass> wrapper);
    static const std::vector<boost::shared_ptr<ICIMNamespace>>& CompareList(const TDeltaNamespace& ns);
    static boost::shared_ptr<ICIMNamespace> Store(const TDeltaNamespace& ns);
    static void SetStore(TDeltaNamespace& ns, boost::shared_ptr<ICIMNamespace> store);

    static boost::shared_ptr<ICIMClass> WrappedClass(const TDeltaClass& cls) { return cls.fClass; }
    static const std::map<std::string, const TCIMReference>& Aliases(const TDeltaClass& cls) { return cls.fObjectPathAliases; }

    static TCIMDiffEngine::TRuleset& Ruleset(TCIMDiffEngine& engine) { return engine.ruleset; }

    static std::size_t StackSize(const TCIMDiffEngine::TDiffXMLParser& parser) { return parser.fStateStack.size(); }
    static const std::string& CharData(const TCIMDiffEngine::TDiffXMLParser& parser) { return parser.fCharData; }
    static boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> CurrentRules(const TCIMDiffEngine::TDiffXMLParser& parser)
    {
        return parser.fCurrentRules;
    }
};

}  // namespace NORVZEL20
