// Makes the compiler lay out every type of layouts.txt by asking for its size. Compiled for the compiler's dump, never linked.
#include "engine/TCompareInstances.h"
#include "engine/TMasterInstance.h"
#include "host/TAddKeyBindingsToMapCallback.h"
#include "host/TAddKeyNamesToVectorCallback.h"
#include "host/TAddToVectorCallback.h"
#include "provider/TCallbackWrapClass.h"
#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespace.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "spec/TDiffClassRules.h"
#include "spec/TStateClass.h"
#include "spec/TStateDTS.h"
#include "spec/TStateExcludeList.h"
#include "spec/TStateIncludeList.h"
#include "spec/TStateStart.h"
#include "spec/TStateValue.h"

namespace NORVZEL20 {

template <class... T>
constexpr std::size_t kSizes = (sizeof(T) + ...);

using TParser = TCIMDiffEngine::TDiffXMLParser;

static_assert(kSizes<ICIMElement, ICIMNamedElement, ICIMClass, ICIMNamespace, INamespaceProvider, TZELException> > 0);
static_assert(kSizes<TAddToVectorCallback<ICIMClass>, TAddToVectorCallback<ICIMInstance>, TAddToVectorCallback<ICIMProperty>,
                     TAddToVectorCallback<ICIMPropertyDecl>, TAddKeyNamesToVectorCallback, TAddKeyBindingsToMapCallback> > 0);
static_assert(kSizes<TDeltaNamespaceProvider, TDeltaNamespace, TDeltaClass, TCallbackWrapClass> > 0);
static_assert(kSizes<TCIMDiffEngine, TCIMDiffEngine::TDiffClassRules, TCIMDiffEngine::TRuleset, TCIMDiffEngine::TMasterInstance,
                     TCIMDiffEngine::TCompareInstances> > 0);
static_assert(kSizes<TParser, TParser::TParseState, TParser::TStateStart, TParser::TStateDTS, TParser::TStateClass,
                     TParser::TStateIncludeList, TParser::TStateExcludeList, TParser::TStateValue> > 0);

}  // namespace NORVZEL20
