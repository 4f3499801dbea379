#include "client/noise/FindTops.h"

#include <iterator>

namespace NORVZEL20 {

namespace {

std::size_t CountIn(const std::set<std::size_t>& positions, std::size_t begin, std::size_t end)
{
    return static_cast<std::size_t>(std::distance(positions.lower_bound(begin), positions.lower_bound(end)));
}

}  // namespace

std::map<std::size_t, std::size_t> FindTops(const std::vector<TRulesDraft::TClass>& classes, const std::set<std::size_t>& showing,
                                            const std::set<std::size_t>& relevant, const std::function<bool(std::size_t)>& declares)
{
    const auto isWhole = [&](std::size_t position) {
        const std::size_t end = classes[position].treeEnd;
        return CountIn(showing, position, end) == CountIn(relevant, position, end);
    };
    std::map<std::size_t, std::size_t> tops;
    std::size_t covered = 0;  // classes before this position have their rules
    for (const std::size_t position : showing) {
        if (position < covered) {
            continue;
        }
        std::size_t top = position;
        for (std::size_t above = classes[position].parent; above > 0 && declares(above) && isWhole(above);
             above = classes[above].parent) {
            if (CountIn(showing, above, classes[above].treeEnd) > 1) {
                top = above;
            }
        }
        covered = isWhole(top) ? classes[top].treeEnd : top + 1;
        tops[top] = covered;
    }
    return tops;
}

}  // namespace NORVZEL20
