// Which property of which instance an object is.
//
// Instances have properties by the million, so a property must not take a word to say this. Its virtual table says it: each
// position in a row has a class of its own, whose only difference is the number in GetPlace. From the position follows where the
// row begins, and in front of the row is the instance or the head of the late block. The tables are 80 bytes for each position,
// once for all instances.

#include "embedded/store/TInMemProperty.h"

#include <array>
#include <new>
#include <utility>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemLateBlock.h"

namespace NORVZEL20 {

template <std::uint32_t kPosition>
class TInMemProperty::TBehindInstance final : public TInMemProperty {
  public:
    using TInMemProperty::TInMemProperty;

  private:
    TPlace GetPlace() const noexcept override { return {&TInMemInstance::GetOwner(*(this - kPosition)), kPosition}; }
};

template <std::uint32_t kPosition>
class TInMemProperty::TInLateBlock final : public TInMemProperty {
  public:
    using TInMemProperty::TInMemProperty;

  private:
    TPlace GetPlace() const noexcept override
    {
        const TInMemLateBlock& block = TInMemLateBlock::GetBlock(*(this - kPosition));
        return {&block.GetInstance(), block.GetFirst() + kPosition};
    }
};

struct TInMemProperty::TMakers {
    using TMaker = void (*)(void*, TCIMValue::TCIMType) noexcept;

    template <class TProperty>
    static void Make(void* memory, TCIMValue::TCIMType type) noexcept
    {
        static_assert(sizeof(TProperty) == sizeof(TInMemProperty), "the row is one of TInMemProperty");
        new (memory) TProperty(type);
    }
    template <template <std::uint32_t> class TProperty, std::uint32_t... kPositions>
    static constexpr std::array<TMaker, sizeof...(kPositions)> List(std::integer_sequence<std::uint32_t, kPositions...>)
    {
        return {&Make<TProperty<kPositions>>...};
    }
};

void TInMemProperty::MakeBehindInstance(void* memory, std::uint32_t position, TCIMValue::TCIMType type) noexcept
{
    static constexpr auto kMakers =
        TMakers::List<TBehindInstance>(std::make_integer_sequence<std::uint32_t, kMostBehindInstance>());
    kMakers[position](memory, type);
}

void TInMemProperty::MakeInLateBlock(void* memory, std::uint32_t position, TCIMValue::TCIMType type) noexcept
{
    static constexpr auto kMakers = TMakers::List<TInLateBlock>(std::make_integer_sequence<std::uint32_t, kMostInLateBlock>());
    kMakers[position](memory, type);
}

const TCIMValue& TInMemProperty::GetValue(TCallContext) const
{
    return fValue;
}

void TInMemProperty::SetValue(const TCIMValue& value, TCallContext)
{
    const TPlace place = GetPlace();
    place.instance->SetSlot(place.slot, value);
}

void TInMemProperty::MarkRemoved()
{
    const TPlace place = GetPlace();
    place.instance->MarkRemoved(place.slot);
}

void TInMemProperty::MarkChanged(const TCIMValue& value)
{
    const TPlace place = GetPlace();
    place.instance->MarkChanged(place.slot, place.instance->Fit(place.slot, TCIMValue(value)));
}

void TInMemProperty::MarkStandIn(TCIMValue value)
{
    const TPlace place = GetPlace();
    place.instance->MarkChanged(place.slot, std::move(value));
}

/// Unlike the others this keeps no earlier value and no key, because the value still means the same.
void TInMemProperty::Rewrite(TCIMValue value)
{
    const TPlace place = GetPlace();
    fValue = place.instance->Fit(place.slot, std::move(value));
}

boost::shared_ptr<const ICIMPropertyDecl> TInMemProperty::GetPropertyDecl(TCallContext) const
{
    const TPlace place = GetPlace();
    return place.instance->GetInMemClass()->GetLayout().GetSharedDecl(place.slot);
}

bool TInMemProperty::IsRemoved() const noexcept
{
    const TPlace place = GetPlace();
    return place.instance->IsMarkedRemoved(place.slot);
}

const TCIMValue* TInMemProperty::GetEarlierValue() const noexcept
{
    const TPlace place = GetPlace();
    return place.instance->FindEarlier(place.slot);
}

}  // namespace NORVZEL20
