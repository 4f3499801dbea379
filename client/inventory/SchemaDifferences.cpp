#include "client/inventory/SchemaDifferences.h"

#include <algorithm>

#include "embedded/value/TNameText.h"

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
    TSchemaPair(const std::vector<TInventory>& inventories, std::size_t other, bool withSpelling, std::vector<TSchemaNote>& notes)
        : fReference(*inventories.front().ns), fOther(*inventories[other].ns), fPosition(other), fWithSpelling(withSpelling),
          fNotes(notes)
    {}

    void FindDifferences()
    {
        for (const boost::shared_ptr<TInMemClass>& cls : fReference.GetClasses()) {
            if (const boost::shared_ptr<TInMemClass> there = fOther.FindClass(cls->GetName())) {
                CompareClass(*cls, *there);
            }
        }
    }

  private:
    void CompareClass(const TInMemClass& cls, const TInMemClass& there)
    {
        TSchemaNote note{TSchemaNote::kSpellingDiffers, fPosition, 0, cls.GetName(), std::string(), there.GetName()};
        if (fWithSpelling && cls.GetName() != there.GetName()) {
            fNotes.push_back(note);
        }
        note.before.clear();
        if (KeysInLowerCase(cls) != KeysInLowerCase(there)) {
            note.kind = TSchemaNote::kKeysDiffer;
            fNotes.push_back(note);
        }
        if (!TNameText::Equal(SuperClassName(cls), SuperClassName(there))) {
            note.kind = TSchemaNote::kSuperClassDiffers;
            note.declared = SuperClassName(there);
            note.declaredInSource = SuperClassName(cls);
            fNotes.push_back(note);
        }
        for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
            const TInMemPropertyDecl& property = cls.GetLayout().GetDecl(slot);
            if (const boost::shared_ptr<TInMemPropertyDecl> counterpart = there.FindPropertyDecl(property.GetName())) {
                CompareProperty(cls, property, *counterpart);
            }
        }
    }

    void CompareProperty(const TInMemClass& cls, const TInMemPropertyDecl& property, const TInMemPropertyDecl& there)
    {
        TSchemaNote note{TSchemaNote::kSpellingDiffers, fPosition, 0, cls.GetName(), property.GetName(), there.GetName()};
        // The plug-in finds properties in any letter case, but the text of a key has the declared one.
        if (fWithSpelling && property.IsKey() && property.GetName() != there.GetName()) {
            fNotes.push_back(note);
        }
        note.before.clear();
        if (property.GetType() != there.GetType()) {
            note.kind = TSchemaNote::kTypeDiffers;
            fNotes.push_back(note);
        } else if (property.IsBag() != there.IsBag()) {
            note.kind = TSchemaNote::kArrayTypeDiffers;
            note.declared = ArrayTypeName(there);
            note.declaredInSource = ArrayTypeName(property);
            fNotes.push_back(note);
        }
    }

    const TInMemNamespace& fReference;
    const TInMemNamespace& fOther;
    std::size_t fPosition;
    bool fWithSpelling;
    std::vector<TSchemaNote>& fNotes;
};

}  // namespace

std::vector<TSchemaNote> FindSchemaDifferences(const std::vector<TInventory>& inventories, bool withSpelling)
{
    std::vector<TSchemaNote> notes;
    for (std::size_t other = 1; other < inventories.size(); ++other) {
        TSchemaPair(inventories, other, withSpelling, notes).FindDifferences();
    }
    return notes;
}

}  // namespace NORVZEL20
