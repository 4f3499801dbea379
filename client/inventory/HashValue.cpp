#include "client/inventory/HashValue.h"

namespace NORVZEL20 {

std::size_t HashValue(const TCIMValue& value)
{
    if (value.IsNull() || !value.GetType().IsArray()) {
        return value.Hash();
    }
    std::size_t sum = 0;
    for (const TCIMValue& element : value.GetElements()) {
        sum += element.Hash();
    }
    return sum;
}

}  // namespace NORVZEL20
