#include "client/TSchemaCompletion.h"

#include <algorithm>

#include "client/TClientError.h"
#include "embedded/TNameText.h"
#include "embedded/TSchemaCopier.h"
#include "embedded/TSchemaLimitError.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

std::vector<std::string> KeysInLowerCase(const TInMemClass& cls)
{
    std::vector<std::string> keys;
    for (const std::uint32_t slot : cls.GetKeySlots()) {
        keys.push_back(TNameText::ToLower(cls.GetSlotDecl(slot).GetName()));
    }
    std::sort(keys.begin(), keys.end());
    return keys;
}

}  // namespace

std::vector<TSchemaNote> TSchemaCompletion::Run()
{
    fNotes.clear();
    for (std::size_t source = 0; source < fInventories.size(); ++source) {
        // Nothing is declared in the source itself meanwhile, but the list is copied: targets may be the same namespace.
        const std::vector<boost::shared_ptr<TInMemClass>> classes = fInventories[source].ns->GetClasses();
        for (const boost::shared_ptr<TInMemClass>& cls : classes) {
            for (std::size_t target = 0; target < fInventories.size(); ++target) {
                if (target != source) {
                    SpreadWithinLimits(source, *cls, target);
                }
            }
        }
    }
    return fNotes;
}

void TSchemaCompletion::SpreadWithinLimits(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    try {
        Spread(source, cls, target);
    } catch (const TSchemaLimitError& error) {
        throw TClientError(fInventories[target].path + ": class " + cls.GetName() + " of " + fInventories[source].path +
                           " cannot be declared here: " + error.what());
    }
}

void TSchemaCompletion::Spread(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    const boost::shared_ptr<TInMemClass> there = fInventories[target].ns->FindClass(cls.GetName());
    if (!there) {
        Declare(source, cls, target);
        return;
    }
    if (target > source) {
        Respell(source, cls, target);
        if (KeysInLowerCase(cls) != KeysInLowerCase(*there)) {
            Note(TSchemaNote::kKeysDiffer, target, source, cls.GetName(), std::string());
        }
    }
    TSchemaCopier copier(fInventories[target].ns);
    for (const std::uint32_t slot : cls.GetSlotOrder()) {
        const TInMemPropertyDecl& property = cls.GetSlotDecl(slot);
        const boost::shared_ptr<TInMemPropertyDecl> counterpart = there->FindPropertyDecl(property.GetName());
        if (!counterpart) {
            copier.CopyPropertyDecl(property, *there);
            Note(TSchemaNote::kPropertyDeclared, target, source, cls.GetName(), property.GetName());
        } else if (target > source && counterpart->GetType() != property.GetType()) {
            Note(TSchemaNote::kTypeDiffers, target, source, cls.GetName(), property.GetName());
        }
    }
}

void TSchemaCompletion::Declare(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    try {
        for (const boost::shared_ptr<TInMemClass>& declared : TSchemaCopier(fInventories[target].ns).CopyClass(cls)) {
            Note(TSchemaNote::kClassDeclared, target, source, declared->GetName(), std::string());
        }
    } catch (const TSchemaLimitError&) {
        throw;
    } catch (const TZELException& error) {
        throw TClientError(fInventories[target].path + ": class " + cls.GetName() + " of " + fInventories[source].path +
                           " cannot be declared here: " + error.what() +
                           "; a superclass has a property of another type in the two inventories");
    }
}

void TSchemaCompletion::Respell(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    TSchemaCopier copier(fInventories[target].ns);
    const boost::shared_ptr<TInMemClass> there = fInventories[target].ns->FindClass(cls.GetName());
    const std::string classBefore = there->GetName();
    if (copier.RespellClass(cls.GetName())) {
        Note(TSchemaNote::kClassRespelled, target, source, cls.GetName(), std::string(), classBefore);
    }
    for (const std::uint32_t slot : cls.GetSlotOrder()) {
        const std::string& name = cls.GetSlotDecl(slot).GetName();
        const boost::shared_ptr<TInMemPropertyDecl> counterpart = there->FindPropertyDecl(name);
        const std::string before = counterpart ? counterpart->GetName() : name;
        if (before != name && copier.RespellProperty(*there, name)) {
            Note(TSchemaNote::kPropertyRespelled, target, source, cls.GetName(), name, before);
        }
    }
}

void TSchemaCompletion::Note(TSchemaNote::EKind kind, std::size_t target, std::size_t source, const std::string& className,
                             const std::string& property, const std::string& before)
{
    fNotes.push_back({kind, target, source, className, property, before});
}

}  // namespace NORVZEL20
