#include "bench/peers/IPeerDatabase.h"

namespace NORVZEL20 {

std::unique_ptr<IPeerDatabase> MakeDuckDb()
{
    return nullptr;
}

}  // namespace NORVZEL20
