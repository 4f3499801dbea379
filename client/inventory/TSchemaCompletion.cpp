// How the schemas become one.
//
// Every inventory in turn is the source. Its classes are taken in the order of their declaration, superclasses first, to each other
// inventory, the target:
//   the target lacks the class              it is declared there, with the superclasses that are missing too
//   the target lacks a property             it is declared there
//   the target spells a name otherwise      it gets the source's spelling, if the source comes first
//   a type or the keys differ               that is noted, once for each pair of inventories
// What an early source declares in a later one is there when that one is the source; so one pass over all makes the union.
//
// Stored references name classes and keys. Those of changed inventories are rewritten at the end. Notes are sorted, because
// they arise in the order of declaration, which depends on the tool that wrote the file.
#include "client/inventory/TSchemaCompletion.h"

#include <algorithm>
#include <set>
#include <tuple>

#include "client/process/TClientError.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/store/TSchemaCopier.h"
#include "embedded/store/TSchemaLimitError.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

std::vector<std::string> KeysInLowerCase(const TInMemClass& cls)
{
    std::vector<std::string> keys;
    for (const std::uint32_t slot : cls.GetLayout().GetKeys()) {
        keys.push_back(TNameText::ToLower(cls.GetLayout().GetDecl(slot).GetName()));
    }
    std::sort(keys.begin(), keys.end());
    return keys;
}

// Why a property cannot be declared in `cls`: which class below declares it with another type.
std::string DescribeConflict(const TInMemClass& cls, const TInMemPropertyDecl& property)
{
    for (const boost::shared_ptr<TInMemClass>& below : cls.GetClassesBelow()) {
        const boost::shared_ptr<TInMemPropertyDecl> other = below->FindPropertyDecl(property.GetName());
        if (other && other->GetType() != property.GetType()) {
            return "class " + below->GetName() + " below it has one of that name with the type " +
                   TValueText::DescribeType(other->GetType()) + " instead of " + TValueText::DescribeType(property.GetType());
        }
    }
    return "the declarations do not fit together";
}

}  // namespace

std::vector<TSchemaNote> TSchemaCompletion::Run()
{
    fNotes.clear();
    for (std::size_t source = 0; source < fInventories.size(); ++source) {
        // A copy of the list: if one namespace is passed twice, declaring in the target changes the source's list as well.
        const std::vector<boost::shared_ptr<TInMemClass>> classes = fInventories[source].ns->GetClasses();
        for (const boost::shared_ptr<TInMemClass>& cls : classes) {
            for (std::size_t target = 0; target < fInventories.size(); ++target) {
                if (target != source) {
                    SpreadWithinLimits(source, *cls, target);
                }
            }
        }
    }
    AdaptReferences();
    SortNotes();
    return fNotes;
}

void TSchemaCompletion::SpreadWithinLimits(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    try {
        Spread(source, cls, target);
    } catch (const TSchemaLimitError& error) {
        Refuse(source, "class " + cls.GetName(), target, error.what());
    }
}

void TSchemaCompletion::Spread(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    const boost::shared_ptr<TInMemClass> there = fInventories[target].ns->FindClass(cls.GetName());
    if (!there) {
        Declare(source, cls, target);
        return;
    }
    // The first inventory decides the spelling; and what differs is noted once, not a second time in the other direction.
    if (target > source) {
        Respell(source, cls, target);
        if (KeysInLowerCase(cls) != KeysInLowerCase(*there)) {
            Note(TSchemaNote::kKeysDiffer, target, source, cls.GetName(), std::string());
        }
    }
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        const TInMemPropertyDecl& property = cls.GetLayout().GetDecl(slot);
        const boost::shared_ptr<TInMemPropertyDecl> counterpart = there->FindPropertyDecl(property.GetName());
        if (!counterpart) {
            DeclareProperty(source, property, target, *there);
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
        Refuse(source, "class " + cls.GetName(), target,
               error.what() + std::string("; a superclass has a property of another type in the two inventories"));
    }
}

void TSchemaCompletion::DeclareProperty(std::size_t source, const TInMemPropertyDecl& property, std::size_t target,
                                        TInMemClass& there)
{
    try {
        TSchemaCopier(fInventories[target].ns).CopyPropertyDecl(property, there);
    } catch (const TSchemaLimitError&) {
        throw;
    } catch (const TZELException&) {
        Refuse(source, "property " + property.GetName() + " of class " + there.GetName(), target,
               DescribeConflict(there, property) + "; give them one type in both inventories, or another name");
    }
    Note(TSchemaNote::kPropertyDeclared, target, source, there.GetName(), property.GetName());
}

void TSchemaCompletion::Respell(std::size_t source, const TInMemClass& cls, std::size_t target)
{
    TSchemaCopier copier(fInventories[target].ns);
    const boost::shared_ptr<TInMemClass> there = fInventories[target].ns->FindClass(cls.GetName());
    const std::string classBefore = there->GetName();
    if (copier.RespellClass(cls.GetName())) {
        Note(TSchemaNote::kClassRespelled, target, source, cls.GetName(), std::string(), classBefore);
    }
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        const std::string& name = cls.GetLayout().GetDecl(slot).GetName();
        const boost::shared_ptr<TInMemPropertyDecl> counterpart = there->FindPropertyDecl(name);
        const std::string before = counterpart ? counterpart->GetName() : name;
        if (before != name && copier.RespellProperty(*there, name)) {
            Note(TSchemaNote::kPropertyRespelled, target, source, cls.GetName(), name, before);
        }
    }
}

void TSchemaCompletion::Refuse(std::size_t source, const std::string& element, std::size_t target, const std::string& reason) const
{
    throw TClientError(fInventories[target].path + ": " + element + " of " + fInventories[source].path +
                       " cannot be declared here: " + reason);
}

void TSchemaCompletion::Note(TSchemaNote::EKind kind, std::size_t target, std::size_t source, const std::string& className,
                             const std::string& property, const std::string& before)
{
    fNotes.push_back({kind, target, source, className, property, before});
}

// Rewrites the stored references of the inventories whose declarations have changed.
void TSchemaCompletion::AdaptReferences()
{
    std::set<std::size_t> changed;
    for (const TSchemaNote& note : fNotes) {
        if (note.kind != TSchemaNote::kTypeDiffers && note.kind != TSchemaNote::kKeysDiffer) {
            changed.insert(note.inventory);
        }
    }
    for (const std::size_t inventory : changed) {
        const std::string twice = TReferenceAdapter::AdaptAndFindDuplicate(*fInventories[inventory].ns);
        if (!twice.empty()) {
            throw TClientError(fInventories[inventory].path + ": has two instances " + twice +
                               " once names are spelled and keys are declared as in the other inventories; remove one of them");
        }
    }
}

void TSchemaCompletion::SortNotes()
{
    const auto key = [](const TSchemaNote& note) {
        return std::tie(note.source, note.className, note.inventory, note.kind, note.property);
    };
    std::sort(fNotes.begin(), fNotes.end(), [&](const TSchemaNote& a, const TSchemaNote& b) { return key(a) < key(b); });
}

}  // namespace NORVZEL20
