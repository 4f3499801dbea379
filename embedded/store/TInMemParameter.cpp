#include "embedded/store/TInMemParameter.h"

namespace NORVZEL20 {

TInMemParameter::TInMemParameter(const std::string& name, TCIMValue::TCIMType type) : fName(name), fType(type) {}

}  // namespace NORVZEL20
