#pragma once

#include "host/Export.h"
#include "host/ICIMProperty.h"

namespace NORVZEL20 {

class TInMemPropertyDecl;

/// The value of a static property, which the class, its subclasses and all their instances share. Lives in its declaration.
///
/// Its marks and its earlier value are shared too.
class CIMDELTA_EXPORT TInMemStaticProperty : public ICIMProperty {
  public:
    /// All that changes.
    struct TState {
        TCIMValue value;
        TCIMValue earlier;  ///< before the first MarkChanged
        bool isChanged = false;
        bool isRemoved = false;
    };

    explicit TInMemStaticProperty(TInMemPropertyDecl& decl) noexcept : fDecl(decl) {}
    TInMemStaticProperty(const TInMemStaticProperty&) = delete;
    TInMemStaticProperty& operator=(const TInMemStaticProperty&) = delete;

    const TCIMValue& GetValue(TCallContext context) const override;
    void SetValue(const TCIMValue& value, TCallContext context) override;
    void MarkRemoved() override;
    void MarkChanged(const TCIMValue& value) override;
    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const override;

    const TCIMValue& GetValue() const noexcept { return fState.value; }
    void SetValue(const TCIMValue& value);
    /// See TInMemProperty::MarkStandIn.
    void MarkStandIn(const TCIMValue& value);
    bool IsChanged() const noexcept { return fState.isChanged; }
    bool IsRemoved() const noexcept { return fState.isRemoved; }
    /// What it held before the first MarkChanged; null if there was none.
    const TCIMValue* GetEarlierValue() const noexcept { return fState.isChanged ? &fState.earlier : nullptr; }

    const TState& GetState() const noexcept { return fState; }
    void SetState(const TState& state) noexcept { fState = state; }

  private:
    void KeepEarlier(const TCIMValue& earlier);

    TInMemPropertyDecl& fDecl;
    TState fState;
};

}  // namespace NORVZEL20
