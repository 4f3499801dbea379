// How the schemas become one.
//
// Every inventory in turn is the source. Its classes are taken in the order of their declaration, superclasses first, to each other
// inventory, the target:
//   the target lacks the class              it is declared there, with the superclasses that are missing too
//   the target lacks a property             it is declared there
//   the target spells a name otherwise      it gets the source's spelling, if the source comes first
//
// What an early source declares in a later one is there when that one is the source; so one pass over all makes the union.
//
// Most classes of a source bring nothing new. Once a class has been taken to all inventories, its names are noted (TAgreedNames),
// and a later source with the same names, or fewer, need not be compared with the others: inventories lose no declaration
// meanwhile. Only a spelling can change, if the classes above differ; the class is then forgotten and taken to all inventories once
// more. So N inventories with the same C classes cost N times C steps.
//
// One name is decided beforehand: the plug-in knows the time of collection, which it leaves out, in one spelling only. Stored
// references name classes and keys. Those of changed inventories are rewritten at the end.
#include "client/inventory/TSchemaCompletion.h"

#include <algorithm>
#include <set>

#include "client/process/TClientError.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/store/TSchemaCopier.h"
#include "embedded/store/TSchemaLimitError.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

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
    fAgreed = TAgreedNames();
    fComparisons = 0;
    SpellCollectionTimes();
    for (std::size_t source = 0; source < fInventories.size(); ++source) {
        // A copy of the list: if one namespace is passed twice, declaring in the target changes the source's list as well.
        const std::vector<boost::shared_ptr<TInMemClass>> classes = fInventories[source].ns->GetClasses();
        for (const boost::shared_ptr<TInMemClass>& cls : classes) {
            if (!fAgreed.Covers(*cls)) {
                SpreadToAll(source, *cls);
            }
        }
    }
    AdaptReferences();
    return fNotes;
}

void TSchemaCompletion::SpreadToAll(std::size_t source, const TInMemClass& cls)
{
    bool agree = true;
    for (std::size_t target = 0; target < fInventories.size(); ++target) {
        if (target != source) {
            ++fComparisons;
            SpreadWithinLimits(source, cls, target);
            agree = agree && Agrees(source, cls, target);
        }
    }
    if (agree) {
        fAgreed.Add(cls);
    } else {
        fAgreed.Forget(cls);
    }
}

// Whether the target has all names of the class, and will not be spelled anew by a source that spells them likewise. A class that
// was just declared may inherit another spelling from the classes above it there.
bool TSchemaCompletion::Agrees(std::size_t source, const TInMemClass& cls, std::size_t target) const
{
    const boost::shared_ptr<TInMemClass> there = fInventories[target].ns->FindClass(cls.GetName());
    const bool isSpellingFinal = target < source;
    const std::vector<std::uint32_t>& slots = cls.GetLayout().GetOrder();
    return (isSpellingFinal || there->GetName() == cls.GetName()) &&
           std::all_of(slots.begin(), slots.end(), [&](std::uint32_t slot) {
               const std::string& name = cls.GetLayout().GetDecl(slot).GetName();
               const std::uint32_t counterpart = there->GetLayout().FindSlot(name);
               return counterpart != TInMemLayout::kNoSlot &&
                      (isSpellingFinal || there->GetLayout().GetDecl(counterpart).GetName() == name);
           });
}

void TSchemaCompletion::SpellCollectionTimes()
{
    for (std::size_t inventory = 0; inventory < fInventories.size(); ++inventory) {
        TSchemaCopier copier(fInventories[inventory].ns);
        for (const boost::shared_ptr<TInMemClass>& cls : fInventories[inventory].ns->GetClasses()) {
            for (const boost::shared_ptr<TInMemPropertyDecl>& own : cls->GetLayout().GetOwnDecls()) {
                const std::string before = own->GetName();
                if (TNameText::Equal(before, kCollectionTime) && copier.RespellProperty(*cls, kCollectionTime)) {
                    Note(TSchemaNote::kPropertyRespelled, inventory, inventory, cls->GetName(), kCollectionTime, before);
                }
            }
        }
    }
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
    // The first inventory decides the spelling.
    if (target > source) {
        Respell(source, cls, target);
    }
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        const TInMemPropertyDecl& property = cls.GetLayout().GetDecl(slot);
        if (!there->FindPropertyDecl(property.GetName())) {
            DeclareProperty(source, property, target, *there);
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
            ForgetRespelled(*there, name);
        }
    }
}

// The classes below inherit the new spelling, also those that had the spelling of this source or an earlier one.
void TSchemaCompletion::ForgetRespelled(const TInMemClass& cls, const std::string& property)
{
    for (const boost::shared_ptr<TInMemClass>& below : cls.GetClassesBelow()) {
        fAgreed.Respelled(*below, below->FindPropertyDecl(property)->GetName());
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
        changed.insert(note.inventory);
    }
    for (const std::size_t inventory : changed) {
        const std::string twice = TReferenceAdapter::AdaptAndFindDuplicate(*fInventories[inventory].ns);
        if (!twice.empty()) {
            throw TClientError(fInventories[inventory].path + ": has two instances " + twice +
                               " once names are spelled and keys are declared as in the other inventories; remove one of them");
        }
    }
}

}  // namespace NORVZEL20
