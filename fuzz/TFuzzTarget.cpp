#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

const std::vector<TFuzzTarget>& TFuzzTarget::GetAll()
{
    static const std::vector<TFuzzTarget> fgTargets = {
        {"answer", FuzzAnswer}, {"arguments", FuzzArguments}, {"baseline", FuzzBaseline},           {"collect", FuzzCollect},
        {"engine", FuzzEngine}, {"http", FuzzHttp},           {"inventory", FuzzInventory},         {"mof", FuzzMof},
        {"path", FuzzPath},     {"query", FuzzQuery},         {"specification", FuzzSpecification}, {"tokenizer", FuzzTokenizer},
        {"value", FuzzValue},
    };
    return fgTargets;
}

}  // namespace NORVZEL20
