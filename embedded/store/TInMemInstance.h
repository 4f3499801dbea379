#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "embedded/store/TInMemProperty.h"
#include "host/Export.h"
#include "host/ICIMInstance.h"

namespace NORVZEL20 {

class TInMemClass;

/// An instance in memory: one block with the shared pointer's counts, the instance and its properties.
///
/// TInMemClass::AllocateInMemInstance makes it. A property that the class gets later is made when it is first asked for, and so are
/// those beyond the first TInMemProperty::kMostBehindInstance. Handles stay valid when the instance is deleted and when the
/// namespace goes; AddToNamespace then throws kNamespaceGone (18).
/// Threads: as the namespace, reading included.
class CIMDELTA_EXPORT TInMemInstance final : public ICIMInstance, public boost::enable_shared_from_this<TInMemInstance> {
  public:
    /// An instance of `cls` with every property null.
    static boost::shared_ptr<TInMemInstance> Create(boost::shared_ptr<TInMemClass> cls);
    TInMemInstance(const TInMemInstance&) = delete;
    TInMemInstance& operator=(const TInMemInstance&) = delete;
    ~TInMemInstance() override;

    /// Checks that AddToNamespace would succeed. Errors: those of AddToNamespace.
    void Validate(TCallContext context) const override;
    /// Generated keys that are null get the next number of the class first. Errors: also kInvalidParameter (5) if it is in a
    /// namespace. A TStoreRefusal says which instance and which key.
    void AddToNamespace(TCallContext context) override;
    TCIMReference GetReference(TCallContext context) const override;
    boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const override;
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const override;
    void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                             TCallContext context) const override;

    /// As the operations above, without context.
    TCIMReference GetReference() const;
    const boost::shared_ptr<TInMemClass>& GetInMemClass() const noexcept { return fClass; }
    /// The instance's own property of that name; null if the class declares none, and for a static one. Valid while the instance
    /// lives.
    TInMemProperty* FindProperty(std::string_view name) const;
    /// The property in a slot of the class (see TInMemLayout::FindSlot).
    TInMemProperty& GetSlotProperty(std::uint32_t slot) const;
    /// The value in a slot, also that of a static property.
    const TCIMValue& GetSlotValue(std::uint32_t slot) const;
    /// The same if the property stands behind the instance; otherwise null.
    const TCIMValue* FindOwnValue(std::uint32_t slot) const noexcept
    {
        return slot < fSlots ? &GetOwnProperties()[slot].GetValue() : nullptr;
    }
    /// Sets the property in a slot as ICIMProperty::SetValue does, without looking up a name. Errors: kTypeMismatch (13).
    void SetSlot(std::uint32_t slot, TCIMValue value);
    /// The same without checks, for an instance that is being made: not yet added, and still null in that slot. `value` must have
    /// the type that the property declares, and the property must not be static or a bag. Moves it away and returns true. Returns
    /// false and does nothing if the property does not stand behind the instance.
    bool FillSlot(std::uint32_t slot, TCIMValue& value) noexcept;

    /// Whether it is part of the namespace.
    bool IsAdded() const noexcept { return fAdded != 0; }
    /// The name of the first key without a value, which keeps the instance from being added; null if there is none.
    const std::string* FindMissingKey() const;
    /// The value of a key as it was when the instance was added, which counts while the instance is in the namespace.
    const TCIMValue& GetAddedKey(std::uint32_t slot) const;
    /// The hash of the keys as added.
    std::uint32_t GetKeyHash() const noexcept { return fKeyHash; }

    /// The value in the form in which the property in that slot holds it. Errors: kTypeMismatch (13).
    TCIMValue Fit(std::uint32_t slot, TCIMValue&& value) const;
    /// Sets the instance's own property in a slot, also to a value that does not fit its declared type; Fit checks that. While the
    /// instance is in a namespace, it keeps the first value that a key had. Errors: std::bad_alloc, and then nothing has changed.
    void Change(std::uint32_t slot, TCIMValue&& fitting);
    /// The same; the value before the first such change is kept.
    void MarkChanged(std::uint32_t slot, TCIMValue&& fitting);
    /// The value before the first MarkChanged, or null.
    const TCIMValue* FindEarlier(std::uint32_t slot) const noexcept;
    /// Errors: std::bad_alloc.
    void MarkRemoved(std::uint32_t slot);
    bool IsMarkedRemoved(std::uint32_t slot) const noexcept;

    /// The instance that the row of properties beginning with `first` stands behind.
    static TInMemInstance& GetOwner(const TInMemProperty& first) noexcept
    {
        // Operations that are const give out handles through which properties are changed.
        return *(const_cast<TInMemInstance*>(reinterpret_cast<const TInMemInstance*>(&first)) - 1);
    }

  private:
    friend class TInMemExtent;  // the owner: it alone says whether the instance is part of the namespace

    struct TExtras;  // what few instances have

    TInMemInstance(boost::shared_ptr<TInMemClass> cls, std::uint32_t slots) noexcept;
    TInMemProperty* GetOwnProperties() const noexcept;
    boost::shared_ptr<ICIMProperty> GetHandle(std::uint32_t slot, boost::shared_ptr<const TInMemInstance> self) const;
    TExtras& GetExtras() const;
    TInMemProperty& GetLateProperty(std::uint32_t slot) const;
    void SetAdded(std::uint32_t keyHash) noexcept;
    void SetRemoved() noexcept;

    boost::shared_ptr<TInMemClass> fClass;
    mutable std::unique_ptr<TExtras> fExtras;
    std::uint32_t fKeyHash = 0;
    std::uint32_t fSlots : 31;  // whose properties stand behind the instance
    std::uint32_t fAdded : 1;
};

}  // namespace NORVZEL20
