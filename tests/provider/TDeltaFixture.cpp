#include "tests/provider/TDeltaFixture.h"

#include "embedded/services/TAssertionFailure.h"

namespace NORVZEL20 {

TDeltaFixture::TDeltaFixture() : fComparison(EHost::kPlain)
{
    for (std::size_t index = 0; index < 3; ++index) {
        auto& ns = fComparison.Namespace(index);
        ns.Class("Base", "", {TNamespaceBuilder::Key("Id")}).Class("Sub", "Base", {TNamespaceBuilder::Property("Size")});
    }
    fComparison.Prepare();
    fComparison.GetWatch().Forget();
}

TCallContext TDeltaFixture::At(unsigned short index)
{
    TCallContext context;
    context["nsIndex"] = TCIMValue(index);
    return context;
}

bool FailsOnNull(const std::function<void()>& call)
{
    TCapturingLogger log;
    try {
        call();
    } catch (const TAssertionFailure& failure) {
        return std::string(failure.what()).find("px != 0") != std::string::npos;
    }
    return false;
}

}  // namespace NORVZEL20
