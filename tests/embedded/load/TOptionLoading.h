#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "embedded/load/EAdvice.h"
#include "embedded/load/TLoadOptions.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// A namespace, and documents that are loaded into it together with options, for tests.
class TOptionLoading {
  public:
    TOptionLoading();

    /// Loads the documents in one load. Messages call them "1.xml", "2.xml" and so on. Returns the message if they cannot be
    /// loaded;
    /// "" if they can.
    std::string Load(const std::vector<std::string>& documents);

    /// The class with its qualifiers and properties, a line for each property; "" if it is not declared.
    std::string Declaration(const std::string& className) const;
    /// The paths of the instances of a class, a line for each.
    std::string PathsOf(const std::string& className) const;

    /// What a DECLGROUP has in it, as a document.
    static std::string Document(const std::string& contents);

    TLoadOptions fOptions;
    TLoadReport fReport;               ///< of the last load that did not fail
    EAdvice fAdvice = EAdvice::kNone;  ///< of the last load that did
    boost::shared_ptr<TInMemNamespace> fNamespace;
};

}  // namespace NORVZEL20
