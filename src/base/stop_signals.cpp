#include "base/stop_signals.h"

#include <atomic>

namespace ryn {

namespace {

constexpr std::array kSignals = {SIGINT, SIGTERM, SIGHUP};

std::atomic<int> caught = 0;
static_assert(std::atomic<int>::is_always_lock_free); // or a handler could not write it

extern "C" void Remember(int signal) {
    int none = 0;
    caught.compare_exchange_strong(none, signal);
}

} // namespace

StopSignals::StopSignals() {
    caught = 0;
    for (std::size_t i = 0; i < kCount; ++i) {
        ::sigaction(kSignals[i], nullptr, &before[i]);
        if (before[i].sa_handler == SIG_IGN)
            continue;
        struct sigaction action {};
        action.sa_handler = Remember;
        action.sa_flags = SA_RESTART; // reads and writes under way go on
        ::sigaction(kSignals[i], &action, nullptr);
    }
}

StopSignals::~StopSignals() {
    for (std::size_t i = 0; i < kCount; ++i)
        ::sigaction(kSignals[i], &before[i], nullptr);
}

int StopSignals::Caught() {
    return caught.load();
}

void EndBySignal(int signal) {
    ::signal(signal, SIG_DFL);
    ::raise(signal);
}

} // namespace ryn
