#pragma once

#include "host/TZELException.h"

namespace NORVZEL20 {

/// The status that `call` fails with; 0 if it does not fail.
template <class TCall>
int StatusOf(const TCall& call)
{
    try {
        call();
    } catch (const TZELException& failure) {
        return failure.GetStatusCode().GetStatus();
    }
    return 0;
}

}  // namespace NORVZEL20
