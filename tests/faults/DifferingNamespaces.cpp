#include "tests/faults/DifferingNamespaces.h"

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

/// Puts the three kinds of records back into the order of writing: the class record stands before the first record that is tied
/// to it; a record without association was written last.
class TTrace {
  public:
    explicit TTrace(boost::shared_ptr<ICIMNamespace> store)
        : fClasses(InstancesOf(store, "KALMO_DeltaClass")), fDeltas(InstancesOf(store, "KALMO_Delta")),
          fTies(InstancesOf(store, "KALMO_DeltaClassAssocToDelta"))
    {}

    std::vector<std::string> Tell()
    {
        for (std::size_t index = 0; index < fDeltas.size(); ++index) {
            const bool isTied = index < fTies.size();
            TellClassesUpTo(isTied ? ValueOf(*fTies[index], "Class").ToText() : "");
            fTexts.push_back(RecordText(*fDeltas[index]));
            if (isTied) {
                const bool fits = ValueOf(*fTies[index], "Delta").ToText() == PathOf(*fDeltas[index]);
                fTexts.push_back(fits ? "tie" : "tie of another record");
            }
        }
        TellClassesUpTo("");
        if (fTies.size() > fDeltas.size()) {
            fTexts.push_back("ties without records");
        }
        return fTexts;
    }

  private:
    void TellClassesUpTo(const std::string& path)
    {
        while (fClassesTold < fClasses.size() && (fClassesTold == 0 || PathOf(*fClasses[fClassesTold - 1]) != path)) {
            fTexts.push_back("class " + ValueOf(*fClasses[fClassesTold], "ClassName").ToText());
            ++fClassesTold;
        }
    }

    TInstances fClasses;
    TInstances fDeltas;
    TInstances fTies;
    std::size_t fClassesTold = 0;
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
