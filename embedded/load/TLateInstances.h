#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "embedded/load/TDraft.h"
#include "embedded/load/TLoadPlace.h"
#include "embedded/load/TOwnPlaceSearch.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Instances and references that need something which the document gives only later. Plain storage: the loader works it off when
/// the document has ended.
class TLateInstances {
  public:
    /// An instance that is filled but not added, with its place in the document.
    struct THeld {
        boost::shared_ptr<TInMemInstance> instance;
        TLoadPlace place;
    };

    /// From now on all instances wait as drafts; called when the class of one is not declared yet.
    void StartWaiting() noexcept { fIsWaiting = true; }
    bool IsWaiting() const noexcept { return fIsWaiting; }
    void Wait(TDraft draft) { fDrafts.push_back(std::move(draft)); }

    /// Calls `visit` with the class of each instance that waits, and of each reference in it or noted.
    void ForEachClass(const boost::function<void(const std::string&)>& visit) const;

    /// Holds an instance back, because a reference in one of its keys is noted too.
    void Hold(const boost::shared_ptr<TInMemInstance>& instance, const TLoadPlace& place) { fHeld.push_back({instance, place}); }

    /// Notes a property with a reference that may have to be written again. `declared` is how many classes are declared.
    void NoteReference(const boost::shared_ptr<TInMemInstance>& instance, std::uint32_t slot, std::size_t declared)
    {
        fDeclaredBefore = fReferences.empty() ? declared : fDeclaredBefore;
        fReferences.emplace_back(instance, slot);
    }
    /// Writes the noted references again, with the keys as their classes declare them. `declared` is how many classes are declared
    /// by now. Call it before `place` decides, so that it sees references that were text.
    void AdaptReferences(TOwnPlaceSearch& place, const TInMemNamespace& ns, std::size_t declared);
    /// Whether any noted reference leads to an instance of `ns` or to one that is held, once namespaces and hosts are left out.
    /// Linear in what is held and noted.
    bool LeadTo(const TInMemNamespace& ns) const;
    /// Takes the document's own namespace out of the noted references. Call it after `place` has decided, and before TakeHeld.
    void MakeReferencesLocal(TOwnPlaceSearch& place);

    /// Those that were held and those that waited, each once and in the document's order.
    std::vector<THeld> TakeHeld() noexcept { return std::exchange(fHeld, {}); }
    const std::vector<TDraft>& GetDrafts() const noexcept { return fDrafts; }
    std::vector<TDraft> TakeDrafts() noexcept { return std::exchange(fDrafts, {}); }

  private:
    bool fIsWaiting = false;
    std::vector<TDraft> fDrafts;
    std::vector<THeld> fHeld;
    std::vector<std::pair<boost::shared_ptr<TInMemInstance>, std::uint32_t>> fReferences;
    std::size_t fDeclaredBefore = 0;  // classes, when the first reference was noted
};

}  // namespace NORVZEL20
