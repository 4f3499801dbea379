#include "client/TSignalsHeld.h"

#include "client/EndingSignals.h"

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
