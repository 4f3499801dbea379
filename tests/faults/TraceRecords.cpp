#include "tests/faults/TraceRecords.h"

#include <set>

#include "tests/support/InstanceAccess.h"

namespace NORVZEL20 {

namespace {

std::string PathOf(const ICIMInstance& instance)
{
    return instance.GetReference(TCallContext()).GetPath();
}

std::string RecordText(const ICIMInstance& record)
{
    return ValueOf(record, "Type").ToText() + " " + ValueOf(record, "InstanceName").ToText() + " " +
           ValueOf(record, "Property").ToText() + " " + ValueOf(record, "NamespaceIndices").ToText();
}

/// Merges the three kinds of records into the order of writing. A class record comes before the first record that is tied to it. A
/// class record without records comes before the next loose record, or else before the next class record.
class TTrace {
  public:
    explicit TTrace(boost::shared_ptr<ICIMNamespace> store)
        : fClasses(InstancesOf(store, "KALMO_DeltaClass")), fDeltas(InstancesOf(store, "KALMO_Delta")),
          fTies(InstancesOf(store, "KALMO_DeltaClassAssocToDelta"))
    {
        for (const auto& tie : fTies) {
            fTiedClasses.insert(ValueOf(*tie, "Class").ToText());
        }
    }

    std::vector<std::string> Tell()
    {
        for (const auto& delta : fDeltas) {
            const bool isTied = fTiesTold < fTies.size() && ValueOf(*fTies[fTiesTold], "Delta").ToText() == PathOf(*delta);
            isTied ? TellClassesUpTo(ValueOf(*fTies[fTiesTold], "Class").ToText()) : TellUntiedClass();
            fTexts.push_back(RecordText(*delta));
            if (isTied) {
                fTexts.push_back("tie");
                ++fTiesTold;
            }
        }
        TellClassesUpTo("");
        if (fTiesTold < fTies.size()) {
            fTexts.push_back("ties of other records");
        }
        return fTexts;
    }

  private:
    void TellClassesUpTo(const std::string& path)
    {
        while (fClassesTold < fClasses.size() && (fClassesTold == 0 || PathOf(*fClasses[fClassesTold - 1]) != path)) {
            TellClass();
        }
    }

    void TellUntiedClass()
    {
        if (fClassesTold < fClasses.size() && fTiedClasses.count(PathOf(*fClasses[fClassesTold])) == 0) {
            TellClass();
        }
    }

    void TellClass()
    {
        fTexts.push_back("class " + ValueOf(*fClasses[fClassesTold], "ClassName").ToText());
        ++fClassesTold;
    }

    TInstances fClasses;
    TInstances fDeltas;
    TInstances fTies;
    std::set<std::string> fTiedClasses;
    std::size_t fClassesTold = 0;
    std::size_t fTiesTold = 0;
    std::vector<std::string> fTexts;
};

}  // namespace

std::vector<std::string> TraceRecords(boost::shared_ptr<ICIMNamespace> store)
{
    return TTrace(store).Tell();
}

}  // namespace NORVZEL20
