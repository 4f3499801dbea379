#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>
#include <vector>

#include "embedded/cimxml/TLoadReport.h"
#include "embedded/cimxml/TPopulateError.h"
#include "host/ICIMElement.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Loads CIM-XML documents (DSP0201) into a namespace: declarations in any kind of group, and recorded requests and responses.
///
/// Classes may come in any order, and instances before their class; references are written as their classes are declared, wherever
/// that stands. Only a key that a path tells without its name needs the class in front of it. Names of classes, properties and keys
/// are of letters, digits, underscores and what is beyond ASCII, so that a path tells them apart. A property that an instance does
/// not mention is null there. A reference without a namespace, or to the document's own namespace (and host), is stored without
/// one. Each load is all or nothing: where it throws, the namespace is as it was. Errors of every load: TPopulateError with the
/// statuses of TNamespacePopulator::PopulateFromXMLFile, 31 where the namespace is none of the provider "inmem"; std::bad_alloc.
/// Nothing is logged. Threads: one at a time for each populator and namespace; several populators may work at once on namespaces of
/// their own. Cost: one pass over the document; it is never held whole, but LoadFromMemory has the XML library copy it.
/// Bounds, beyond which a document is refused with status 9: those of TXmlReader; 1000 superclasses of a class; 1024 properties of
/// a class, an instance or an embedded object; 1024 methods of a class; 1024 qualifiers of an element; 256 key bindings of a path;
/// 12 paths and 32 embedded objects within each other. Classes and elements count with what they inherit. An embedded object must
/// not have a document type declaration (status 13).
class TCimXmlPopulator {
  public:
    /// Fills the buffer with at most so many bytes and returns how many; 0 ends the document, and is asked for once. May deliver as
    /// little as it likes: small pieces are gathered before they are parsed. May throw: the load then fails with that exception.
    using TPullSource = boost::function<std::size_t(char*, std::size_t)>;

    explicit TCimXmlPopulator(boost::shared_ptr<ICIMNamespace> ns);

    /// Loads the `length` bytes at `data`, which are called `name` in messages.
    TLoadReport LoadFromMemory(const char* data, std::size_t length, const std::string& name);

    /// Loads what `source` delivers.
    TLoadReport LoadFromSource(const TPullSource& source, const std::string& name);

    /// Loads the file at `path`. Errors: also status 11 where it cannot be opened or read.
    TLoadReport LoadFile(const std::string& path);

    /// From now on keeps what each load loads; for TakeElements.
    void KeepElements() { fKeep = true; }

    /// The classes, then the instances of the last load that did not fail, each in the document's order. Empty without
    /// KeepElements, and where they have been taken already.
    std::vector<boost::shared_ptr<ICIMElement>> TakeElements();

  private:
    template <class TRead>
    TLoadReport Load(const std::string& name, TRead read);

    boost::shared_ptr<ICIMNamespace> fNamespace;
    bool fKeep = false;
    std::vector<boost::shared_ptr<ICIMElement>> fElements;
};

}  // namespace NORVZEL20
