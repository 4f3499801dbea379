#include "tests/spec/TSpecFixture.h"

#include "host/TZELException.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {

namespace {

TNamespaceBuilder::TProperty Key(const std::string& name)
{
    return TNamespaceBuilder::Key(name);
}

TNamespaceBuilder::TProperty Property(const std::string& name)
{
    return TNamespaceBuilder::Property(name);
}

}  // namespace

TSpecFixture::TSpecFixture(EHost host) : fComparison(host)
{
    fComparison.Namespace(0).Class("Base", "", {Key("Id"), Key("Name"), Key("Kind"), Property("A"), Property("B")});
    fComparison.Namespace(0).Class("Sub", "Base", {Property("C")}).Class("Other", "", {Key("Id"), Property("A")});
    fNamespaces.push_back(fComparison.Watched(0));
    fEngine = std::make_unique<TCIMDiffEngine>(fComparison.GetDelta(), fNamespaces, "");
}

std::string TSpecFixture::Read(const std::string& document)
{
    const TScratchFile file(document);
    return ReadFile(file.GetPath());
}

std::string TSpecFixture::ReadFile(const std::string& path)
{
    try {
        return DumpRules(fEngine->ReadSpecFile(path));
    } catch (const TZELException& error) {
        return "status " + std::to_string(error.GetStatusCode().GetStatus());
    }
}

std::string TextOf(TZELStatusCode::EStatusCode status)
{
    return TZELStatusCode(status).TranslateStatusCode();
}

}  // namespace NORVZEL20
