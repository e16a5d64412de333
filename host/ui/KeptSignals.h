// The host's signals, put back at the end of a scope in which somebody else puts in handlers of their own.
#pragma once

#include <array>
#include <csignal>

namespace tessel
{
class KeptSignals
{
public:
    KeptSignals();
    ~KeptSignals();
    KeptSignals(const KeptSignals&) = delete;
    KeptSignals& operator=(const KeptSignals&) = delete;

private:
    static constexpr std::array kSignals = {SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGPIPE};

    std::array<struct sigaction, kSignals.size()> mActions;
};
} // namespace tessel
