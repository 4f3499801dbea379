// Each group is written as a comparison of two: what most have, and what these have.
//
//   web07: 2 differences
//     KALMO_Package  + cryptominer   Version 1.0-1, Vendor unknown
//     KALMO_Service  ~ rsyslog.Started: TRUE -> FALSE
//
//   web21..23 alike: 43 differences
//     KALMO_Package  ~ Version in 43 instances, 43 distinct changes
//                        curl: 7.88.1-10 -> 7.88.1-10+deb12u5   ... 42 more (--detail)
#include "client/report/WriteOutliers.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <cstddef>
#include <cstring>
#include <numeric>

#include "client/report/TClassTable.h"
#include "client/report/TextColors.h"
#include "client/text/Counted.h"

namespace NORVZEL20 {

namespace {

const char kIndent[] = "  ";

using TBlock = std::vector<std::string>;

TBlock WriteBlock(const TOutliers& outliers, const TInventoryNames& names, const TTextOptions& options, std::size_t most)
{
    TBlock block{DescribeOutliers(outliers, names, options.isColored)};
    TTextOptions indented = options;
    indented.width -= std::min(indented.width, std::strlen(kIndent));
    for (const std::string& line : TClassTable(outliers.classes, names, indented, true).Write(most)) {
        block.push_back(kIndent + line);
    }
    block.emplace_back();
    return block;
}

std::size_t CountLinesOf(const std::vector<TBlock>& blocks)
{
    return std::accumulate(blocks.begin(), blocks.end(), static_cast<std::size_t>(0),
                           [](std::size_t sum, const TBlock& block) { return sum + block.size(); });
}

// Of the largest blocks, only the first line is left.
void CollapseBlocks(std::vector<TBlock>& blocks, std::size_t mostLines)
{
    std::vector<TBlock*> bySize;
    for (TBlock& block : blocks) {
        bySize.push_back(&block);
    }
    std::stable_sort(bySize.begin(), bySize.end(),
                     [](const TBlock* one, const TBlock* other) { return one->size() > other->size(); });
    for (TBlock* const block : bySize) {
        if (CountLinesOf(blocks) <= mostLines) {
            return;
        }
        *block = {block->front() + " (--detail)", std::string()};
    }
}

}  // namespace

std::string DescribeOutliers(const TOutliers& outliers, const TInventoryNames& names, bool isColored)
{
    const bool isOne = outliers.inventories.size() == 1;
    return Paint(isColored, kBold, names.List(outliers.inventories)) + (isOne ? ": " : " alike: ") +
           Counted(outliers.differences, "difference");
}

std::string WriteOutliers(const std::vector<TOutliers>& outliers, const TInventoryNames& names, const TTextOptions& options)
{
    std::vector<TBlock> blocks;
    for (const std::size_t most : TClassTable::MostMembers(options)) {
        blocks.clear();
        for (const TOutliers& group : outliers) {
            blocks.push_back(WriteBlock(group, names, options, most));
        }
        if (options.mostLines == 0 || CountLinesOf(blocks) <= options.mostLines) {
            break;
        }
    }
    if (options.mostLines > 0) {
        CollapseBlocks(blocks, options.mostLines);
    }
    std::string text;
    for (const TBlock& block : blocks) {
        text += boost::algorithm::join(block, "\n") + "\n";
    }
    return text;
}

}  // namespace NORVZEL20
