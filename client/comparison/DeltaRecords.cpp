#include "client/comparison/DeltaRecords.h"

#include <algorithm>

#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

const TCIMValue& ValueOf(const ICIMInstance& instance, const char* property)
{
    return instance.GetProperty(property, TCallContext())->GetValue(TCallContext());
}

std::string TextOf(const ICIMInstance& instance, const char* property)
{
    return std::string(ValueOf(instance, property).GetString());
}

TDeltaRecord MakeRecord(const ICIMInstance& delta)
{
    TDeltaRecord record;
    record.type = static_cast<TDeltaNamespace::EDeltaType>(ValueOf(delta, kDeltaRecordType).GetUnsigned());
    record.instanceName = TextOf(delta, kDeltaRecordInstance);
    record.property = TextOf(delta, kDeltaRecordProperty);
    for (const TCIMValue& index : ValueOf(delta, kDeltaRecordIndices).GetElements()) {
        record.inventories.push_back(index.GetUnsigned());
    }
    std::sort(record.inventories.begin(), record.inventories.end());
    record.inventories.erase(std::unique(record.inventories.begin(), record.inventories.end()), record.inventories.end());
    return record;
}

// Follows associations to their two ends; the class record of the last one is likely that of the next.
class TAssociationReader {
  public:
    TAssociationReader(TDeltaNamespace& ns, std::map<std::string, std::vector<TDeltaRecord>>& records)
        : fNamespace(ns), fRecords(records)
    {}

    void Read(const ICIMInstance& association)
    {
        const TCIMReference classPath = ValueOf(association, kDeltaAssociationClass);
        const std::string path = classPath.GetPath();
        if (fCurrent == nullptr || path != fCurrentPath) {
            fCurrentPath = path;
            fCurrent = &fRecords[TextOf(*fNamespace.GetInstance(classPath, TCallContext()), kClassRecordName)];
        }
        const TCIMReference deltaPath = ValueOf(association, kDeltaAssociationDelta);
        fCurrent->push_back(MakeRecord(*fNamespace.GetInstance(deltaPath, TCallContext())));
    }

  private:
    TDeltaNamespace& fNamespace;
    std::map<std::string, std::vector<TDeltaRecord>>& fRecords;
    std::string fCurrentPath;
    std::vector<TDeltaRecord>* fCurrent = nullptr;
};

}  // namespace

std::map<std::string, std::vector<TDeltaRecord>> ReadDeltaRecords(TDeltaNamespace& ns)
{
    std::map<std::string, std::vector<TDeltaRecord>> records;
    TAssociationReader reader(ns, records);
    std::string language = "WQL";
    std::string query = std::string("SELECT * FROM ") + kDeltaAssociation;
    ns.ExecuteQuery(
        [&reader](boost::shared_ptr<ICIMInstance> association) {
            reader.Read(*association);
            return true;
        },
        language, query, TCallContext());
    return records;
}

}  // namespace NORVZEL20
