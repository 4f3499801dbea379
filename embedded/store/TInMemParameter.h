#pragma once

#include <string>

#include "embedded/store/TInMemNamedElement.h"
#include "host/Export.h"
#include "host/ICIMNamedElement.h"

namespace NORVZEL20 {

/// A parameter of a method: name, type, and for references the class, for arrays of fixed size that size.
class CIMDELTA_EXPORT TInMemParameter : public TInMemNamedElement<ICIMNamedElement> {
  public:
    TInMemParameter(const std::string& name, TCIMValue::TCIMType type);

    const std::string& GetName() const noexcept { return fName; }
    TCIMValue::TCIMType GetType() const noexcept { return fType; }

    /// The class that a reference points to; empty if none was named.
    const std::string& GetReferenceClass() const noexcept { return fReferenceClass; }
    void SetReferenceClass(const std::string& name) { fReferenceClass = name; }
    /// The number of elements of a fixed array; 0 if it is not fixed.
    unsigned int GetArraySize() const noexcept { return fArraySize; }
    void SetArraySize(unsigned int size) noexcept { fArraySize = size; }

  private:
    std::string fName;
    std::string fReferenceClass;
    TCIMValue::TCIMType fType;
    unsigned int fArraySize = 0;
};

}  // namespace NORVZEL20
