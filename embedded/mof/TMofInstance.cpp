#include "embedded/mof/TMofInstance.h"

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

const TMofInstance::TProperty* TMofInstance::FindProperty(const std::string& name) const noexcept
{
    for (const TProperty& property : properties) {
        if (TNameText::Equal(property.name, name)) {
            return &property;
        }
    }
    return nullptr;
}

}  // namespace NORVZEL20
