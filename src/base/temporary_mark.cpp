#include "base/temporary_mark.h"

#include <array>
#include <atomic>
#include <cerrno>
#include <climits>
#include <unistd.h>

#include "base/path_parts.h"

namespace ryn {

namespace {

constexpr std::array kSignals = {SIGINT, SIGTERM, SIGHUP};

enum class SlotState { Free, BeingFilled, Marked };

/// Memory of its own, since a handler can wait for no lock and must not meet a name that another
/// thread is freeing.
struct Slot {
    std::atomic<SlotState> state = SlotState::Free;
    std::array<char, PATH_MAX> path{};
};
static_assert(std::atomic<SlotState>::is_always_lock_free); // or a handler could not read it

constexpr std::size_t kMostMarks = 16;
std::array<Slot, kMostMarks> slots;

extern "C" void RemoveAndEnd(int signal) {
    for (const Slot& slot : slots)
        if (slot.state.load() == SlotState::Marked)
            ::unlink(slot.path.data());
    // The default, which ends the process, takes over when the handler returns.
    ::signal(signal, SIG_DFL);
    ::raise(signal);
}

sigset_t SetOfSignals() {
    sigset_t set;
    ::sigemptyset(&set);
    for (const int signal : kSignals)
        ::sigaddset(&set, signal);
    return set;
}

} // namespace

void TemporaryMark::Set(const std::string& path) {
    Clear();
    const std::string full = FullPath(path);
    if (full.size() >= PATH_MAX)
        return;
    for (std::size_t i = 0; i < slots.size(); ++i) {
        SlotState expected = SlotState::Free;
        if (!slots[i].state.compare_exchange_strong(expected, SlotState::BeingFilled))
            continue;
        slots[i].path[full.copy(slots[i].path.data(), full.size())] = '\0';
        slots[i].state = SlotState::Marked;
        slot = static_cast<int>(i);
        return;
    }
}

void TemporaryMark::Clear() {
    if (slot >= 0)
        slots[static_cast<std::size_t>(slot)].state = SlotState::Free;
    slot = -1;
}

void RemoveTemporariesOnSignals() {
    for (const int signal : kSignals) {
        struct sigaction found {};
        if (::sigaction(signal, nullptr, &found) != 0 || found.sa_handler == SIG_IGN)
            continue;
        struct sigaction action {};
        action.sa_handler = RemoveAndEnd;
        action.sa_mask = SetOfSignals();
        ::sigaction(signal, &action, nullptr);
    }
}

SignalsHeld::SignalsHeld() {
    const sigset_t held = SetOfSignals();
    ::pthread_sigmask(SIG_BLOCK, &held, &before);
}

SignalsHeld::~SignalsHeld() {
    ::pthread_sigmask(SIG_SETMASK, &before, nullptr);
}

} // namespace ryn
