#pragma once

#include <string>
#include <vector>

#include "embedded/load/TBadValue.h"
#include "embedded/load/TLoadPlace.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// A class or an instance as a document describes it, with its place there, until it can be added to a namespace.
struct TDraft {
    TEmbeddedObject object;
    TLoadPlace place;
    std::vector<TLoadPlace> propertyPlaces;                  ///< in the order of the object's properties
    std::vector<std::pair<std::string, TCIMValue>> ownKeys;  ///< for an instance: the keys of the name in front of it
    bool hasName = false;                   ///< whether a name stands in front of the instance, perhaps without keys
    bool takesDefaults = false;             ///< whether an instance has the defaults of its class where it gives no value
    std::vector<TBadValue> badValues = {};  ///< for an instance: those that are no values of the types written; NULL in the object
};

}  // namespace NORVZEL20
