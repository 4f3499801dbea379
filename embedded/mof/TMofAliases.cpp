// Aliases.
//
// An alias stands for the path of its instance. A path is the class with the values of its keys, and a key may be a reference by an
// alias again, also to an instance further down in the document. So paths are made when they are asked for, each once; making one
// asks for those in its keys.
#include "embedded/mof/TMofAliases.h"

#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/mof/TMofLimits.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

TMofAliases::TMofAliases(TLoadContext& context, const TInMemNamespace& ns, const std::vector<const TMofInstance*>& instances,
                         TMofTyping::TResolve resolve)
    : fContext(context), fNamespace(ns), fResolve(std::move(resolve))
{
    for (const TMofInstance* instance : instances) {
        TEntry& entry = fEntries[instance->alias];
        if (entry.instance != nullptr && entry.instance != instance) {
            const TLoadContext::TAt at(fContext, instance->place);
            const TLoadPlace& first = entry.instance->place;
            fContext.Fail(EStatus::kParseError, "found the alias $" + instance->alias + " a second time, after " +
                                                    fContext.GetDocument(first.document) + ":" + std::to_string(first.place.line) +
                                                    "; name one of the two otherwise");
        }
        entry.instance = instance;
    }
}

/// An alias whose reference is being made. The load may go on after a failure, if it was about the text of an embedded object.
class TMofAliases::TOpen {
  public:
    TOpen(TEntry& entry, std::size_t& depth) noexcept : fEntry(entry), fDepth(depth)
    {
        entry.isOpen = true;
        ++depth;
    }
    TOpen(const TOpen&) = delete;
    TOpen& operator=(const TOpen&) = delete;
    ~TOpen()
    {
        fEntry.isOpen = false;
        --fDepth;
    }

  private:
    TEntry& fEntry;
    std::size_t& fDepth;
};

const TCIMValue& TMofAliases::GetReference(const std::string& alias)
{
    const auto known = fEntries.find(alias);
    if (known == fEntries.end()) {
        fContext.Fail(EStatus::kNotFound,
                      "found the alias $" + alias + ", but no instance of the document has it; declare one \"as $" + alias + "\"");
    }
    TEntry& entry = known->second;
    if (entry.isOpen) {
        fContext.Fail(EStatus::kParseError, "found the alias $" + alias + " in the keys of its own instance");
    }
    if (entry.reference.IsNull()) {
        if (fDepth == TMofLimits::kMaxPathDepth) {
            fContext.Fail(EStatus::kParseError, "found aliases in each other's keys more than " +
                                                    std::to_string(TMofLimits::kMaxPathDepth) + " deep, expected fewer levels");
        }
        const TOpen open(entry, fDepth);
        entry.reference = MakeReference(*entry.instance);
    }
    return entry.reference;
}

TCIMValue TMofAliases::MakeReference(const TMofInstance& instance)
{
    const boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(instance.className);
    if (!cls) {
        fContext.Fail(EStatus::kNotFound,
                      "found the alias $" + instance.alias + " of an instance of class " + Quote(instance.className) +
                          fContext.DescribeUndeclared(),
                      EAdvice::kGiveDeclaration);
    }
    TCIMReference path;
    path.SetClass(cls);
    for (const std::uint32_t slot : cls->GetLayout().GetKeys()) {
        const TInMemPropertyDecl& decl = cls->GetLayout().GetDecl(slot);
        TCIMValue key = ReadKey(instance, decl);
        if (key.IsNull()) {
            fContext.Fail(EStatus::kKeyMissing, "found the alias $" + instance.alias +
                                                    " of an instance without a value for its key " + Quote(decl.GetName()) +
                                                    "; every key needs one");
        }
        TValueAccess::LimitDepth(key, TReferenceAdapter::kLevelsAbove);
        path.AddKeyValue(decl.GetName(), key);
    }
    return TCIMValue(path);
}

TCIMValue TMofAliases::ReadKey(const TMofInstance& instance, const TInMemPropertyDecl& decl)
{
    const TMofInstance::TProperty* property = instance.FindProperty(decl.GetName());
    if (property == nullptr) {
        return decl.GetDefaultValue();
    }
    const TLoadContext::TAt at(fContext, property->place);
    TCIMValue value;
    TCIMValue guessed;
    if (TMofTyping::Read(property->value, decl.GetType(), fResolve, value) ||
        (TMofTyping::Guess(property->value, fResolve, guessed) && TValueText::Convert(guessed, decl.GetType(), value))) {
        return value;
    }
    fContext.Fail(EStatus::kTypeMismatch, "found " + TMofTyping::Describe(property->value) + " in property " +
                                              Quote(property->name) + ", which class " + Quote(instance.className) +
                                              " declares as " + TValueText::DescribeType(decl.GetType()));
}

}  // namespace NORVZEL20
