#include "host/ui/KeptSignals.h"

namespace tessel
{
KeptSignals::KeptSignals()
{
    for (std::size_t index = 0; index < kSignals.size(); ++index)
        sigaction(kSignals[index], nullptr, &mActions[index]);
}

KeptSignals::~KeptSignals()
{
    for (std::size_t index = 0; index < kSignals.size(); ++index)
        sigaction(kSignals[index], &mActions[index], nullptr);
}
} // namespace tessel
