#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <unordered_set>

#include "client/collect/read/TFacts.h"
#include "embedded/cimxml/TCimXmlWriter.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Writes a collected inventory as CIM-XML: all declarations, then the instances as they come. It keeps the keys of the instances,
/// and nothing else of them.
///
/// Errors of all operations: what the sink throws, std::bad_alloc.
class TInventoryWriter {
  public:
    explicit TInventoryWriter(TCimXmlWriter::TSink sink);

    /// Writes an instance. Returns false, and writes nothing, if there was one with the same keys already. Class, properties and
    /// types must be as declared, and each key must have a value. Errors: TZELException if not.
    bool Add(const TFacts& facts);

    /// Ends the document. Call it once.
    void End() { fWriter.EndDocument(); }

  private:
    boost::shared_ptr<TInMemNamespace> fNamespace;  // the declarations
    std::unordered_set<std::string> fPaths;
    TCimXmlWriter fWriter;
};

}  // namespace NORVZEL20
