// The records of a run are three kinds of instances in the delta namespace: a KALMO_DeltaClass for each class with differences, a
// KALMO_Delta for each difference, and a KALMO_DeltaClassAssocToDelta that joins a KALMO_Delta to its class:
//
//   KALMO_DeltaClass { ClassName }  <-- Class -- KALMO_DeltaClassAssocToDelta -- Delta -->  KALMO_Delta { Type, InstanceName, ... }
//
// One query lists the associations. Both ends of each are then fetched by their paths; since the associations of a class follow
// each other, the class's record is fetched only if the path has changed.
#include "client/comparison/ReadDeltaRecords.h"

#include <algorithm>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"
#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

template <class TCallback>
void EnumerateAll(TDeltaNamespace& ns, const std::string& recordClass, const TCallback& callback)
{
    std::string language = "WQL";
    std::string query = "SELECT * FROM " + recordClass;
    ns.ExecuteQuery(callback, language, query, TCallContext());
}

std::string TextOf(const ICIMInstance& instance, const char* property)
{
    return std::string(ValueOf(instance, property).GetString());
}

// Follows associations to both ends and keeps the records by class.
class TAssociationReader {
  public:
    TAssociationReader(TDeltaNamespace& ns, std::map<std::string, TDeltaInstances>& records) : fNamespace(ns), fRecords(records) {}

    void Read(const ICIMInstance& association)
    {
        const TCIMReference classPath = ValueOf(association, kDeltaAssociationClass);
        const std::string path = classPath.GetPath();
        if (fCurrent == nullptr || path != fCurrentPath) {
            fCurrentPath = path;
            fCurrent = &fRecords[TextOf(*fNamespace.GetInstance(classPath, TCallContext()), kClassRecordName)];
        }
        const TCIMReference deltaPath = ValueOf(association, kDeltaAssociationDelta);
        fCurrent->push_back(fNamespace.GetInstance(deltaPath, TCallContext()));
    }

  private:
    TDeltaNamespace& fNamespace;
    std::map<std::string, TDeltaInstances>& fRecords;
    std::string fCurrentPath;
    TDeltaInstances* fCurrent = nullptr;
};

std::vector<boost::shared_ptr<ICIMInstance>> RecordsOf(TDeltaNamespace& ns, const char* recordClass)
{
    return Collect<ICIMInstance>([&](const auto& callback) { EnumerateAll(ns, recordClass, callback); });
}

TCIMValue WithoutPositions(const TCIMValue& indices, const std::vector<std::size_t>& positions)
{
    std::vector<TCIMValue> kept = indices.GetElements();
    kept.erase(std::remove_if(kept.begin(), kept.end(),
                              [&positions](const TCIMValue& index) {
                                  return std::find(positions.begin(), positions.end(), index.GetUnsigned()) != positions.end();
                              }),
               kept.end());
    return TCIMValue(indices.GetType(), static_cast<unsigned int>(kept.size()), kept);
}

// Returns whether positions are left.
bool ReduceOrDelete(TDeltaNamespace& ns, const ICIMInstance& association, const std::vector<std::size_t>& positions)
{
    const TCIMReference path = ValueOf(association, kDeltaAssociationDelta);
    const TCIMValue kept = WithoutPositions(ValueOf(*ns.GetInstance(path, TCallContext()), kDeltaRecordIndices), positions);
    if (!kept.GetElements().empty()) {
        ns.ModifyInstance(path, {{kDeltaRecordIndices, kept}}, TCallContext());
        return true;
    }
    ns.DeleteInstance(association.GetReference(TCallContext()), TCallContext());
    ns.DeleteInstance(path, TCallContext());
    return false;
}

}  // namespace

std::map<std::string, TDeltaInstances> CollectDeltaRecords(TDeltaNamespace& ns)
{
    std::map<std::string, TDeltaInstances> records;
    TAssociationReader reader(ns, records);
    EnumerateAll(ns, kDeltaAssociation, [&reader](const boost::shared_ptr<ICIMInstance>& association) {
        reader.Read(*association);
        return true;
    });
    return records;
}

TDeltaRecord ReadDeltaRecord(const ICIMInstance& delta)
{
    TDeltaRecord record;
    record.type = TypeOfRecord(delta);
    record.instanceName = TextOf(delta, kDeltaRecordInstance);
    record.property = TextOf(delta, kDeltaRecordProperty);
    const TCIMValue indices = ValueOf(delta, kDeltaRecordIndices);
    for (const TCIMValue& index : indices.GetElements()) {
        record.inventories.push_back(index.GetUnsigned());
    }
    // With excluded keys a position occurs once for each instance that shares the key.
    std::sort(record.inventories.begin(), record.inventories.end());
    record.inventories.erase(std::unique(record.inventories.begin(), record.inventories.end()), record.inventories.end());
    return record;
}

TDeltaNamespace::EDeltaType TypeOfRecord(const ICIMInstance& delta)
{
    return static_cast<TDeltaNamespace::EDeltaType>(ValueOf(delta, kDeltaRecordType).GetUnsigned());
}

TCIMValue InstanceOfRecord(const ICIMInstance& delta)
{
    return ValueOf(delta, kDeltaRecordInstance);
}

TCIMValue PropertyOfRecord(const ICIMInstance& delta)
{
    return ValueOf(delta, kDeltaRecordProperty);
}

bool ReadLastDeltaRecord(TDeltaNamespace& ns, std::string& className, TDeltaRecord& record)
{
    const std::vector<boost::shared_ptr<ICIMInstance>> classes = RecordsOf(ns, kClassRecord);
    const std::vector<boost::shared_ptr<ICIMInstance>> deltas = RecordsOf(ns, kDeltaRecord);
    if (classes.empty() || deltas.empty()) {
        return false;
    }
    className = TextOf(*classes.back(), kClassRecordName);
    record = ReadDeltaRecord(*deltas.back());
    return true;
}

void RemovePosition(TDeltaNamespace& ns, std::size_t position)
{
    // Collected first: changing instances during their enumeration is not allowed.
    for (const boost::shared_ptr<ICIMInstance>& delta : RecordsOf(ns, kDeltaRecord)) {
        const TCIMValue kept = WithoutPositions(ValueOf(*delta, kDeltaRecordIndices), {position});
        ns.ModifyInstance(delta->GetReference(TCallContext()), {{kDeltaRecordIndices, kept}}, TCallContext());
    }
}

void RemovePositionsOf(TDeltaNamespace& ns, const std::string& className, const std::vector<std::size_t>& positions)
{
    for (const boost::shared_ptr<ICIMInstance>& record : RecordsOf(ns, kClassRecord)) {
        if (!TNameText::Equal(TextOf(*record, kClassRecordName), className)) {
            continue;
        }
        const TCIMReference path = record->GetReference(TCallContext());
        bool isAnyLeft = false;
        for (const boost::shared_ptr<ICIMInstance>& association : RecordsOf(ns, kDeltaAssociation)) {
            const TCIMReference ofClass = ValueOf(*association, kDeltaAssociationClass);
            if (ofClass.GetPath() == path.GetPath()) {
                isAnyLeft = ReduceOrDelete(ns, *association, positions) || isAnyLeft;
            }
        }
        if (!isAnyLeft) {
            ns.DeleteInstance(path, TCallContext());
        }
    }
}

}  // namespace NORVZEL20
