#include "tests/faults/DifferingNamespaces.h"

#include <vector>

#include "host/TAddToVectorCallback.h"
#include "host/TZELException.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {

namespace {

using EType = TCIMValue::TCIMType::ECIMType;

const TCallContext kNone;
const char* const kClasses[] = {"Disk", "Ssd", "Slot"};
const unsigned short kSameNumber = 1;
const unsigned short kOtherPeer = 2;

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
    if (flaw != EFlaw::kNoStateOfSlots) {
        ofSlot.push_back(property("State", EType::kString));
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
                              {"Mirror", index == 0 ? TCIMValue::Null(EType::kReference) : PathOfDisk("same")},
                              {"Note", "a note that is too long to be held inside, number " + own},
                              {"DateTimeOfCollection", own}});
    builder.Instance("Disk", {{"Id", "moved"}, {"Size", 7u}, {"Mirror", PathOfDisk(index == 0 ? "common" : "same")}});
    builder.Instance("Disk", {{"Id", "same"}, {"Size", 7u}, {"Mirror", PathOfDisk("common")}});
    builder.Instance("Ssd", {{"Id", "solid"}, {"Size", 9 + number}, {"Wear", static_cast<unsigned char>(index)}});
    if (index == 0) {
        builder.Instance("Disk", {{"Id", "only in the reference, alas"}, {"Size", 1u}});
    } else {
        builder.Instance("Disk", {{"Id", "not in the reference, alas"}, {"Size", 2u}, {"Mirror", PathOfDisk("same")}});
    }
}

/// The keys of a slot, of which bus and shelf are those of the namespace.
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

void AddSlot(TNamespaceBuilder& builder, std::size_t index, unsigned short number, const std::string& state, const TCIMValue& peer,
             EFlaw flaw)
{
    TNamespaceBuilder::TValues values = KeysOfSlot(index, number);
    values.emplace_back("Peer", peer);
    if (flaw != EFlaw::kNoStateOfSlots) {
        values.emplace_back("State", state);
    }
    builder.Instance("Slot", values);
}

/// The first slot's peer is the same but for its bus and shelf.
void FillSlots(TNamespaceBuilder& builder, std::size_t index, EFlaw flaw)
{
    const auto own = static_cast<unsigned short>(10 + index);
    AddSlot(builder, index, kSameNumber, std::to_string(index), PathOfSlot(index, kOtherPeer), flaw);
    AddSlot(builder, index, kOtherPeer, "ready", PathOfSlot(index, index == 0 ? kSameNumber : kOtherPeer), flaw);
    AddSlot(builder, index, own, "only here", TCIMValue::Null(EType::kReference), flaw);
}

void CopyInstances(TNamespaceBuilder& builder, ICIMNamespace& from, const std::string& className)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    from.GetClass(className, kNone)->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, kNone);
    for (const auto& instance : instances) {
        TNamespaceBuilder::TValues values;
        const auto append = [&values](boost::shared_ptr<ICIMProperty> property) {
            values.emplace_back(property->GetPropertyDecl(kNone)->GetName(kNone), property->GetValue(kNone));
            return true;
        };
        instance->EnumerateProperties(append, kNone);
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
           "<class name='Ssd'><includelist><value>Wear</value></includelist></class>\n"
           "<class name='Slot'" +
           excluded + "><includelist><value>State</value><value>Peer</value>" + unknown +
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
