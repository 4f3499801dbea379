// Writing keys and references again with other texts.
//
// A key that changes gives its instance another path, and a reference to that instance has to follow, wherever it stands. So both
// are changed in one pass by one rule. Every value that changes is kept with its place until the end. If the change fails, or two
// instances have one path after it, the values go back to their places. The index of an extent needs no change of its own:
// it is renewed when it is next needed.
#include "embedded/store/TKeyTexts.h"

#include <utility>
#include <vector>

#include "embedded/store/FindDuplicate.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/value/ChangeReferences.h"
#include "embedded/value/TValueAccess.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;
using TType = TCIMValue::TCIMType;

class TKeyTextChange {
  public:
    TKeyTextChange(TInMemNamespace& ns, const TKeyTexts::TChange& change) : fNamespace(ns), fChange(change) {}
    TKeyTextChange(const TKeyTextChange&) = delete;
    TKeyTextChange& operator=(const TKeyTextChange&) = delete;
    ~TKeyTextChange()
    {
        if (!fIsDone) {
            Undo();
        }
    }

    std::string Run()
    {
        for (const boost::shared_ptr<TInMemClass>& cls : fNamespace.GetClasses()) {
            ChangeStatics(*cls);
            ChangeInstances(*cls);
        }
        fNamespace.ReferenceTextsChanged();
        for (TInMemClass* const cls : fWithChangedKeys) {
            std::string duplicate = FindDuplicate(*cls);
            if (!duplicate.empty()) {
                return duplicate;
            }
        }
        fIsDone = true;
        return std::string();
    }

  private:
    struct TEarlier {
        TInMemProperty* property;
        TCIMValue value;
    };
    struct TEarlierStatic {
        TInMemStaticProperty* property;
        TInMemStaticProperty::TState state;
    };

    /// What was there before fits its property, so that putting it back needs no memory.
    void Undo() noexcept
    {
        for (TEarlier& earlier : fEarlier) {
            earlier.property->Rewrite(std::move(earlier.value));
        }
        for (const TEarlierStatic& earlier : fEarlierStatics) {
            earlier.property->SetState(earlier.state);
        }
        fNamespace.ReferenceTextsChanged();
    }

    /// Inherited static values are changed with the class that declares them.
    void ChangeStatics(const TInMemClass& cls)
    {
        for (const boost::shared_ptr<TInMemPropertyDecl>& decl : cls.GetLayout().GetOwnDecls()) {
            TInMemStaticProperty& property = decl->GetStaticProperty();
            TCIMValue value = property.GetValue();
            if (decl->IsStatic() && ChangeReferencesIn(value, cls)) {
                fEarlierStatics.push_back({&property, property.GetState()});
                property.SetValue(value);
            }
        }
    }

    void ChangeInstances(TInMemClass& cls)
    {
        cls.EnumerateInstances(
            [&](const boost::shared_ptr<ICIMInstance>& instance) {
                // An in-memory class has in-memory instances only.
                ChangeInstance(static_cast<TInMemInstance&>(*instance), cls);
                return true;
            },
            false, TCallContext());
    }

    void ChangeInstance(TInMemInstance& instance, TInMemClass& cls)
    {
        const TInMemLayout& layout = cls.GetLayout();
        for (const std::uint32_t slot : layout.GetOrder()) {
            const TInMemPropertyDecl& decl = layout.GetDecl(slot);
            const TType::ECIMType type = decl.GetType().GetElementType();
            if (decl.IsStatic() || (type != TType::kReference && type != TType::kString)) {
                continue;
            }
            const TCIMValue& stored = instance.GetSlotValue(slot);
            TCIMValue value;
            if (TAccess::IsText(stored)) {
                // Text in the place of a reference is a value that did not fit.
                if (!decl.IsKey() || type != TType::kString) {
                    continue;
                }
                value = fChange(TAccess::GetText(stored), {cls.GetName(), decl.GetName(), false});
            } else if (!stored.IsNull()) {
                TCIMValue copy = stored;
                value = ChangeReferencesIn(copy, cls) ? copy : TCIMValue();
            }
            if (!value.IsNull()) {
                Put(instance.GetSlotProperty(slot), std::move(value));
                if (decl.IsKey() && (fWithChangedKeys.empty() || fWithChangedKeys.back() != &cls)) {
                    fWithChangedKeys.push_back(&cls);
                }
            }
        }
    }

    void Put(TInMemProperty& property, TCIMValue value)
    {
        fEarlier.push_back({&property, property.GetValue()});
        property.Rewrite(std::move(value));
    }

    bool ChangeReferencesIn(TCIMValue& value, const TInMemClass& cls)
    {
        return ChangeReferences(value, [&](TCIMValue& path) { return ChangePath(path, cls); });
    }

    bool ChangePath(TCIMValue& value, const TInMemClass& cls)
    {
        const TCIMReference path = value;
        TCIMReference changed(path);
        bool isChanged = false;
        path.EnumerateKeyBindings([&](std::pair<std::string, TCIMValue> key) {
            TCIMValue now;
            if (TAccess::IsText(key.second)) {
                now = fChange(TAccess::GetText(key.second), {cls.GetName(), key.first, true});
            } else if (ChangeReferencesIn(key.second, cls)) {
                now = key.second;
            }
            if (!now.IsNull()) {
                changed.AddKeyValue(key.first, now);
                isChanged = true;
            }
            return true;
        });
        if (isChanged) {
            value = TCIMValue(changed);
        }
        return isChanged;
    }

    TInMemNamespace& fNamespace;
    const TKeyTexts::TChange& fChange;
    std::vector<TEarlier> fEarlier;
    std::vector<TEarlierStatic> fEarlierStatics;
    std::vector<TInMemClass*> fWithChangedKeys;
    bool fIsDone = false;
};

}  // namespace

std::string TKeyTexts::Change(const TChange& change)
{
    return TKeyTextChange(fNamespace, change).Run();
}

}  // namespace NORVZEL20
