#include "client/report/DescribeLack.h"

#include <boost/algorithm/string/join.hpp>

#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

const std::size_t kMostSubjects = 3;

// "instances: Fan, Sensor and 5 more".
std::string NameSubjects(const TNotCollected& lack, std::size_t most)
{
    std::vector<std::string> named = lack.subjects;
    if (named.size() > most + 1) {
        named.resize(most);
    }
    const std::string text = EscapeForDisplay(lack.kind + (named.empty() ? "" : ": " + boost::algorithm::join(named, ", ")));
    return lack.count > named.size() && !named.empty() ? text + " and " + std::to_string(lack.count - named.size()) + " more"
                                                       : text;
}

}  // namespace

std::string DescribeLack(const TNotCollected& lack)
{
    return NameSubjects(lack, kMostSubjects) + " (" + EscapeForDisplay(lack.reason) + ")";
}

std::string DescribeLackWholly(const TNotCollected& lack)
{
    return NameSubjects(lack, lack.subjects.size()) + " (" + EscapeForDisplay(lack.reason) + ")";
}

}  // namespace NORVZEL20
