#include "tests/engine/TPerClassFixture.h"

#include "tests/support/Dump.h"

namespace NORVZEL20 {

TPerClassFixture::TPerClassFixture(EHost host) : fComparison(host)
{
    Rules("<class name=\"Disk\" default=\"include\"/>");
}

TNamespaceBuilder& TPerClassFixture::Namespace(std::size_t index)
{
    for (; fDeclared <= index; ++fDeclared) {
        fComparison.Namespace(fDeclared).Class(
            "Disk", "",
            {TNamespaceBuilder::Key("Bus", TCIMValue::TCIMType::kUint32), TNamespaceBuilder::Key("Id"),
             TNamespaceBuilder::Property("Size", TCIMValue::TCIMType::kUint32), TNamespaceBuilder::Property("Label")});
    }
    return fComparison.Namespace(index);
}

void TPerClassFixture::Disk(std::size_t index, const std::string& id, unsigned int size, unsigned int bus)
{
    Namespace(index).Instance("Disk", {{"Bus", bus}, {"Id", id}, {"Size", size}});
}

std::string TPerClassFixture::Disks(std::size_t index)
{
    return DumpInstances(Namespace(index).GetNamespace(), "Disk");
}

}  // namespace NORVZEL20
