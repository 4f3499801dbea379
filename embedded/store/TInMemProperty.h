#pragma once

#include <cstdint>

#include "host/Export.h"
#include "host/ICIMProperty.h"

namespace NORVZEL20 {

class TInMemInstance;

/// One property of an in-memory instance; 32 bytes inside a block of the instance (TInMemBlock).
///
/// Handles are shared pointers into the instance, which they keep alive.
class CIMDELTA_EXPORT TInMemProperty final : public ICIMProperty {
  public:
    TInMemProperty(std::uint32_t slot, std::uint32_t position, const TCIMValue& value) noexcept;
    TInMemProperty(const TInMemProperty&) = delete;
    TInMemProperty& operator=(const TInMemProperty&) = delete;

    const TCIMValue& GetValue(TCallContext context) const override;
    void SetValue(const TCIMValue& value, TCallContext context) override;
    void MarkRemoved() override;
    void MarkChanged(const TCIMValue& value) override;
    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const override;

    const TCIMValue& GetValue() const noexcept { return fValue; }
    /// Errors: kTypeMismatch (13).
    void SetValue(TCIMValue&& value);
    /// Writes the value in another way that means the same. If it is a key, the instance is found by the new value; the caller must
    /// then call TInMemNamespace::ReferenceTextsChanged. Errors: kTypeMismatch (13).
    void Rewrite(TCIMValue value);
    /// As MarkChanged, with a value of any type: what a comparison is to see in the place of the value. A key with a stand-in does
    /// not change which instance it is.
    void MarkStandIn(TCIMValue value);
    bool IsChanged() const noexcept { return fChanged; }
    bool IsRemoved() const noexcept { return fRemoved; }
    /// What the property held before the first MarkChanged; null if there was none. Valid until another property of the instance
    /// is changed.
    const TCIMValue* GetEarlierValue() const noexcept;

  private:
    TInMemInstance& GetInstance() const noexcept;
    void Change(TCIMValue&& fitting, bool isMarked);
    TCIMValue Fit(TCIMValue&& value) const;

    TCIMValue fValue;
    std::uint32_t fSlot;           // in the layout of the class
    std::uint32_t fPosition : 30;  // in its block of properties, by which the instance is found
    std::uint32_t fChanged : 1;
    std::uint32_t fRemoved : 1;
};

static_assert(sizeof(TInMemProperty) == 32, "a property takes half a cache line");

}  // namespace NORVZEL20
