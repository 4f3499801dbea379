// The constructor reads what the order and the counts depend on, class by class. Most of it is in the records; only if the rules of
// a class exclude keys, instances are looked up for their keys and counted. ForEach looks up the values.
//
// A run writes the records of a class in three ascending runs at most, one for each kind. A pass that finds such runs and merges
// them takes less time than sorting does. Any other order is sorted by the same merges.
#include "client/comparison/TDifferenceList.h"

#include <algorithm>
#include <utility>

namespace NORVZEL20 {

namespace {

// Sorts by merging neighbouring ascending runs until one is left.
template <class TIterator, class TLess>
void MergeRuns(TIterator first, TIterator last, const TLess& less)
{
    std::vector<TIterator> ends(1, first);
    while (ends.back() != last) {
        ends.push_back(std::is_sorted_until(ends.back(), last, less));
    }
    while (ends.size() > 2) {
        std::vector<TIterator> merged(1, first);
        for (std::size_t run = 2; run < ends.size(); run += 2) {
            std::inplace_merge(ends[run - 2], ends[run - 1], ends[run], less);
            merged.push_back(ends[run]);
        }
        if (merged.back() != last) {
            merged.push_back(last);
        }
        ends.swap(merged);
    }
}

}  // namespace

TDifferenceList::TDifferenceList(const std::vector<TInventory>& inventories, std::shared_ptr<TRules> rules,
                                 TDeltaNamespace& records)
    : fRules(std::move(rules)), fReader(inventories, *fRules), fClasses(CollectDeltaRecords(records))
{
    for (auto& [className, ofClass] : fClasses) {
        fReader.StartClass(className);
        TPlaces places = FindPlaces(ofClass);
        MergeRuns(places.begin(), places.end(), &StandsBefore);
        Count(places);
        std::transform(places.begin(), places.end(), ofClass.begin(), [](TPlace& place) { return std::move(place.record); });
    }
}

bool TDifferenceList::StandsBefore(const TPlace& a, const TPlace& b)
{
    const int byInstance = a.instance.GetString().compare(b.instance.GetString());
    if (byInstance != 0) {
        return byInstance < 0;
    }
    return a.type != b.type ? a.type < b.type : a.property.GetString() < b.property.GetString();
}

TDifferenceList::TPlaces TDifferenceList::FindPlaces(const TDeltaInstances& records)
{
    TPlaces places;
    places.reserve(records.size());
    for (const boost::shared_ptr<ICIMInstance>& record : records) {
        places.push_back({fReader.KeyOf(*record), TypeOfRecord(*record), PropertyOfRecord(*record), record});
    }
    return places;
}

void TDifferenceList::Count(const TPlaces& places)
{
    const TPlace* previous = nullptr;
    for (const TPlace& place : places) {
        switch (place.type) {
        case TDeltaNamespace::kInstanceRemoved:
            ++fCounts.onlyInReference;
            break;
        case TDeltaNamespace::kInstanceAdded:
            ++fCounts.onlyInOthers;
            fCounts.instancesOnlyInOthers += fReader.CountInstances(*place.record);
            break;
        case TDeltaNamespace::kPropertyChanged:
            ++fCounts.changedValues;
            // Differences of one instance follow each other.
            if (previous == nullptr || previous->type != place.type || previous->instance != place.instance) {
                ++fCounts.changedInstances;
            }
        }
        previous = &place;
    }
}

void TDifferenceList::ForEach(const TCallback& callback)
{
    for (const auto& [className, records] : fClasses) {
        fReader.StartClass(className);
        for (const boost::shared_ptr<ICIMInstance>& record : records) {
            callback(fReader.Read(*record));
        }
    }
}

}  // namespace NORVZEL20
