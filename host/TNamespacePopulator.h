#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMElement.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Loads classes and instances from files.
class TNamespacePopulator {
  public:
    TNamespacePopulator() = delete;

    /// Loads the CIM-XML file (DSP0201) at `path` into `ns` and returns the classes and instances loaded, in the file's order.
    ///
    /// All or nothing: where it throws, `ns` is as it was.
    /// Errors: TZELException with status 11 where the file cannot be read, 9 where it is not CIM-XML, 12 for something that is
    /// there already, 13 for a value that does not fit its type, 14 for an instance without a key, 15 for an unknown class or
    /// property, 31 where `ns` is null or none of the provider "inmem" (the file is opened first). The core log gets one entry
    /// that tells file, line, column, what was found and what was expected.
    static std::vector<boost::shared_ptr<ICIMElement>> PopulateFromXMLFile(boost::shared_ptr<ICIMNamespace> ns, std::string path);
};

}  // namespace NORVZEL20
