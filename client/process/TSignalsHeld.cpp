#include "client/process/TSignalsHeld.h"

#include "client/process/EndingSignals.h"

namespace NORVZEL20 {

TSignalsHeld::TSignalsHeld() noexcept
{
    const sigset_t ending = EndingSignals();
    pthread_sigmask(SIG_BLOCK, &ending, &fBefore);
}

TSignalsHeld::~TSignalsHeld()
{
    pthread_sigmask(SIG_SETMASK, &fBefore, nullptr);
}

}  // namespace NORVZEL20
