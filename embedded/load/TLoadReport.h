#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "embedded/load/TBadProperty.h"

namespace NORVZEL20 {

/// What a load found and added. A plain value.
struct TLoadReport {
    /// One kind of oddity that did not end the load.
    struct TTolerated {
        std::string text;      ///< what was found and what was made of it, with the names of the first one
        std::string document;  ///< what messages call the document of the first one
        std::size_t line;      ///< the line of the first one, from 1
        std::size_t count;     ///< how many of this kind there were
        std::size_t others;    ///< how many of these have another text, because they are about other names
    };

    /// What the namespace was taken from.
    enum ENamespaceOrigin {
        kFromDocuments,   ///< they name it themselves
        kFromReferences,  ///< all references that name a namespace name this one
        kFromOptions,     ///< TLoadOptions::namespaceName
        kFromDefault      ///< none of these names one
    };

    /// A class that was declared as its instances suggest.
    struct TInferred {
        std::string className;
        std::vector<std::string> keys;
    };

    /// The namespace that the documents name; if they name none, see TOwnPlaceSearch.
    std::string namespaceName = "root/cimv2";
    ENamespaceOrigin namespaceOrigin = kFromDefault;
    /// If the documents do not name their namespace: those that references name, in ascending order.
    std::vector<std::string> namespacesOfReferences;
    bool namesNamespace = false;           ///< whether the document names its namespace
    bool referencesNameNamespace = false;  ///< whether namespace or host had to be found out from the references
    std::string host;                      ///< the host beside that namespace; empty if none is named
    std::size_t qualifierDecls = 0;
    std::size_t classes = 0;
    std::size_t instances = 0;
    std::vector<TInferred> inferred;          ///< in the order of their first instances
    std::vector<TTolerated> tolerated;        ///< one entry for each kind, in the order of their first ones
    std::vector<TBadProperty> badProperties;  ///< those with values that do not fit, which TLoadOptions::badValues let pass
};

}  // namespace NORVZEL20
