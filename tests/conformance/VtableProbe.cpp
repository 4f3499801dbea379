// Makes the compiler lay out the virtual table of every type whose order of operations is part of the contract. A destructor sets
// the table of its class, so each probe has one. Compiled for the compiler's dump, never linked.
#include "embedded/store/TInMemNamedElement.h"
#include "embedded/value/TStubClass.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"
#include "host/ICIMProperty.h"
#include "host/ICIMPropertyDecl.h"
#include "host/ILogger.h"
#include "host/INamespaceProvider.h"
#include "host/INamespaceProviderManager.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TXmlParser.h"
#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespace.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "spec/TStateClass.h"
#include "spec/TStateDTS.h"
#include "spec/TStateExcludeList.h"
#include "spec/TStateIncludeList.h"
#include "spec/TStateStart.h"
#include "spec/TStateValue.h"

namespace NORVZEL20 {

// The dump names a table by its class alone, so each probe needs its own name.
#define PROBE(name, type)                                                                                                          \
    struct TProbeOf##name : type {                                                                                                 \
        ~TProbeOf##name() override;                                                                                                \
    };                                                                                                                             \
    TProbeOf##name::~TProbeOf##name() = default

using TParser = TCIMDiffEngine::TDiffXMLParser;

PROBE(ICIMElement, ICIMElement);
PROBE(ICIMNamedElement, ICIMNamedElement);
PROBE(ICIMClass, ICIMClass);
PROBE(ICIMNamespace, ICIMNamespace);
PROBE(ICIMInstance, ICIMInstance);
PROBE(ICIMProperty, ICIMProperty);
PROBE(ICIMPropertyDecl, ICIMPropertyDecl);
PROBE(ILogger, ILogger);
PROBE(INamespaceProvider, INamespaceProvider);
PROBE(INamespaceProviderManager, INamespaceProviderManager);
PROBE(TNamespaceProviderManager, TNamespaceProviderManager);
PROBE(TXmlParser, TXmlParser);
PROBE(TInMemNamedElement, TInMemNamedElement<ICIMClass>);
PROBE(TStubClass, TStubClass);
PROBE(TDeltaNamespaceProvider, TDeltaNamespaceProvider);
PROBE(TDeltaNamespace, TDeltaNamespace);
PROBE(TDeltaClass, TDeltaClass);
PROBE(TDiffXMLParser, TParser);
PROBE(TParseState, TParser::TParseState);
PROBE(TStateStart, TParser::TStateStart);
PROBE(TStateDTS, TParser::TStateDTS);
PROBE(TStateClass, TParser::TStateClass);
PROBE(TStateIncludeList, TParser::TStateIncludeList);
PROBE(TStateExcludeList, TParser::TStateExcludeList);
PROBE(TStateValue, TParser::TStateValue);

}  // namespace NORVZEL20
