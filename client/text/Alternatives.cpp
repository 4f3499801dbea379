#include "client/text/Alternatives.h"

#include <boost/algorithm/string/join.hpp>

namespace NORVZEL20 {

std::string Alternatives(std::vector<std::string> names)
{
    const std::string last = names.back();
    names.pop_back();
    return boost::algorithm::join(names, ", ") + " or " + last;
}

}  // namespace NORVZEL20
