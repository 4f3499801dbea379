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
static_assert(kSizes<TZELStatusCode, TXmlParser> > 0);
static_assert(kSizes<TAddToVectorCallback<ICIMClass>, TAddToVectorCallback<ICIMInstance>, TAddToVectorCallback<ICIMProperty>,
                     TAddToVectorCallback<ICIMPropertyDecl>, TAddKeyNamesToVectorCallback, TAddKeyBindingsToMapCallback> > 0);
static_assert(kSizes<TDeltaNamespaceProvider, TDeltaNamespace, TDeltaClass, TCallbackWrapClass> > 0);
static_assert(kSizes<TCIMDiffEngine, TCIMDiffEngine::TDiffClassRules, TCIMDiffEngine::TRuleset, TCIMDiffEngine::TMasterInstance,
                     TCIMDiffEngine::TCompareInstances> > 0);
static_assert(kSizes<TParser, TParser::TParseState, TParser::TStateStart, TParser::TStateDTS, TParser::TStateClass,
                     TParser::TStateIncludeList, TParser::TStateExcludeList, TParser::TStateValue> > 0);

// The plug-in has values and paths in its own containers, so it knows their sizes.
static_assert(sizeof(TCIMValue) == 16 && alignof(TCIMValue) == 8);
static_assert(sizeof(TCIMValue::TCIMType) == 1);
static_assert(sizeof(TCIMReference) == sizeof(void*) && alignof(TCIMReference) == alignof(void*));
// It throws and catches these, and derives from the parser.
static_assert(sizeof(TZELStatusCode) == sizeof(int) && sizeof(TZELException) == 2 * sizeof(void*));
static_assert(sizeof(TXmlParser) == 2 * sizeof(void*));

}  // namespace NORVZEL20
