#include "client/text/SomeOf.h"

#include <boost/algorithm/string/join.hpp>
#include <cstddef>

namespace NORVZEL20 {

namespace {

const std::size_t kMostNames = 12;

}  // namespace

std::string SomeOf(const std::vector<std::string>& names)
{
    if (names.size() <= kMostNames) {
        return boost::algorithm::join(names, ", ");
    }
    const std::vector<std::string> first(names.begin(), names.begin() + kMostNames);
    return boost::algorithm::join(first, ", ") + " and " + std::to_string(names.size() - kMostNames) + " more";
}

}  // namespace NORVZEL20
