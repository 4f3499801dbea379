#pragma once

#include <string>
#include <vector>

#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Appends the key names of a class to the caller's vector.
///
/// The names are not copied; they belong to the class, which must live as long as the vector is used. The vector is not owned and
/// must outlive the enumeration.
class TAddKeyNamesToVectorCallback : public TUnaryFunction<const std::string*> {
  public:
    explicit TAddKeyNamesToVectorCallback(std::vector<const std::string*>* names) : fNames(names) {}

    /// Always returns true, so the enumeration continues.
    bool operator()(const std::string* name) const
    {
        fNames->push_back(name);
        return true;
    }

  private:
    std::vector<const std::string*>* fNames;
};

}  // namespace NORVZEL20
