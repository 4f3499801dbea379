#include "embedded/load/ReadEachText.h"

#include <vector>

#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

TCIMValue ReadEachText(const TCIMValue& value, const boost::function<TCIMValue(const TCIMValue&)>& read)
{
    if (value.IsNull()) {
        return value;
    }
    if (!value.GetType().IsArray()) {
        return TValueAccess::IsText(value) ? read(value) : value;
    }
    std::vector<TCIMValue> elements;
    for (const TCIMValue& element : value.GetElements()) {
        elements.push_back(ReadEachText(element, read));
    }
    return TCIMValue(value.GetType(), static_cast<unsigned int>(elements.size()), elements);
}

}  // namespace NORVZEL20
