#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>
#include <vector>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/load/TPopulateError.h"
#include "host/Export.h"
#include "host/ICIMElement.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Loads CIM-XML documents (DSP0201) into a namespace, each on its own; TLoadSession loads several as one.
///
/// Forms: declarations in any kind of group, and the answers of servers to the operations that read classes and instances. A part
/// of either may stand alone, such as an IRETURNVALUE or an INSTANCE, and several documents or parts may follow each other in one
/// file. Of these only the first may have a document type declaration. Refused with kParseError (9) are requests, answers that are
/// errors, an answer to an Open or Pull operation without the one that ends its sequence, and a load that has no declaration and no
/// instance at all, such as a list of names: it would look like an inventory without instances.
/// Order: classes may come in any order, and instances before their class. References are stored as their classes are declared,
/// even if the declaration comes later. There is one exception: a key value without a name needs its class in front of it.
/// Names: those of classes, properties and keys consist of ASCII letters, digits, underscores and characters beyond ASCII, so they
/// cannot be confused with the punctuation of a path.
/// Values: a property that an instance does not mention is null, even if it has a default.
/// References: one without a namespace, or to the document's own namespace and host, is stored without both; letter case, and
/// slashes at both ends of the name, do not count. If the document names no namespace, its own is the one that its references
/// name (see TOwnPlaceSearch), otherwise root/cimv2. If it names no host, its own is the one that its references name beside
/// that namespace; if they name several, none is its own, and all are kept. A reference that names no host is to the own one. All
/// or nothing: if a load throws, the namespace is as it was. Errors of every load: TPopulateError with the statuses of
/// TNamespacePopulator::PopulateFromXMLFile, or kNotSupported (31) if the namespace is not one of the provider "inmem";
/// std::bad_alloc. Nothing is logged. Threads: use a populator, and a namespace, from one thread at a time; different populators
/// may load into different namespaces concurrently. Cost: one pass over the document, which is never held whole. Bounds: a document
/// that exceeds one is refused with kParseError (9). They are those of TXmlLimits; 1000 superclasses of a class; 1024 properties of
/// a class, an instance or an embedded object; 1024 methods of a class; 1024 qualifiers of an element; 256 key bindings of a path;
/// 12 paths and 32 embedded objects inside of each other. Inherited parts count. An embedded object with a document type
/// declaration is refused with kTypeMismatch (13).
class CIMDELTA_EXPORT TCimXmlPopulator {
  public:
    using TPullSource = TCimXmlDocuments::TPullSource;

    /// The populator loads into `ns` and keeps it alive.
    explicit TCimXmlPopulator(boost::shared_ptr<ICIMNamespace> ns);

    /// Loads the `length` bytes at `data`. Messages call the document `name`.
    TLoadReport LoadFromMemory(const char* data, std::size_t length, const std::string& name);

    /// Loads what `source` delivers. Messages call the document `name`.
    TLoadReport LoadFromSource(const TPullSource& source, const std::string& name);

    /// Loads the file at `path`. Errors: also kFileError (11) if it cannot be opened or read.
    TLoadReport LoadFile(const std::string& path);

    /// From now on remembers what each load adds, for TakeElements.
    void KeepElements() { fKeep = true; }

    /// From now on reads documents through Expat alone: the results are the same, and loading takes several times as long. For
    /// tests.
    void UseExpatAlone() { fUsesExpatAlone = true; }

    /// The classes, then the instances of the last load that did not fail, each in the document's order. Empty without KeepElements
    /// and when called again.
    std::vector<boost::shared_ptr<ICIMElement>> TakeElements();

  private:
    template <class TRead>
    TLoadReport Load(const std::string& name, TRead read);

    boost::shared_ptr<ICIMNamespace> fNamespace;
    bool fKeep = false;
    bool fUsesExpatAlone = false;
    std::vector<boost::shared_ptr<ICIMElement>> fElements;
};

}  // namespace NORVZEL20
