#include "embedded/load/TRepeatedInstances.h"

#include <algorithm>
#include <string>

#include "embedded/load/MessageText.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemExtent.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

namespace {

std::string ShowPath(const TInMemInstance& instance)
{
    return QuoteIfLong(instance.GetReference().ToText());
}

boost::shared_ptr<TInMemInstance> FindFirst(const TInMemInstance& repeated)
{
    std::vector<TCIMValue> keys;
    for (const std::uint32_t slot : repeated.GetInMemClass()->GetLayout().GetKeys()) {
        keys.push_back(repeated.GetSlotValue(slot));
    }
    return repeated.GetInMemClass()->GetExtent().Find(keys);
}

bool AreEqual(const TCIMValue& a, const TCIMValue& b)
{
    return a.IsNull() || b.IsNull() ? a.IsNull() && b.IsNull() : a == b;
}

/// The first property in which they differ; null if they are equal. Static properties have the same value anyway.
const TInMemPropertyDecl* FindDifference(const TInMemInstance& a, const TInMemInstance& b)
{
    const TInMemLayout& layout = a.GetInMemClass()->GetLayout();
    for (const std::uint32_t slot : layout.GetOrder()) {
        if (!layout.GetDecl(slot).IsStatic() && !AreEqual(a.GetSlotValue(slot), b.GetSlotValue(slot))) {
            return &layout.GetDecl(slot);
        }
    }
    return nullptr;
}

std::string ShowValue(const TInMemInstance& instance, const TInMemPropertyDecl& decl)
{
    const TCIMValue value = instance.GetSlotValue(instance.GetInMemClass()->GetLayout().FindSlot(decl.GetName()));
    return value.IsNull() ? "NULL" : Quote(value.ToText());
}

}  // namespace

void TRepeatedInstances::NoteAdded(const TInMemClass& cls, const TLoadPlace& place)
{
    if (&cls != fLastClass) {
        fLastClass = &cls;
        fLast = &fPlaces[&cls];
    }
    if (fLast->places.empty()) {
        fLast->before = cls.GetExtent().GetCount() - 1;
    }
    fLast->places.push_back({static_cast<std::uint32_t>(place.document), static_cast<std::uint32_t>(place.place.line),
                             static_cast<std::uint32_t>(place.place.column)});
}

std::optional<TLoadPlace> TRepeatedInstances::FindPlace(const TInMemInstance& instance) const
{
    const auto known = fPlaces.find(instance.GetInMemClass().get());
    if (known == fPlaces.end()) {
        return std::nullopt;
    }
    std::size_t position = 0;
    instance.GetInMemClass()->GetExtent().Enumerate([&](const boost::shared_ptr<ICIMInstance>& next) {
        position += next.get() != &instance ? 1 : 0;
        return next.get() != &instance;
    });
    if (position < known->second.before || position - known->second.before >= known->second.places.size()) {
        return std::nullopt;
    }
    const TPlace& place = known->second.places[position - known->second.before];
    return TLoadPlace{place.document, {place.line, place.column}};
}

void TRepeatedInstances::NoteRepeated(const boost::shared_ptr<TInMemInstance>& repeated)
{
    const TInMemClass& cls = *repeated->GetInMemClass();
    if (cls.GetLayout().GetKeys().empty()) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second instance of class " + Quote(cls.GetName()) +
                                                   ", which has no key to tell them apart; give its whole declaration, with the"
                                                   " qualifiers and those of its superclasses");
    }
    const boost::shared_ptr<TInMemInstance> first = FindFirst(*repeated);
    if (!first || !FindPlace(*first)) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second instance " + ShowPath(*repeated) + "; instances of class " +
                                                   Quote(cls.GetName()) + " must differ in their keys");
    }
    fRepeats.push_back({first, repeated, fContext.GetPlace()});
}

void TRepeatedInstances::Check()
{
    for (const TRepeat& repeat : fRepeats) {
        const TLoadContext::TAt at(fContext, repeat.place);
        Compare(repeat);
    }
}

void TRepeatedInstances::Compare(const TRepeat& repeat)
{
    const std::string path = ShowPath(*repeat.repeated);
    if (const TInMemPropertyDecl* const decl = FindDifference(*repeat.first, *repeat.repeated)) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second instance " + path + " with " + ShowValue(*repeat.repeated, *decl) +
                                                   " in property " + Quote(decl->GetName()) + ", but the one at " +
                                                   fContext.Describe(*FindPlace(*repeat.first)) + " has " +
                                                   ShowValue(*repeat.first, *decl) + "; remove one of the two");
    }
    fContext.Tolerate("repeated instance", "instance " + path + " is there again with the same values; taken as one");
}

bool TRepeatedInstances::Has(const TInMemInstance& instance) const noexcept
{
    return std::any_of(fRepeats.begin(), fRepeats.end(), [&](const TRepeat& repeat) { return repeat.repeated.get() == &instance; });
}

}  // namespace NORVZEL20
