#include "client/rules/DescribeReducedReferences.h"

#include <boost/algorithm/string/join.hpp>

namespace NORVZEL20 {

std::string DescribeReducedReferences(const std::vector<std::string>& keys)
{
    const std::string withoutKeys =
        keys.empty() ? "" : (keys.size() == 1 ? "without key " : "without keys ") + boost::algorithm::join(keys, ", ") + " and ";
    return withoutKeys + "without their namespace";
}

}  // namespace NORVZEL20
