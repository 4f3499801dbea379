#include "engine/TCIMDiffEngine.h"
#include "provider/DeltaNames.h"
#include "provider/TDeltaClass.h"

// A difference is stored as three kinds of instances in the delta namespace:
//
//     KALMO_DeltaClass               one for each class with differences
//     KALMO_Delta                    one for each difference: its kind, the instance, the property, the namespaces
//     KALMO_DeltaClassAssocToDelta   one for each KALMO_Delta, with references to it and to its KALMO_DeltaClass
//
// The engine sets no keys. The store generates them when an instance is added, so the association must be made last: before that,
// the two references would have no keys. All instances are plain instances of the delta namespace's store.
//
// If keys are excluded, a record may name an instance by a key text that is no object path. An alias on the class wrapper says
// which path the text stands for.

namespace NORVZEL20 {

namespace {

TCIMValue MakeIndexArray(const std::vector<int>& indices)
{
    std::vector<TCIMValue> elements(indices.size());
    for (std::size_t i = 0; i < indices.size(); ++i) {
        const TCIMValue element(static_cast<unsigned short>(indices[i]));
        elements[i] = element;
    }
    return TCIMValue(TCIMValue::TCIMType::kArrayUint16, static_cast<unsigned int>(elements.size()), elements);
}

TCIMValue MakeReferenceTo(const ICIMInstance& instance)
{
    TCIMReference path = instance.GetReference(TCallContext());
    return TCIMValue(path);
}

}  // namespace

void TCIMDiffEngine::SetProperty(ICIMInstance& instance, const std::string& name, const TCIMValue& value)
{
    instance.GetProperty(name, TCallContext())->SetValue(value, TCallContext());
}

boost::shared_ptr<ICIMInstance> TCIMDiffEngine::AllocateRecord(const std::string& className)
{
    const boost::shared_ptr<ICIMClass> cls = deltaNamespace->GetClass(className, TCallContext());
    return cls->AllocateInstance(TCallContext());
}

void TCIMDiffEngine::createCIMDiff(boost::shared_ptr<ICIMInstance> deltaClassRecord, TDeltaNamespace::EDeltaType type,
                                   std::string instanceName, std::string propertyName, std::vector<int> namespaceIndices)
{
    const boost::shared_ptr<ICIMInstance> delta = AllocateRecord(kDeltaRecord);
    SetProperty(*delta, kDeltaRecordType, TCIMValue(static_cast<unsigned char>(type)));
    SetProperty(*delta, kDeltaRecordInstance, TCIMValue(instanceName));
    SetProperty(*delta, kDeltaRecordProperty, TCIMValue(propertyName));
    SetProperty(*delta, kDeltaRecordIndices, MakeIndexArray(namespaceIndices));
    delta->AddToNamespace(TCallContext());

    const boost::shared_ptr<ICIMInstance> association = AllocateRecord(kDeltaAssociation);
    SetProperty(*association, kDeltaAssociationClass, MakeReferenceTo(*deltaClassRecord));
    SetProperty(*association, kDeltaAssociationDelta, MakeReferenceTo(*delta));
    association->AddToNamespace(TCallContext());
}

void TCIMDiffEngine::createObjectPathAlias(std::string className, std::string alias, const TCIMReference& path,
                                           unsigned int nsIndex)
{
    const TCIMValue index(static_cast<unsigned short>(nsIndex));
    TCallContext context;
    context[kNamespaceIndexEntry] = index;
    const boost::shared_ptr<ICIMClass> cls = deltaNamespace->GetClass(className, context);
    boost::dynamic_pointer_cast<TDeltaClass>(cls)->AddObjectPathAlias(alias, path);
}

}  // namespace NORVZEL20
