#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <map>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

#include "embedded/load/TLoadContext.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemPropertyDecl.h"

namespace NORVZEL20 {

/// Instances that a load has twice. If both have the same values, they are one, which is tolerated; otherwise they contradict each
/// other. Values are compared at the end, because references may be written again until then.
///
/// Memory: 12 bytes for each instance of the load. Cost: constant for each operation but Check and GetRepeated, which are linear in
/// what was noted.
class TRepeatedInstances {
  public:
    explicit TRepeatedInstances(TLoadContext& context) noexcept : fContext(context) {}

    /// The load has added an instance of that class, the next one of its extent, which is at `place`.
    void NoteAdded(const TInMemClass& cls, const TLoadPlace& place);
    /// The instance at the current place has the keys of another one of its class, which was added before. Errors: fails with
    /// kAlreadyExists (12) if that was there before the load, or if the class has no keys.
    void NoteRepeated(const boost::shared_ptr<TInMemInstance>& repeated);
    /// A value that does not fit its type becomes NULL in that slot; `text` is what it was. Only equal texts are equal then. Costs
    /// a record for each.
    void NoteLost(const TInMemInstance& instance, std::uint32_t slot, TCIMValue text)
    {
        fLost.emplace(std::make_pair(&instance, slot), std::move(text));
    }
    /// Compares what was noted. Errors: fails with kAlreadyExists (12) if one has other values than the instance added first.
    void Check();

    std::size_t GetCount() const noexcept { return fRepeats.size(); }
    /// The instances that were noted.
    std::unordered_set<const TInMemInstance*> GetRepeated() const;

  private:
    struct TPlace {
        std::uint32_t document;
        std::uint32_t line;
        std::uint32_t column;
    };
    struct TPlaces {
        std::uint32_t before = 0;  // positions in the extent, from earlier loads
        std::vector<TPlace> places;
    };
    struct TRepeat {
        boost::shared_ptr<TInMemInstance> first;
        TLoadPlace firstPlace;
        boost::shared_ptr<TInMemInstance> repeated;
        TLoadPlace place;
    };

    const TPlace* FindPlace(const TInMemClass& cls, std::uint32_t position) const;
    void Compare(const TRepeat& repeat);
    const TInMemPropertyDecl* FindDifference(const TInMemInstance& a, const TInMemInstance& b) const;
    const TCIMValue& ValueOf(const TInMemInstance& instance, std::uint32_t slot) const;
    std::string Show(const TInMemInstance& instance, const TInMemPropertyDecl& decl) const;

    TLoadContext& fContext;
    std::unordered_map<const TInMemClass*, TPlaces> fPlaces;
    const TInMemClass* fLastClass = nullptr;
    TPlaces* fLast = nullptr;  // of that class
    std::vector<TRepeat> fRepeats;
    std::map<std::pair<const TInMemInstance*, std::uint32_t>, TCIMValue> fLost;  // by slot
};

}  // namespace NORVZEL20
