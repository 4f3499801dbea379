#include "tests/faults/DifferingNamespaces.h"

#include <set>

#include "host/TAddToVectorCallback.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {

namespace {

using EType = TCIMValue::TCIMType::ECIMType;
using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

TCIMValue PathOfDisk(const std::string& id)
{
    TCIMReference path;
    path.SetClassName("Disk");
    path.AddKeyValue("Id", TCIMValue(id));
    return TCIMValue(path);
}

void FillDisks(TNamespaceBuilder& builder, std::size_t index)
{
    const auto number = static_cast<unsigned int>(index);
    builder.Instance("Disk", {{"Id", "common"}, {"Size", 100 + number}, {"Note", "a note that is too long to be held inside"}});
    builder.Instance("Disk", {{"Id", "same"}, {"Size", 7u}, {"Mirror", PathOfDisk("common")}});
    builder.Instance("Ssd", {{"Id", "solid"}, {"Size", 9u}, {"Wear", static_cast<unsigned char>(index)}});
    if (index == 0) {
        builder.Instance("Disk", {{"Id", "only in the reference, alas"}, {"Size", 1u}});
    } else {
        builder.Instance("Disk", {{"Id", "not in the reference, alas"}, {"Size", 2u}, {"Mirror", PathOfDisk("same")}});
    }
}

void FillSlots(TNamespaceBuilder& builder, std::size_t index)
{
    const std::string bus = "a bus with a long name, number " + std::to_string(index);
    const auto own = static_cast<unsigned short>(10 + index);
    builder.Instance("Slot", {{"Bus", bus}, {"Number", static_cast<unsigned short>(1)}, {"State", std::to_string(index)}});
    builder.Instance("Slot", {{"Bus", bus}, {"Number", own}, {"State", "only here"}});
}

TInstances InstancesOf(boost::shared_ptr<ICIMNamespace> ns, const std::string& className)
{
    TInstances instances;
    ns->GetClass(className, TCallContext())
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, TCallContext());
    return instances;
}

TCIMValue ValueOf(const ICIMInstance& instance, const std::string& name)
{
    return instance.GetProperty(name, TCallContext())->GetValue(TCallContext());
}

std::string PathOf(const ICIMInstance& instance)
{
    return instance.GetReference(TCallContext()).GetPath();
}

std::string RecordText(const ICIMInstance& record)
{
    return ValueOf(record, "Type").ToText() + " " + ValueOf(record, "InstanceName").ToText() + " " +
           ValueOf(record, "Property").ToText() + " " + ValueOf(record, "NamespaceIndices").ToText();
}

/// Puts the three kinds of records back into the order of writing: a class record stands before the first record that is tied to
/// it; one that nothing is tied to stands before the loose record, or else the class, that comes next.
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

void FillDiffering(TNamespaceBuilder& builder, std::size_t index)
{
    const auto key = TNamespaceBuilder::Key("Id");
    const auto size = TNamespaceBuilder::Property("Size", EType::kUint32);
    const auto mirror = TNamespaceBuilder::Property("Mirror", EType::kReference);
    builder.Class("Disk", "", {key, size, mirror, TNamespaceBuilder::Property("Note")});
    builder.Class("Ssd", "Disk", {TNamespaceBuilder::Property("Wear", EType::kUint8)});
    builder.Class(
        "Slot", "",
        {TNamespaceBuilder::Key("Bus"), TNamespaceBuilder::Key("Number", EType::kUint16), TNamespaceBuilder::Property("State")});
    if (index == 0) {
        builder.Class("Ghost", "Disk", {});
    }
    FillDisks(builder, index);
    FillSlots(builder, index);
}

std::string RulesForDiffering(bool excludesKeys)
{
    const std::string excluded = excludesKeys ? " excludekeys='Bus'" : "";
    return "<?xml version='1.0'?>\n<DifftoolSpec version='1.0'>\n"
           "<class name='Disk' default='include'/>\n"
           "<class name='Slot'" +
           excluded + "><includelist><value>State</value></includelist></class>\n</DifftoolSpec>\n";
}

std::string DumpDiffering(boost::shared_ptr<ICIMNamespace> ns)
{
    return DumpInstances(ns, "Disk") + DumpInstances(ns, "Ssd") + DumpInstances(ns, "Slot");
}

std::vector<std::string> TraceRecords(boost::shared_ptr<ICIMNamespace> store)
{
    return TTrace(store).Tell();
}

}  // namespace NORVZEL20
