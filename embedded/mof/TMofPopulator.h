#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>
#include <vector>

#include "embedded/load/TLoadReport.h"
#include "embedded/mof/IMofIncludes.h"
#include "embedded/mof/TMofDocuments.h"
#include "host/Export.h"
#include "host/ICIMElement.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Loads MOF documents (DSP0004 2.x) into a namespace: qualifiers, classes and instances, with what they include.
///
/// Order: declarations may come in any order, and aliases before their instances.
/// Text: UTF-8, with or without a byte order mark, or UTF-16. Comments may have any bytes.
/// Qualifiers: a use takes from the declaration the flavors that it does not write and, without a value, the value; a boolean
/// qualifier without a value is true. One that is not declared has the type that its value suggests.
/// Values: a property that an instance does not mention has the default of its class, or else is null. An instance as a value, and
/// a text that is MOF in a property with EmbeddedObject or EmbeddedInstance, becomes an embedded object.
/// References: aliases of the same document, and paths as texts. They are stored as TCimXmlPopulator stores them. The namespace is
/// that of `#pragma namespace` in front of the first instance.
/// Includes: `#pragma include` reads a file that IMofIncludes finds, in its place, each file once. A file that includes itself, or
/// that is compressed, is an error. All other pragmas are ignored. All or nothing: if a load throws, the namespace is as it was.
/// Errors of every load: TPopulateError with the statuses of TNamespacePopulator::PopulateFromXMLFile, kFileError (11) for a file
/// that cannot be read, or kNotSupported (31) if the namespace is not one of the provider "inmem"; std::bad_alloc. Nothing is
/// logged. Threads: as TCimXmlPopulator. Cost: one pass over each document, which is held whole while it is read. Instances take
/// several times the memory of their text until the load ends. Bounds: those of TMofLimits and TSchemaLimits; 32 embedded objects
/// inside of each other. A document that exceeds one is refused with kParseError (9).
class CIMDELTA_EXPORT TMofPopulator {
  public:
    using TPullSource = TMofDocuments::TPullSource;

    /// The populator loads into `ns` and keeps it alive. `includes` finds the files that documents include; null refuses each.
    explicit TMofPopulator(boost::shared_ptr<ICIMNamespace> ns, boost::shared_ptr<IMofIncludes> includes = {});

    /// Loads the `length` bytes at `data`. Messages call the document `name`; what it includes is looked for beside `name`.
    TLoadReport LoadFromMemory(const char* data, std::size_t length, const std::string& name);
    /// Loads what `source` delivers, in the same way.
    TLoadReport LoadFromSource(const TPullSource& source, const std::string& name);
    /// Loads the file at `path`. Errors: also kFileError (11) if it cannot be opened or read.
    TLoadReport LoadFile(const std::string& path);

    /// From now on remembers what each load adds, for TakeElements.
    void KeepElements() { fKeep = true; }
    /// The classes, then the instances of the last load that did not fail, each in the document's order, except that classes with a
    /// qualifier that is declared behind them come last. Empty without KeepElements and when called again.
    std::vector<boost::shared_ptr<ICIMElement>> TakeElements();

  private:
    template <class TRead>
    TLoadReport Load(const std::string& name, TRead read);

    boost::shared_ptr<ICIMNamespace> fNamespace;
    boost::shared_ptr<IMofIncludes> fIncludes;
    bool fKeep = false;
    std::vector<boost::shared_ptr<ICIMElement>> fElements;
};

}  // namespace NORVZEL20
