#pragma once

#include <cstdint>

#include "host/Export.h"
#include "host/ICIMProperty.h"

namespace NORVZEL20 {

class TInMemInstance;

/// One property of an in-memory instance: 24 bytes, a virtual table and the value, in a row of properties.
///
/// Handles are shared pointers into the instance, which they keep alive.
class CIMDELTA_EXPORT TInMemProperty : public ICIMProperty {
  public:
    /// How many properties can stand in a row behind their instance.
    static constexpr std::uint32_t kMostBehindInstance = 128;
    /// How many properties can stand in one TInMemLateBlock.
    static constexpr std::uint32_t kMostInLateBlock = 32;

    TInMemProperty(const TInMemProperty&) = delete;
    TInMemProperty& operator=(const TInMemProperty&) = delete;

    /// Makes a null of that type at `position` of the row that begins directly behind an instance.
    static void MakeBehindInstance(void* memory, std::uint32_t position, TCIMValue::TCIMType type) noexcept;
    /// The same in a TInMemLateBlock.
    static void MakeInLateBlock(void* memory, std::uint32_t position, TCIMValue::TCIMType type) noexcept;
    /// Ends a property that one of the two has made.
    void Destroy() noexcept { this->TInMemProperty::~TInMemProperty(); }

    const TCIMValue& GetValue(TCallContext context) const final;
    void SetValue(const TCIMValue& value, TCallContext context) final;
    void MarkRemoved() final;
    void MarkChanged(const TCIMValue& value) final;
    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const final;

    const TCIMValue& GetValue() const noexcept { return fValue; }
    /// Writes the value in another way that means the same. If it is a key, the instance is found by the new value; the caller must
    /// then call TInMemNamespace::ReferenceTextsChanged. Errors: kTypeMismatch (13).
    void Rewrite(TCIMValue value);
    /// As MarkChanged, with a value of any type: what a comparison is to see in the place of the value. A key with a stand-in does
    /// not change which instance it is.
    void MarkStandIn(TCIMValue value);
    bool IsChanged() const noexcept { return GetEarlierValue() != nullptr; }
    bool IsRemoved() const noexcept;
    /// What the property held before the first MarkChanged; null if there was none. Valid until a property of the instance is
    /// marked or a key changes.
    const TCIMValue* GetEarlierValue() const noexcept;

  protected:
    struct TPlace {
        TInMemInstance* instance;
        std::uint32_t slot;
    };

    explicit TInMemProperty(TCIMValue::TCIMType type) noexcept : fValue(TCIMValue::Null(type)) {}
    ~TInMemProperty() override = default;

  private:
    friend class TInMemInstance;

    template <std::uint32_t kPosition>
    class TBehindInstance;
    template <std::uint32_t kPosition>
    class TInLateBlock;
    struct TMakers;

    /// Whose property it is and which.
    virtual TPlace GetPlace() const noexcept = 0;

    TCIMValue fValue;
};

static_assert(sizeof(TInMemProperty) == 24, "a virtual table and a value");

}  // namespace NORVZEL20
