#include "client/collect/TInventoryWriter.h"

#include <utility>

#include "client/collect/LinuxClasses.h"
#include "embedded/mof/TMofPopulator.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemQualifierDecl.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

constexpr char kNamespaceName[] = "root/cimv2";

boost::shared_ptr<TInMemNamespace> LoadLinuxClasses()
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create(kNamespaceName);
    TMofPopulator(ns).LoadFromMemory(LinuxClasses().data(), LinuxClasses().size(), "LinuxClasses.mof");
    return ns;
}

void SetValue(ICIMInstance& instance, const TFacts::TValue& fact)
{
    const boost::shared_ptr<ICIMProperty> property = instance.GetProperty(fact.first, TCallContext());
    TCIMValue value;
    if (!TValueText::Convert(fact.second, property->GetValue(TCallContext()).GetType(), value)) {
        throw TZELException(TZELStatusCode(TZELStatusCode::kTypeMismatch));
    }
    property->SetValue(value, TCallContext());
}

std::string PathOf(const ICIMClass& cls, const ICIMInstance& instance)
{
    std::string path = cls.GetName(TCallContext());
    const auto append = [&](const std::string* key) {
        const TCIMValue& value = instance.GetProperty(*key, TCallContext())->GetValue(TCallContext());
        if (value.IsNull()) {
            throw TZELException(TZELStatusCode(TZELStatusCode::kKeyMissing));
        }
        path += '\n';
        value.AppendKeyText(path);
        return true;
    };
    cls.EnumerateKeyNames(append, TCallContext());
    return path;
}

}  // namespace

TInventoryWriter::TInventoryWriter(TCimXmlWriter::TSink sink) : fNamespace(LoadLinuxClasses()), fWriter(std::move(sink))
{
    fWriter.StartDocument(kNamespaceName);
    for (const boost::shared_ptr<TInMemQualifierDecl>& decl : fNamespace->GetQualifierDecls()) {
        fWriter.WriteQualifierDecl(*decl);
    }
    for (const boost::shared_ptr<TInMemClass>& cls : fNamespace->GetClasses()) {
        fWriter.WriteClass(*cls);
    }
}

bool TInventoryWriter::Add(const TFacts& facts)
{
    const boost::shared_ptr<ICIMClass> cls = fNamespace->GetClass(facts.GetClassName(), TCallContext());
    const boost::shared_ptr<ICIMInstance> instance = cls->AllocateInstance(TCallContext());
    for (const TFacts::TValue& fact : facts.GetValues()) {
        SetValue(*instance, fact);
    }
    if (!fPaths.insert(PathOf(*cls, *instance)).second) {
        return false;
    }
    fWriter.WriteInstance(*instance);
    return true;
}

}  // namespace NORVZEL20
