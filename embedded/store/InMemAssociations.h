#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// Which associations to follow. An empty text restricts nothing; letter case does not count.
struct TAssociationFilter {
    std::string associationClass;  ///< this class, or one below it
    std::string role;              ///< the reference that points to the class asked about
    std::string resultClass;       ///< what is found is this class, or one below it
    std::string resultRole;        ///< the reference that points to what is found
};

/// The association classes of `ns` that tie `cls` to others, in order of declaration: those with a reference to it or to an
/// ancestor, and, if no role is given, those named by AddAssociationClass. Only `associationClass` and `role` count.
std::vector<boost::shared_ptr<TInMemClass>> FindAssociationClasses(const TInMemNamespace& ns, const TInMemClass& cls,
                                                                   const TAssociationFilter& filter);

/// The classes at the other ends of those associations, each once.
std::vector<boost::shared_ptr<TInMemClass>> FindAssociatedClasses(const TInMemNamespace& ns, const TInMemClass& cls,
                                                                  const TAssociationFilter& filter);

}  // namespace NORVZEL20
