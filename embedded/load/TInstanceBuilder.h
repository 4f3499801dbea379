#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "embedded/load/TClassQueue.h"
#include "embedded/load/TLateInstances.h"
#include "embedded/load/TLoadLayout.h"
#include "embedded/load/TLoadTarget.h"
#include "embedded/load/TRepeatedInstances.h"

namespace NORVZEL20 {

/// Fills instances of declared classes, one after the other, property by property.
///
/// Order of calls: Begin; FindProperty and SetProperty for each property, or Fill; Take.
/// Errors: every operation fails through the context.
class TInstanceBuilder {
  public:
    using TOwnKeys = std::vector<std::pair<std::string, TCIMValue>>;
    /// Returns a value with those of its texts read that are embedded objects.
    using TReadObjects = boost::function<TCIMValue(const TCIMValue&)>;

    /// All arguments must outlive the builder.
    TInstanceBuilder(TLoadContext& context, TInMemNamespace& ns, TInMemStaging& staging, TClassQueue& classes, TLateInstances& late,
                     TRepeatedInstances& repeats) noexcept
        : fContext(context), fNamespace(ns), fStaging(staging), fClasses(classes), fLate(late), fRepeats(repeats)
    {}

    /// Starts an instance; false if its class is not known yet.
    bool Begin(const char* className);
    /// Errors: kNotFound (15) if the class has no such property, kParseError (9) if the instance has had it already.
    TLoadTarget& FindProperty(const char* name);
    /// As FindProperty, for the property that is likely to come next. Returns null if the property did not note that tag last
    /// time, or if the instance has the property already.
    TLoadTarget* TakeLikely(std::uint64_t tagNumber) noexcept
    {
        TLoadTarget* const target = fExpected;
        return target != nullptr && target->tag.number == tagNumber && Take(*target) ? target : nullptr;
    }
    /// `isUnsettled` says that references in the value may have to be written again (see TCimXmlPathReader::TakeMetUnsettled). A
    /// value of another type is converted; if that would lose something, it is a bad value: see SetBad. Errors: those of SetBad;
    /// kParseError (9) if the property is static and another instance has given it another value.
    void SetProperty(const TLoadTarget& target, TCIMValue&& value, bool isUnsettled);
    /// As SetProperty for a value that does not fit the type that it is written with. It becomes what TLoadOptions::badValues says,
    /// and is counted. Errors: kTypeMismatch (13) if it would be NULL and is a key.
    void SetBad(const TLoadTarget& target, const TBadValue& bad);
    /// As SetProperty with a value that is not unsettled and not null. Returns false if there is more to do than to keep the value,
    /// which is then as it was; otherwise it is null now.
    bool FillProperty(const TLoadTarget& target, TCIMValue& value) noexcept
    {
        return target.isKeptAsIs && value.GetType() == target.type && fInstance->FillSlot(target.slot, value);
    }
    /// Begins the instance and sets all its properties. Call it for a draft when the document has ended. Errors: kNotFound (15) if
    /// its class is not declared; those of FindProperty and SetProperty.
    void Fill(const TDraft& draft, const TReadObjects& readObjects);
    /// Ends the instance. `ownKeys` (may be null) are the keys of the name in front of it, for those that it leaves out. Errors:
    /// kParseError (9) if the instance has another value there, or if they are not the keys of the class; none at all, or a class
    /// without keys, is no error.
    boost::shared_ptr<TInMemInstance> Take(const TOwnKeys* ownKeys);

    /// Whether the instances of the last instance's class are held; see TLateInstances::Hold.
    bool IsHeld() const noexcept { return fLayout->isHeld; }

  private:
    /// Notes that the instance has the property; false if it has had it.
    bool Take(TLoadTarget& target) noexcept
    {
        if (target.given == fNumber) {
            return false;
        }
        target.given = fNumber;
        fExpected = target.next;
        return true;
    }
    TLoadLayout* FindLayout(const char* className);
    void SetStatic(const TLoadTarget& target, const TCIMValue& value, bool fits);
    bool Convert(const TLoadTarget& target, const TCIMValue& value, TCIMValue& converted);
    bool ReadObjects(const TLoadTarget& target, const TCIMValue& written, const TReadObjects& readObjects, TCIMValue& value) const;
    bool Localize(TCIMValue& value) const;
    void FillDefaults();
    void UseKeys(const TOwnKeys& keys);
    void CheckKeyCount(const TOwnKeys& keys) const;
    std::uint32_t FindKey(const std::string& name) const;
    void FillKey(const TLoadTarget& target, const TCIMValue& value);
    void CheckKey(const TLoadTarget& target, const TCIMValue& value);

    TLoadContext& fContext;
    TInMemNamespace& fNamespace;
    TInMemStaging& fStaging;
    TClassQueue& fClasses;
    TLateInstances& fLate;
    TRepeatedInstances& fRepeats;
    TNameMap<std::unique_ptr<TLoadLayout>> fLayouts;  // by class name
    TLoadLayout* fLayout = nullptr;                   // of the instance being filled, or of the last one
    boost::shared_ptr<TInMemInstance> fInstance;
    std::set<const TInMemPropertyDecl*> fGivenStatics;  // those that an instance has given a value, or NULL
    std::uint32_t fNumber = 0;                          // of the instance, from 1
    TLoadTarget* fExpected = nullptr;                   // the property that is likely to come next, or null
};

}  // namespace NORVZEL20
