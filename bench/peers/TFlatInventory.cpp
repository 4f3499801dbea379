#include "bench/peers/TFlatInventory.h"

#include "bench/peers/TFlatReader.h"

namespace NORVZEL20 {

TFlatInventory::TFlatInventory(const std::string& path)
{
    TFlatReader(*this, path).Read();
}

std::string TFlatInventory::KeyText(const TFlatRow& row) const
{
    const TFlatClass& type = fClasses[row.classNumber];
    std::string text = type.name;
    for (const std::size_t key : type.keys) {
        text.append(1, '\0').append(row.values[key]);
    }
    return text;
}

}  // namespace NORVZEL20
