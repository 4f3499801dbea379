// How classes are gathered. Device, Fan, Disk and Tape are given, Fan and Disk below Device, Tape below Disk. If the same is said
// of
//
//   all four           Device and 3 classes below it
//   Fan, Disk, Tape    2 groups: Fan; Disk and 1 class below it. "3 classes below Device" would be as true, but only if nothing
//                      can be said about Device itself, because it has no instances.
//   Device, Tape       2 groups: Device; Tape
//
// The classes stand in one list, each behind its superclass. A pass from the end of the list adds up how many of the classes at and
// below each one are meant; a class with all of these meant can name a group. A pass from the beginning finds the highest of them.
#include "client/report/TClassGathering.h"

#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

TClassGathering::TClassGathering(const TCoverage& coverage, const std::vector<const TCoverage::TClass*>& among)
{
    for (const TCoverage::TClass* const cls : among) {
        fNodes[Find(cls->name, coverage)].own = 1;
    }
    for (std::size_t i = fNodes.size(); i-- > 0;) {
        fNodes[i].lowest = i;
        fNodes[i].total += fNodes[i].own;
        if (fNodes[i].above != i) {
            fNodes[fNodes[i].above].total += fNodes[i].total;
        }
    }
    for (std::size_t i = fNodes.size(); i-- > 0;) {
        TNode& above = fNodes[fNodes[i].above];
        if (above.own == 0 && above.total == fNodes[i].total) {
            above.lowest = fNodes[i].lowest;
        }
    }
}

// The position of the class. It and those above it are added if they are new, the highest first.
std::size_t TClassGathering::Find(const std::string& name, const TCoverage& coverage)
{
    std::vector<std::string> added;
    std::string top = name;
    while (fPositions.count(top) == 0) {
        added.push_back(top);
        const auto above = coverage.superClasses.find(top);
        if (above == coverage.superClasses.end()) {
            break;
        }
        top = above->second;
    }
    for (std::size_t i = added.size(); i-- > 0;) {
        const auto above = fPositions.find(top);
        fPositions[added[i]] = fNodes.size();
        fNodes.push_back({added[i], above == fPositions.end() ? fNodes.size() : above->second});
        top = added[i];
    }
    return fPositions.at(name);
}

// For each class of `said`, the position of the highest class at or above it that has all classes at and below it in `said`; its
// own if there is none.
std::vector<std::size_t> TClassGathering::FindTops(const std::vector<const TCoverage::TClass*>& said) const
{
    std::vector<std::size_t> counts(fNodes.size(), 0);
    for (const TCoverage::TClass* const cls : said) {
        counts[fPositions.at(cls->name)] = 1;
    }
    for (std::size_t i = fNodes.size(); i-- > 0;) {
        if (fNodes[i].above != i) {
            counts[fNodes[i].above] += counts[i];
        }
    }
    std::vector<std::size_t> tops;
    for (std::size_t i = 0; i < fNodes.size(); ++i) {
        const std::size_t above = fNodes[i].above;
        tops.push_back(above != i && counts[above] == fNodes[above].total ? tops[above] : i);
    }
    std::vector<std::size_t> result;
    for (const TCoverage::TClass* const cls : said) {
        result.push_back(tops[fPositions.at(cls->name)]);
    }
    return result;
}

std::vector<TClassGroup> TClassGathering::Gather(const std::vector<const TCoverage::TClass*>& said) const
{
    const std::vector<std::size_t> tops = FindTops(said);
    std::map<std::string, TClassGroup> groups;
    for (std::size_t i = 0; i < said.size(); ++i) {
        const TNode& node = fNodes[fNodes[tops[i]].lowest];
        TClassGroup& group = groups[node.name];
        group.top = node.name;
        group.classes.push_back(said[i]);
    }
    std::vector<TClassGroup> result;
    for (auto& [top, group] : groups) {
        const bool hasTop = fNodes[fPositions.at(top)].own > 0;
        const std::size_t below = group.classes.size() - (hasTop ? 1 : 0);
        const std::string classes = Counted(below, "class", "classes") + " below ";
        group.name = !hasTop      ? classes + EscapeForDisplay(top)
                     : below == 0 ? EscapeForDisplay(top)
                                  : EscapeForDisplay(top) + " and " + classes + "it";
        result.push_back(group);
    }
    return result;
}

}  // namespace NORVZEL20
