#include "tests/longrun/TRecordWriter.h"

#include "host/TAddToVectorCallback.h"
#include "tests/support/NoContext.h"

namespace NORVZEL20 {

namespace {

TCIMValue ValueOf(const ICIMInstance& instance, const std::string& name)
{
    return instance.GetProperty(name, kNoContext)->GetValue(kNoContext);
}

void Set(const ICIMInstance& instance, const std::string& name, const TCIMValue& value)
{
    instance.GetProperty(name, kNoContext)->SetValue(value, kNoContext);
}

TCIMValue PathOf(const ICIMInstance& instance)
{
    return TCIMValue(instance.GetReference(kNoContext));
}

TCIMValue MakeIndices(const std::vector<unsigned short>& indices)
{
    const std::vector<TCIMValue> elements(indices.begin(), indices.end());
    return TCIMValue(TCIMValue::TCIMType::kArrayUint16, static_cast<unsigned int>(elements.size()), elements);
}

}  // namespace

TRecordWriter::TRecordWriter(boost::shared_ptr<ICIMNamespace> source)
{
    std::vector<boost::shared_ptr<ICIMInstance>> ties;
    source->GetClass("KALMO_DeltaClassAssocToDelta", kNoContext)
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&ties), false, kNoContext);
    for (const auto& tie : ties) {
        const auto classRecord = source->GetInstance(TCIMReference(ValueOf(*tie, "Class")), kNoContext);
        const auto record = source->GetInstance(TCIMReference(ValueOf(*tie, "Delta")), kNoContext);
        const TCIMValue indices = ValueOf(*record, "NamespaceIndices");
        fDeltas.push_back({ValueOf(*classRecord, "ClassName").ToText(),
                           static_cast<unsigned char>(ValueOf(*record, "Type").GetUnsigned()),
                           ValueOf(*record, "InstanceName").ToText(),
                           ValueOf(*record, "Property").ToText(),
                           {indices.GetElements().begin(), indices.GetElements().end()}});
    }
}

void TRecordWriter::WriteInto(ICIMNamespace& target) const
{
    boost::shared_ptr<ICIMInstance> classRecord;
    std::string className;
    for (const TDelta& delta : fDeltas) {
        if (delta.className != className) {
            className = delta.className;
            classRecord = WriteClass(target, className);
        }
        WriteDelta(target, *classRecord, delta);
    }
}

boost::shared_ptr<ICIMInstance> TRecordWriter::WriteClass(ICIMNamespace& target, const std::string& name)
{
    const auto record = target.GetClass("KALMO_DeltaClass", kNoContext)->AllocateInstance(kNoContext);
    Set(*record, "ClassName", TCIMValue(name));
    record->AddToNamespace(kNoContext);
    return record;
}

void TRecordWriter::WriteDelta(ICIMNamespace& target, const ICIMInstance& classRecord, const TDelta& delta)
{
    const auto record = target.GetClass("KALMO_Delta", kNoContext)->AllocateInstance(kNoContext);
    Set(*record, "Type", TCIMValue(delta.type));
    Set(*record, "InstanceName", TCIMValue(delta.instanceName));
    Set(*record, "Property", TCIMValue(delta.property));
    Set(*record, "NamespaceIndices", MakeIndices(delta.indices));
    record->AddToNamespace(kNoContext);

    const auto tie = target.GetClass("KALMO_DeltaClassAssocToDelta", kNoContext)->AllocateInstance(kNoContext);
    Set(*tie, "Class", PathOf(classRecord));
    Set(*tie, "Delta", PathOf(*record));
    tie->AddToNamespace(kNoContext);
}

}  // namespace NORVZEL20
