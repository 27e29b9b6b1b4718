#include "base/temporary_files.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <csignal>
#include <unistd.h>

namespace ryn {

namespace {

constexpr int kNotNoted = -1;

/// A handler may not allocate or lock, so the names stand in fixed places.
struct Slot {
    std::atomic<bool> taken{false};
    std::atomic<bool> ready{false}; // the name stands whole
    std::array<char, 4096> name{};
};

std::array<Slot, 16> slots;

void RemoveAndEnd(int signal) {
    for (const Slot& slot : slots)
        if (slot.ready)
            ::unlink(slot.name.data());
    // The disposition was set back on entry; the signal ends the process when this returns.
    ::raise(signal);
}

} // namespace

int NoteTemporary(const std::string& path) {
    if (path.size() >= Slot{}.name.size())
        return kNotNoted;
    for (std::size_t i = 0; i < slots.size(); ++i) {
        Slot& slot = slots[i];
        if (slot.taken.exchange(true))
            continue;
        slot.name.fill('\0');
        std::copy(path.begin(), path.end(), slot.name.begin());
        slot.ready = true;
        return static_cast<int>(i);
    }
    return kNotNoted;
}

void ForgetTemporary(int number) {
    if (number == kNotNoted)
        return;
    Slot& slot = slots[static_cast<std::size_t>(number)];
    slot.ready = false;
    slot.taken = false;
}

void RemoveTemporariesOnSignals() {
    struct sigaction action {};
    action.sa_handler = RemoveAndEnd;
    action.sa_flags = static_cast<int>(SA_RESETHAND);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
        struct sigaction before {};
        // What the caller wants ignored (nohup) stays so.
        if (::sigaction(signal, nullptr, &before) == 0 && before.sa_handler != SIG_IGN)
            ::sigaction(signal, &action, nullptr);
    }
}

} // namespace ryn
