#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/Export.h"
#include "host/ICIMElement.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Loads classes and instances from files.
class CIMDELTA_EXPORT TNamespacePopulator {
  public:
    TNamespacePopulator() = delete;

    /// Loads the CIM-XML file (DSP0201) at `path` into `ns` and returns the classes and instances loaded, in the file's order.
    ///
    /// All or nothing: after an error `ns` is as before.
    /// Errors: TZELException with kParseError (9) if the file is not CIM-XML, kFileError (11) if it cannot be read, kAlreadyExists
    /// (12) for an element that `ns` has already, kTypeMismatch (13) for a value that does not fit its type, kKeyMissing (14) for
    /// an instance without a key, kNotFound (15) for an unknown class or property, kNotSupported (31) if `ns` is null or does not
    /// come from the provider "inmem". The file is opened before `ns` is looked at. The core log gets one entry with file, line,
    /// column, what was found and what was expected.
    static std::vector<boost::shared_ptr<ICIMElement>> PopulateFromXMLFile(boost::shared_ptr<ICIMNamespace> ns, std::string path);
};

}  // namespace NORVZEL20
