#pragma once

namespace NORVZEL20 {

/// Documents that were read, but of which something waits for other documents of the load: see TLoadSession::AddLate.
class ILateDocuments {
  public:
    virtual ~ILateDocuments() = default;

    /// Adds the classes that have waited, when all documents have been read.
    virtual void AddClasses() = 0;
    /// Adds the instances that have waited, when all classes are declared.
    virtual void AddInstances() = 0;
};

}  // namespace NORVZEL20
