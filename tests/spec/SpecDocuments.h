#pragma once

#include <string>

namespace NORVZEL20 {

// Documents with a class element for Other, each tag on a line of its own.

inline std::string InClass(const std::string& inner)
{
    return "<DifftoolSpec>\n<class name=\"Other\">\n" + inner + "\n</class>\n</DifftoolSpec>";
}

inline std::string InValue(const std::string& text)
{
    return InClass("<includelist>\n<value>" + text + "</value>\n</includelist>");
}

}  // namespace NORVZEL20
