// Differences are listed in one order, whatever the order of the records. A run writes records in few orders, so the test writes
// its own.

#include "client/comparison/TDifferenceList.h"

#include <algorithm>

#include "client/inventory/TInventoryLoader.h"
#include "provider/DeltaNames.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/client/Documents.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

using EType = TDeltaNamespace::EDeltaType;

/// Records of disks that the reference has as sda to sdc and the other inventory as sdb to sdd.
class DifferenceListTest : public TClientFixture {
  protected:
    using TPropertyValues = std::vector<std::pair<std::string, TCIMValue>>;

    struct TRecord {
        EType type;
        std::string instance;
        std::string property;
    };

    void SetUp() override
    {
        TClientFixture::SetUp();
        TFakeConsole console;
        fInventories = TInventoryLoader(console).Load(
            SourcesOf({Disks("a.xml", {"sda", "sdb", "sdc"}), Disks("b.xml", {"sdb", "sdc", "sdd"})}));
        fRules = std::make_shared<TRules>(
            fInventories[0].ns, TRulesText{"rules", "<DifftoolSpec><class name='Disk' default='include'/></DifftoolSpec>", true});
        fRecords = boost::dynamic_pointer_cast<TDeltaNamespace>(
            TDeltaNamespaceProvider::GetInstance()->AllocateNamespace(TCallContext(), false, std::string()));
    }

    std::string Disks(const std::string& name, const std::vector<std::string>& ids)
    {
        std::string contents =
            System() + Class("Disk", "", KeyProperty("Id") + Declaration("Size", "string") + Declaration("Vendor", "string"));
        for (const std::string& id : ids) {
            contents += Instance("Disk", Value("Id", id) + Value("Size", name) + Value("Vendor", name));
        }
        return Scratch(name, Document(contents));
    }

    boost::shared_ptr<ICIMInstance> AddRecord(const char* cls, const TPropertyValues& values)
    {
        const boost::shared_ptr<ICIMInstance> record = fRecords->GetClass(cls, TCallContext())->AllocateInstance(TCallContext());
        for (const auto& [name, value] : values) {
            record->GetProperty(name, TCallContext())->SetValue(value, TCallContext());
        }
        record->AddToNamespace(TCallContext());
        return record;
    }

    void WriteRecords(const std::vector<TRecord>& records)
    {
        const boost::shared_ptr<ICIMInstance> ofClass = AddRecord(kClassRecord, {{kClassRecordName, TCIMValue("Disk")}});
        const TCIMValue second(TCIMValue::TCIMType::kArrayUint16, 1, {TCIMValue(static_cast<unsigned short>(1))});
        for (const TRecord& record : records) {
            const boost::shared_ptr<ICIMInstance> delta =
                AddRecord(kDeltaRecord, {{kDeltaRecordType, TCIMValue(static_cast<unsigned char>(record.type))},
                                         {kDeltaRecordInstance, TCIMValue("Disk.Id=\"" + record.instance + "\"")},
                                         {kDeltaRecordProperty, TCIMValue(record.property)},
                                         {kDeltaRecordIndices, second}});
            AddRecord(kDeltaAssociation, {{kDeltaAssociationClass, TCIMValue(ofClass->GetReference(TCallContext()))},
                                          {kDeltaAssociationDelta, TCIMValue(delta->GetReference(TCallContext()))}});
        }
    }

    /// The differences, one a line.
    std::string List()
    {
        TDifferenceList list(fInventories, fRules, *fRecords);
        std::string text;
        list.ForEach([&text](const TDifference& difference) {
            text += difference.instance.substr(difference.instance.find('"')) + " " + std::to_string(difference.kind) +
                    (difference.values.empty() ? "" : " " + difference.values.front().property) + "\n";
        });
        return text;
    }

    std::vector<TInventory> fInventories;
    std::shared_ptr<TRules> fRules;
    boost::shared_ptr<TDeltaNamespace> fRecords;
};

TEST_F(DifferenceListTest, EveryOrderOfTheRecordsGivesTheSameList)
{
    const std::vector<TRecord> records = {{EType::kInstanceRemoved, "sda", ""},
                                          {EType::kInstanceAdded, "sdd", ""},
                                          {EType::kPropertyChanged, "sdb", "Size"},
                                          {EType::kPropertyChanged, "sdb", "Vendor"},
                                          {EType::kPropertyChanged, "sdc", "Vendor"}};
    std::vector<int> order = {0, 1, 2, 3, 4};
    do {
        SetUp();
        std::vector<TRecord> shuffled;
        for (const int position : order) {
            shuffled.push_back(records[static_cast<std::size_t>(position)]);
        }
        WriteRecords(shuffled);
        EXPECT_EQ("\"sda\" 0\n\"sdb\" 2 Size\n\"sdb\" 2 Vendor\n\"sdc\" 2 Vendor\n\"sdd\" 1\n", List());
    } while (!HasFailure() && std::next_permutation(order.begin(), order.end()));
}

TEST_F(DifferenceListTest, CountsComeBeforeTheDifferences)
{
    WriteRecords({{EType::kPropertyChanged, "sdc", "Size"},
                  {EType::kPropertyChanged, "sdb", "Size"},
                  {EType::kPropertyChanged, "sdb", "Vendor"},
                  {EType::kInstanceRemoved, "sda", ""},
                  {EType::kInstanceAdded, "sdd", ""}});
    const TDifferenceCounts counts = TDifferenceList(fInventories, fRules, *fRecords).GetCounts();
    EXPECT_EQ(1u, counts.onlyInReference);
    EXPECT_EQ(1u, counts.onlyInOthers);
    EXPECT_EQ(1u, counts.instancesOnlyInOthers);
    EXPECT_EQ(3u, counts.changedValues);
    EXPECT_EQ(2u, counts.changedInstances);
    EXPECT_EQ(5u, counts.GetTotal());
}

TEST_F(DifferenceListTest, IsReadAnewEachTime)
{
    WriteRecords({{EType::kPropertyChanged, "sdb", "Size"}});
    TDifferenceList list(fInventories, fRules, *fRecords);
    std::string values;
    for (int time = 0; time < 2; ++time) {
        list.ForEach([&values](const TDifference& difference) {
            values += difference.values.front().reference.ToText() + " -> " +
                      difference.values.front().others.front().value.ToText() + "\n";
        });
    }
    EXPECT_EQ("a.xml -> b.xml\na.xml -> b.xml\n", values);
}

TEST_F(DifferenceListTest, RecordsOfAnotherRunAreRefused)
{
    WriteRecords({{EType::kPropertyChanged, "sde", "Size"}});
    EXPECT_THROW(List(), std::out_of_range);
}

TEST_F(DifferenceListTest, NoRecordsMakeAnEmptyList)
{
    EXPECT_EQ("", List());
}

}  // namespace
}  // namespace NORVZEL20
