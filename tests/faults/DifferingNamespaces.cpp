// The contents. Disks differ by values, by references and by presence, in a class and in its subclass. Slots have keys that differ
// between all namespaces, so they match only if the rules exclude bus and shelf; then references to them are compared without these
// keys too. Ghost exists in the reference alone and has no instances. Texts are long enough to need an allocation, which can then
// fail.

#include "tests/faults/DifferingNamespaces.h"

#include <vector>

#include "host/TAddToVectorCallback.h"
#include "host/TZELException.h"
#include "tests/support/Dump.h"
#include "tests/support/NoContext.h"

namespace NORVZEL20 {

namespace {

using EType = TCIMValue::TCIMType::ECIMType;

const char* const kClasses[] = {"Disk", "Ssd", "Slot"};

void DeclareDiffering(TNamespaceBuilder& builder, std::size_t index, EFlaw flaw)
{
    const auto property = TNamespaceBuilder::Property;
    const auto key = TNamespaceBuilder::Key;
    builder.Class("Disk", "",
                  {key("Id", EType::kString), property("Size", EType::kUint32), property("Mirror", EType::kReference),
                   property("Note", EType::kString), property("DateTimeOfCollection", EType::kString)});
    builder.Class("Ssd", "Disk", {property("Wear", EType::kUint8)});
    std::vector<TNamespaceBuilder::TProperty> ofSlot = {key("BusOfTheEnclosure", EType::kString),
                                                        key("ShelfOfTheEnclosure", EType::kUint8), key("Number", EType::kUint16),
                                                        property("Peer", EType::kReference)};
    if (flaw != EFlaw::kNoUplinkOfSlots) {
        ofSlot.push_back(property("Uplink", EType::kReference));
    }
    if (flaw != EFlaw::kNoSlots) {
        builder.Class("Slot", "", ofSlot);
    }
    if (index == 0) {
        builder.Class("Ghost", "Disk", {});
    }
}

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
    const std::string own = std::to_string(index);
    builder.Instance("Disk", {{"Id", "common"},
                              {"Size", 100 + number},
                              {"Mirror", PathOfDisk(index == 0 ? "solid" : "lone")},
                              {"Note", "a note that is too long to be held inside, number " + own},
                              {"DateTimeOfCollection", own}});
    builder.Instance("Disk", {{"Id", "lone"}, {"Mirror", index == 0 ? TCIMValue::Null(EType::kReference) : PathOfDisk("common")}});
    builder.Instance(
        "Ssd", {{"Id", "solid"}, {"Size", number}, {"Mirror", PathOfDisk("lone")}, {"Wear", static_cast<unsigned char>(index)}});
    if (index == 0) {
        builder.Instance("Disk", {{"Id", "only in the reference, alas"}, {"Size", 1u}});
    } else {
        builder.Instance("Disk", {{"Id", "not in the reference, alas"}, {"Size", 2u}, {"Mirror", PathOfDisk("lone")}});
    }
}

/// The keys of a slot. Bus and shelf depend on the namespace.
TNamespaceBuilder::TValues KeysOfSlot(std::size_t index, unsigned short number)
{
    return {{"BusOfTheEnclosure", "a bus with a long name, number " + std::to_string(index)},
            {"ShelfOfTheEnclosure", static_cast<unsigned char>(index)},
            {"Number", number}};
}

TCIMValue PathOfSlot(std::size_t index, unsigned short number)
{
    TCIMReference path;
    path.SetClassName("Slot");
    for (const auto& [name, value] : KeysOfSlot(index, number)) {
        path.AddKeyValue(name, value);
    }
    return TCIMValue(path);
}

/// Two slots. The peer of the first differs in bus and shelf only, its uplink in the number.
void FillSlots(TNamespaceBuilder& builder, std::size_t index, EFlaw flaw)
{
    const auto own = static_cast<unsigned short>(10 + index);
    TNamespaceBuilder::TValues values = KeysOfSlot(index, 1);
    values.emplace_back("Peer", PathOfSlot(index, 1));
    if (flaw != EFlaw::kNoUplinkOfSlots) {
        values.emplace_back("Uplink", PathOfSlot(0, own));
    }
    builder.Instance("Slot", values);
    builder.Instance("Slot", KeysOfSlot(index, own));
}

void CopyInstances(TNamespaceBuilder& builder, ICIMNamespace& from, const std::string& className)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    from.GetClass(className, kNoContext)->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, kNoContext);
    for (const auto& instance : instances) {
        TNamespaceBuilder::TValues values;
        const auto append = [&values](boost::shared_ptr<ICIMProperty> property) {
            values.emplace_back(property->GetPropertyDecl(kNoContext)->GetName(kNoContext), property->GetValue(kNoContext));
            return true;
        };
        instance->EnumerateProperties(append, kNoContext);
        builder.Instance(className, values);
    }
}

}  // namespace

void FillDiffering(TNamespaceBuilder& builder, std::size_t index, EFlaw flaw)
{
    DeclareDiffering(builder, index, flaw);
    FillDisks(builder, index);
    if (flaw != EFlaw::kNoSlots) {
        FillSlots(builder, index, flaw);
    }
}

void FillLike(TNamespaceBuilder& builder, boost::shared_ptr<ICIMNamespace> reference)
{
    DeclareDiffering(builder, 0, EFlaw::kNone);
    for (const char* const name : kClasses) {
        CopyInstances(builder, *reference, name);
    }
}

std::string RulesForDiffering(bool excludesKeys, EFlaw flaw)
{
    const std::string excluded = excludesKeys ? " excludekeys='BusOfTheEnclosure ShelfOfTheEnclosure'" : "";
    const std::string unknown = flaw == EFlaw::kUnknownProperty ? "<value>a property that nothing has</value>" : "";
    return "<?xml version='1.0'?>\n<DifftoolSpec version='1.0'>\n"
           "<class name='Disk' default='include'><excludelist><value>Note</value></excludelist></class>\n"
           "<class name='Ssd'><includelist><value>Wear</value><value>Mirror</value></includelist></class>\n"
           "<class name='Slot'" +
           excluded + "><includelist><value>Peer</value><value>Uplink</value>" + unknown +
           "</includelist></class>\n</DifftoolSpec>\n";
}

std::string DumpDiffering(boost::shared_ptr<ICIMNamespace> ns)
{
    std::string text;
    for (const char* const name : kClasses) {
        try {
            text += DumpInstances(ns, name);
        } catch (const TZELException& error) {
            text += std::string("no ") + name + ": " + error.what() + "\n";
        }
    }
    return text;
}

}  // namespace NORVZEL20
