// Gives a text to each reader of what an inventory is collected from. Whatever they make of it fits the declared classes and is
// written as a document that loads. Readers of tables make at most one thing of a line.

#include <algorithm>

#include "client/collect/TInventoryWriter.h"
#include "client/collect/read/ReadAccounts.h"
#include "client/collect/read/ReadCertificates.h"
#include "client/collect/read/ReadCrontab.h"
#include "client/collect/read/ReadDpkgStatus.h"
#include "client/collect/read/ReadHardware.h"
#include "client/collect/read/ReadModules.h"
#include "client/collect/read/ReadMountInfo.h"
#include "client/collect/read/ReadNetwork.h"
#include "client/collect/read/ReadOsRelease.h"
#include "client/collect/read/ReadRpmHeader.h"
#include "client/collect/read/ReadUnitFile.h"
#include "embedded/cimxml/TCimXmlPopulator.h"
#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

class TReaders {
  public:
    explicit TReaders(std::string_view input)
        : fInput(input), fLines(static_cast<std::size_t>(std::count(input.begin(), input.end(), '\n')) + 1)
    {}

    std::vector<TFacts> Read()
    {
        Take(&ReadUsers);
        Take(&ReadGroups);
        Take(&ReadDpkgStatus);
        Take(&ReadSwapAreas);
        Take(&ReadModules);
        TakeAll(ReadProcessors(fInput));
        if (const std::optional<TFacts> memory = ReadMemory(fInput)) {
            fFacts.push_back(*memory);
        }
        TReadFaults faults;
        TakeAll(ReadCertificates(fInput, std::string(fInput.substr(0, 10)), faults));
        TakePackage();
        TakeMounts();
        return fFacts;
    }

    void ReadRecords() const
    {
        Count(&ReadRoutes4);
        Count(&ReadRoutes6);
        Count(&ReadAddresses6);
        Count(&ReadSockets);
        Count(&ReadAnacrontab);
        TReadFaults faults;
        static_cast<void>(ReadCrontab(fInput, true, faults));
        static_cast<void>(ReadCrontab(fInput, false, faults));
        static_cast<void>(ReadOsRelease(fInput));
        static_cast<void>(SourcePackageOf(fInput));
        TUnitFile unit;
        ReadUnitFile(fInput, unit);
    }

  private:
    void TakeAll(const std::vector<TFacts>& facts) { fFacts.insert(fFacts.end(), facts.begin(), facts.end()); }

    void Take(std::vector<TFacts> (*read)(std::string_view, TReadFaults&)) { TakeAll(Count(read)); }

    template <class T>
    std::vector<T> Count(std::vector<T> (*read)(std::string_view, TReadFaults&)) const
    {
        TReadFaults faults;
        std::vector<T> things = read(fInput, faults);
        Promise(things.size() <= fLines, "a line makes at most one thing");
        Promise(faults.GetFirst().empty() == (faults.GetCount() == 0), "a fault is described");
        return things;
    }

    void TakePackage()
    {
        TRpmPackage package;
        std::string trouble;
        const bool isPackage = ReadRpmHeader(fInput, package, trouble);
        Promise(isPackage == trouble.empty(), "what is no header has a reason");
        if (isPackage) {
            fFacts.push_back(TFacts("KALMO_Package")
                                 .Key("Name", package.name)
                                 .Key("Architecture", package.architecture)
                                 .Key("Manager", "rpm")
                                 .Text("Vendor", package.vendor));
        }
    }

    void TakeMounts()
    {
        for (const TMount& mount : Count(&ReadMountInfo)) {
            fFacts.push_back(
                TFacts("KALMO_Mount").Key("Name", mount.path).Texts("Options", mount.options).Text("Source", mount.source));
        }
    }

    std::string_view fInput;
    std::size_t fLines;
    std::vector<TFacts> fFacts;
};

}  // namespace

void FuzzCollect(std::string_view input)
{
    TReaders readers(input);
    readers.ReadRecords();
    const std::vector<TFacts> all = readers.Read();
    if (all.empty()) {
        return;
    }
    std::string document;
    TInventoryWriter writer([&document](std::string_view piece) { document += piece; });
    std::size_t written = 0;
    for (const TFacts& facts : all) {
        written += writer.Add(facts) ? 1 : 0;
    }
    writer.End();
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    const TLoadReport report = TCimXmlPopulator(ns).LoadFromMemory(document.data(), document.size(), "collected");
    Promise(report.instances == written, "each instance that is written loads");
}

}  // namespace NORVZEL20
