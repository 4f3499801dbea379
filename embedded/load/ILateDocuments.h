#pragma once

#include "embedded/load/TLoader.h"

namespace NORVZEL20 {

/// Documents that were read, and hold something that waits for other documents of the load: see TLoadSession::AddLate. In MOF,
/// these are all instances, and classes with a qualifier that was not declared in front of them.
class ILateDocuments {
  public:
    virtual ~ILateDocuments() = default;

    /// Adds the classes that have waited, when all documents have been read.
    virtual void AddClasses() = 0;
    /// Adds the instances that have waited, when all classes are declared. `readObjects` is for TLoader::FillInstance.
    virtual void AddInstances(const TLoader::TReadObjects& readObjects) = 0;
};

}  // namespace NORVZEL20
