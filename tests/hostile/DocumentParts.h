#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

constexpr std::size_t kMegabyte = 1u << 20;

/// The beginning and the end of an inventory, around the contents of its group. A declaration at the end makes it one in any case.
inline const std::string kGroup = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>";
inline const std::string kEnd = "<QUALIFIER.DECLARATION NAME=\"Other\" TYPE=\"boolean\"/></DECLGROUP></DECLARATION></CIM>";

/// The text that many times, without a break.
inline std::string Repeat(const std::string& unit, std::size_t times)
{
    std::string text;
    text.reserve(unit.size() * times);
    for (std::size_t i = 0; i < times; ++i) {
        text += unit;
    }
    return text;
}

}  // namespace NORVZEL20
