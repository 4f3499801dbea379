// What the schemas say otherwise than the reference, against which alone the plug-in compares.
//
// What the reference lacked it has from the completion: from the first inventory that declares it. That one is then the source,
// which the others are held against. What an inventory itself has from the completion is no statement of its own and is left out.
//
//   types, kinds of arrays   as the reference has them after the completion, inherited ones too
//   keys, superclass         as the inventory has them whose class the reference got; keys that were declared late do not count,
//                            because they have no values
#include "client/inventory/SchemaDifferences.h"

#include <algorithm>
#include <map>
#include <tuple>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

// Which inventory a declaration comes from.
class TDeclarationSources {
  public:
    explicit TDeclarationSources(const std::vector<TSchemaNote>& completed)
    {
        for (const TSchemaNote& note : completed) {
            if (note.kind == TSchemaNote::kClassDeclared || note.kind == TSchemaNote::kPropertyDeclared) {
                fSources.emplace(Key(note.inventory, note.className, note.property), note.source);
            }
        }
    }

    std::size_t OfClass(std::size_t inventory, const TInMemClass& cls) const
    {
        return Find(inventory, cls.GetName(), "", inventory);
    }

    std::size_t OfProperty(std::size_t inventory, const TInMemPropertyDecl& property) const
    {
        const TInMemClass& owner = *property.GetOwner();
        return Find(inventory, owner.GetName(), property.GetName(), OfClass(inventory, owner));
    }

  private:
    using TKey = std::tuple<std::size_t, std::string, std::string>;

    static TKey Key(std::size_t inventory, const std::string& className, const std::string& property)
    {
        return {inventory, TNameText::ToLower(className), TNameText::ToLower(property)};
    }

    std::size_t Find(std::size_t inventory, const std::string& className, const std::string& property, std::size_t otherwise) const
    {
        const auto source = fSources.find(Key(inventory, className, property));
        return source == fSources.end() ? otherwise : source->second;
    }

    std::map<TKey, std::size_t> fSources;
};

std::string SuperClassName(const TInMemClass& cls)
{
    return cls.GetSuperInMemClass() ? cls.GetSuperInMemClass()->GetName() : std::string();
}

// In the words of the qualifier ArrayType, of which Ordered and Indexed compare alike.
const char* ArrayTypeName(const TInMemPropertyDecl& array)
{
    return array.IsBag() ? "Bag" : "Ordered";
}

// Holds one inventory against the reference.
class TSchemaPair {
  public:
    TSchemaPair(const std::vector<TInventory>& inventories, std::size_t other, const TDeclarationSources& sources,
                bool withSpelling, std::vector<TSchemaNote>& notes)
        : fInventories(inventories), fOther(other), fSources(sources), fWithSpelling(withSpelling), fNotes(notes)
    {}

    void FindDifferences()
    {
        for (const boost::shared_ptr<TInMemClass>& cls : fInventories.front().ns->GetClasses()) {
            const boost::shared_ptr<TInMemClass> there = fInventories[fOther].ns->FindClass(cls->GetName());
            if (!there) {
                continue;
            }
            if (fSources.OfClass(fOther, *there) == fOther) {
                CompareClass(*cls, *there);
            }
            CompareProperties(*cls, *there);
        }
    }

  private:
    void CompareClass(const TInMemClass& cls, const TInMemClass& there)
    {
        const std::size_t source = fSources.OfClass(0, cls);
        TSchemaNote note{TSchemaNote::kSpellingDiffers, fOther, source, cls.GetName(), std::string(), there.GetName()};
        if (fWithSpelling && cls.GetName() != there.GetName()) {
            fNotes.push_back(note);
        }
        note.before.clear();
        const boost::shared_ptr<TInMemClass> decisive = fInventories[source].ns->FindClass(cls.GetName());
        if (KeysInLowerCase(source, *decisive) != KeysInLowerCase(fOther, there)) {
            note.kind = TSchemaNote::kKeysDiffer;
            fNotes.push_back(note);
        }
        if (!TNameText::Equal(SuperClassName(cls), SuperClassName(there))) {
            note.kind = TSchemaNote::kSuperClassDiffers;
            note.declared = SuperClassName(there);
            note.declaredInSource = SuperClassName(cls);
            fNotes.push_back(note);
        }
    }

    // The keys that the inventory itself declares.
    std::vector<std::string> KeysInLowerCase(std::size_t inventory, const TInMemClass& cls) const
    {
        std::vector<std::string> keys;
        for (const std::uint32_t slot : cls.GetLayout().GetKeys()) {
            const TInMemPropertyDecl& key = cls.GetLayout().GetDecl(slot);
            if (fSources.OfProperty(inventory, key) == inventory) {
                keys.push_back(TNameText::ToLower(key.GetName()));
            }
        }
        std::sort(keys.begin(), keys.end());
        return keys;
    }

    void CompareProperties(const TInMemClass& cls, const TInMemClass& there)
    {
        for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
            const TInMemPropertyDecl& property = cls.GetLayout().GetDecl(slot);
            if (const boost::shared_ptr<TInMemPropertyDecl> counterpart = there.FindPropertyDecl(property.GetName())) {
                CompareProperty(cls, property, *counterpart);
            }
        }
    }

    void CompareProperty(const TInMemClass& cls, const TInMemPropertyDecl& property, const TInMemPropertyDecl& there)
    {
        // The plug-in finds properties in any letter case, but the text of a key has the declared one.
        if (fWithSpelling && property.IsKey() && property.GetName() != there.GetName()) {
            NoteProperty(TSchemaNote::kSpellingDiffers, cls, property).before = there.GetName();
        }
        const bool sameType = property.GetType() == there.GetType();
        if ((sameType && property.IsBag() == there.IsBag()) || fSources.OfProperty(fOther, there) != fOther) {
            return;
        }
        if (!sameType) {
            NoteProperty(TSchemaNote::kTypeDiffers, cls, property);
            return;
        }
        TSchemaNote& note = NoteProperty(TSchemaNote::kArrayTypeDiffers, cls, property);
        note.declared = ArrayTypeName(there);
        note.declaredInSource = ArrayTypeName(property);
    }

    TSchemaNote& NoteProperty(TSchemaNote::EKind kind, const TInMemClass& cls, const TInMemPropertyDecl& property)
    {
        fNotes.push_back({kind, fOther, fSources.OfProperty(0, property), cls.GetName(), property.GetName(), std::string()});
        return fNotes.back();
    }

    const std::vector<TInventory>& fInventories;
    std::size_t fOther;
    const TDeclarationSources& fSources;
    bool fWithSpelling;
    std::vector<TSchemaNote>& fNotes;
};

std::vector<TSchemaNote> HoldAgainstReference(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& completed,
                                              bool withSpelling)
{
    const TDeclarationSources sources(completed);
    std::vector<TSchemaNote> notes;
    for (std::size_t other = 1; other < inventories.size(); ++other) {
        TSchemaPair(inventories, other, sources, withSpelling, notes).FindDifferences();
    }
    return notes;
}

}  // namespace

std::vector<TSchemaNote> FindSchemaDifferences(const std::vector<TInventory>& inventories,
                                               const std::vector<TSchemaNote>& completed)
{
    return HoldAgainstReference(inventories, completed, false);
}

std::vector<TSchemaNote> FindSchemaDifferencesAndSpelling(const std::vector<TInventory>& inventories)
{
    return HoldAgainstReference(inventories, {}, true);
}

}  // namespace NORVZEL20
