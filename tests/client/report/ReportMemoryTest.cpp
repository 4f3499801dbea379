// What a report takes beyond the inventories and the records of the run. The meter counts every allocation of the process.

#include "client/commands/WriteReport.h"
#include "client/comparison/TComparison.h"
#include "client/comparison/TDifferenceList.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/report/EOutputFormat.h"
#include "tests/client/Documents.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TClientFixture.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {
namespace {

const int kInstances = 200;
const int kProperties = 24;

/// Compares two or three inventories of one class and measures how its report is written.
class ReportMemoryTest : public TClientFixture {
  protected:
    /// So many instances with so many properties each, of which the first ones, `changed` of them, have the text `value`.
    std::string Inventory(const std::string& name, int instances, int changed, const std::string& value)
    {
        std::string contents = KeyProperty("Id");
        for (int property = 0; property < kProperties; ++property) {
            contents += Declaration("P" + std::to_string(property), "string");
        }
        contents = System() + Class("Disk", "", contents);
        for (int instance = 0; instance < instances; ++instance) {
            std::string values = Value("Id", "disk-" + std::to_string(instance));
            for (int property = 0; property < kProperties; ++property) {
                const std::string own = fAreDistinct ? " of " + std::to_string(instance) : "";
                values += Value("P" + std::to_string(property), property < changed ? value + own : "the same everywhere");
            }
            contents += Instance("Disk", values);
        }
        return Scratch(name, Document(contents));
    }

    void Load(int instances, int changed)
    {
        std::vector<std::string> paths = {Inventory("a.xml", instances, changed, "a value of the first inventory"),
                                          Inventory("b.xml", instances, changed, fOther)};
        if (fHasThird) {
            paths.push_back(Inventory("c.xml", instances, changed, "a third value, the others differ too"));
        }
        fInventories = TInventoryLoader(fConsole).Load(SourcesOf(paths));
    }

    /// The most bytes that writing has in use at a time. The length of the report is added to fLength.
    std::size_t PeakOfWriting(EOutputFormat format, int instances, int changed)
    {
        Load(instances, changed);
        const TComparisonReport report = TComparison(fInventories, fConsole).Run(std::nullopt, false);
        EXPECT_EQ(static_cast<std::size_t>(instances * changed), report.differences->GetCounts().GetTotal());
        const TMemoryMeter meter;
        fLength = 0;
        TTextOptions options;
        options.isDetailed = true;
        WriteReport(report, format, options, [this](std::string_view piece) { fLength += piece.size(); });
        return meter.GetPeak();
    }

    TFakeConsole fConsole;
    std::vector<TInventory> fInventories;
    std::size_t fLength = 0;
    bool fHasThird = false;
    bool fAreDistinct = false;  // whether each instance has values of its own
    std::string fOther = "another value in the other one";
};

const EOutputFormat kFormats[] = {EOutputFormat::kText, EOutputFormat::kJson, EOutputFormat::kNdjson, EOutputFormat::kCimXml,
                                  EOutputFormat::kCsv};

// Each property that changed is a group with examples, which JSON holds from the beginning.
std::size_t GroupsOf(EOutputFormat format, int changed)
{
    constexpr std::size_t kGroup = 2048;
    const bool hasGroups = format == EOutputFormat::kJson || format == EOutputFormat::kNdjson;
    return hasGroups ? static_cast<std::size_t>(changed) * kGroup : 0;
}

TEST_F(ReportMemoryTest, MoreDifferencesTakeNoMoreMemory)
{
    for (const bool hasThird : {false, true}) {
        fHasThird = hasThird;
        for (const EOutputFormat format : kFormats) {
            const std::size_t peakOfFew = PeakOfWriting(format, kInstances, 1);
            const std::size_t lengthOfFew = fLength;
            const std::size_t peakOfMany = PeakOfWriting(format, kInstances, kProperties);
            EXPECT_LT(200000u, fLength - lengthOfFew) << static_cast<int>(format);
            EXPECT_GT(peakOfFew + 4096 + GroupsOf(format, kProperties), peakOfMany) << static_cast<int>(format);
        }
    }
}

TEST_F(ReportMemoryTest, AnInstanceMoreTakesItsEntryInAnIndexOfEachInventory)
{
    for (const EOutputFormat format : {EOutputFormat::kText, EOutputFormat::kJson, EOutputFormat::kNdjson, EOutputFormat::kCsv}) {
        const std::size_t peakOfFew = PeakOfWriting(format, kInstances, 1);
        const std::size_t peakOfMany = PeakOfWriting(format, 5 * kInstances, 1);
        // 24 bytes for an entry, and while the second index is made and sorted, as many again and a list of the instances.
        EXPECT_GT(4U * kInstances * 100, peakOfMany - peakOfFew) << static_cast<int>(format);
    }
}

TEST_F(ReportMemoryTest, AChangeThatIsLikeNoOtherTakesAnEntryInTheCounts)
{
    fAreDistinct = true;
    for (const EOutputFormat format : {EOutputFormat::kJson, EOutputFormat::kNdjson}) {
        const std::size_t peakOfFew = PeakOfWriting(format, kInstances, 1);
        const std::size_t peakOfMany = PeakOfWriting(format, 5 * kInstances, 1);
        EXPECT_GT(4U * kInstances * (100 + 80), peakOfMany - peakOfFew) << static_cast<int>(format);
        fOther = std::string(5000, 'x');
        const std::size_t peakOfLong = PeakOfWriting(format, 5 * kInstances, 1);
        fOther = "another value in the other one";
        EXPECT_GT(4U * kInstances * 5000 / 10, peakOfLong - peakOfMany) << static_cast<int>(format);
    }
}

TEST_F(ReportMemoryTest, JsonTakesNoMoreThanNdjson)
{
    const std::size_t ndjson = PeakOfWriting(EOutputFormat::kNdjson, kInstances, kProperties);
    const std::size_t json = PeakOfWriting(EOutputFormat::kJson, kInstances, kProperties);
    EXPECT_GT(ndjson + 512, json);
}

TEST_F(ReportMemoryTest, TheListHoldsAPointerForEachDifference)
{
    Load(kInstances, kProperties);
    const TComparisonReport report = TComparison(fInventories, fConsole).Run(std::nullopt, false);
    const auto rules = std::make_shared<TRules>(
        fInventories[0].ns, TRulesText{"rules", "<DifftoolSpec><class name='Disk' default='include'/></DifftoolSpec>", true});
    const TMemoryMeter meter;
    const TDifferenceList list(fInventories, rules, *report.records);
    const std::size_t differences = list.GetCounts().GetTotal();
    EXPECT_EQ(static_cast<std::size_t>(kInstances * kProperties), differences);
    // Bringing them in order takes less than a hundred bytes for each for a while. What stays is a pointer.
    EXPECT_GT(differences * 100, meter.GetPeak());
    EXPECT_GT(static_cast<std::ptrdiff_t>(differences * 36), meter.GetInUse());
}

}  // namespace
}  // namespace NORVZEL20
