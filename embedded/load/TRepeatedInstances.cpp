#include "embedded/load/TRepeatedInstances.h"

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

/// The position in the extent of the class; kNoPosition if it is not there.
std::uint32_t FindFirst(const TInMemInstance& repeated)
{
    std::vector<TCIMValue> keys;
    for (const std::uint32_t slot : repeated.GetInMemClass()->GetLayout().GetKeys()) {
        keys.push_back(repeated.GetSlotValue(slot));
    }
    return repeated.GetInMemClass()->GetExtent().FindPosition(keys);
}

}  // namespace

void TRepeatedInstances::NoteAdded(const TInMemClass& cls, const TLoadPlace& place)
{
    if (&cls != fLastClass) {
        fLastClass = &cls;
        fLast = &fPlaces[&cls];
    }
    if (fLast->places.empty()) {
        fLast->before = cls.GetExtent().GetMark().size - 1;
    }
    fLast->places.push_back({static_cast<std::uint32_t>(place.document), static_cast<std::uint32_t>(place.place.line),
                             static_cast<std::uint32_t>(place.place.column)});
}

/// Null if the load has not added what stands there. Nothing is removed during a load, so the positions of what it adds follow one
/// another.
const TRepeatedInstances::TPlace* TRepeatedInstances::FindPlace(const TInMemClass& cls, std::uint32_t position) const
{
    const auto known = fPlaces.find(&cls);
    if (known == fPlaces.end() || position < known->second.before ||
        position - known->second.before >= known->second.places.size()) {
        return nullptr;
    }
    return &known->second.places[position - known->second.before];
}

void TRepeatedInstances::NoteRepeated(const boost::shared_ptr<TInMemInstance>& repeated)
{
    const TInMemClass& cls = *repeated->GetInMemClass();
    if (cls.GetLayout().GetKeys().empty()) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second instance of class " + Quote(cls.GetName()) +
                                                   ", which has no key to tell them apart; give its whole declaration, with the"
                                                   " qualifiers and those of its superclasses");
    }
    const std::uint32_t first = FindFirst(*repeated);
    const TPlace* const place = FindPlace(cls, first);
    if (place == nullptr) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second instance " + ShowPath(*repeated) + "; instances of class " +
                                                   Quote(cls.GetName()) + " must differ in their keys");
    }
    const TLoadPlace firstPlace = {place->document, {place->line, place->column}};
    fRepeats.push_back({cls.GetExtent().GetAt(first), firstPlace, repeated, fContext.GetPlace()});
}

void TRepeatedInstances::Check()
{
    for (const TRepeat& repeat : fRepeats) {
        const TLoadContext::TAt at(fContext, repeat.place);
        Compare(repeat);
    }
}

/// As it was written, if that did not fit its type.
const TCIMValue& TRepeatedInstances::ValueOf(const TInMemInstance& instance, std::uint32_t slot) const
{
    const auto lost = fLost.empty() ? fLost.end() : fLost.find({&instance, slot});
    return lost == fLost.end() ? instance.GetSlotValue(slot) : lost->second;
}

/// The first property in which they differ; null if they are equal. Static properties have the same value anyway.
const TInMemPropertyDecl* TRepeatedInstances::FindDifference(const TInMemInstance& a, const TInMemInstance& b) const
{
    const TInMemLayout& layout = a.GetInMemClass()->GetLayout();
    for (const std::uint32_t slot : layout.GetOrder()) {
        if (!layout.GetDecl(slot).IsStatic() && ValueOf(a, slot) != ValueOf(b, slot)) {
            return &layout.GetDecl(slot);
        }
    }
    return nullptr;
}

std::string TRepeatedInstances::Show(const TInMemInstance& instance, const TInMemPropertyDecl& decl) const
{
    const TCIMValue& value = ValueOf(instance, instance.GetInMemClass()->GetLayout().FindSlot(decl.GetName()));
    return value.IsNull() ? "NULL" : Quote(value.ToText());
}

void TRepeatedInstances::Compare(const TRepeat& repeat)
{
    const std::string path = ShowPath(*repeat.repeated);
    if (const TInMemPropertyDecl* const decl = FindDifference(*repeat.first, *repeat.repeated)) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second instance " + path + " with " + Show(*repeat.repeated, *decl) +
                                                   " in property " + Quote(decl->GetName()) + ", but the one at " +
                                                   fContext.Describe(repeat.firstPlace) + " has " + Show(*repeat.first, *decl) +
                                                   "; remove one of the two");
    }
    fContext.Tolerate("repeated instance", "instance " + path + " is there again with the same values; taken as one");
}

std::unordered_set<const TInMemInstance*> TRepeatedInstances::GetRepeated() const
{
    std::unordered_set<const TInMemInstance*> repeated;
    for (const TRepeat& repeat : fRepeats) {
        repeated.insert(repeat.repeated.get());
    }
    return repeated;
}

}  // namespace NORVZEL20
