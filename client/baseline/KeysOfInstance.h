#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

namespace NORVZEL20 {

/// A key of an instance as an entry names it, a part of the entry's text.
struct TKeyText {
    std::string_view name;
    std::string_view value;  ///< with its quotes; empty if there is no `=`
    std::size_t position;    ///< of the name in the text of the instance
};

/// Of `Disk.Bus=1,Id="sda"` the keys Bus and Id, whatever their names and values are. `instance` must outlive the result.
std::vector<TKeyText> KeysOfInstance(std::string_view instance);

}  // namespace NORVZEL20
