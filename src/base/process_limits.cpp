#include "base/process_limits.h"

#include <algorithm>
#include <charconv>
#include <climits>
#include <string>
#include <sys/resource.h>
#include <unistd.h>

#include "base/file_access.h"

namespace ryn {

namespace {

constexpr std::size_t kLeast = std::size_t{64} << 20;

/// A number in a file of the system; SIZE_MAX where there is none ("max", no such file).
std::size_t NumberIn(const std::string& path) {
    constexpr std::size_t kLongest = 4096;
    std::string text;
    std::size_t number = SIZE_MAX;
    if (ReadWholeFile(path, kLongest, &text))
        std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

std::size_t ResourceLimit(__rlimit_resource resource) {
    struct rlimit limit {};
    if (::getrlimit(resource, &limit) != 0 || limit.rlim_cur == RLIM_INFINITY)
        return SIZE_MAX;
    return limit.rlim_cur;
}

/// The limit of the process's own group and of every group around it.
std::size_t ControlGroupLimit() {
    const std::string root = "/sys/fs/cgroup";
    std::size_t limit = NumberIn(root + "/memory/memory.limit_in_bytes");
    constexpr std::size_t kLongest = 65536;
    std::string groups;
    if (!ReadWholeFile("/proc/self/cgroup", kLongest, &groups))
        return limit;
    const std::size_t found = groups.find("0::/");
    if (found == std::string::npos)
        return limit;
    std::string group = groups.substr(found + 3, groups.find('\n', found) - found - 3);
    for (;; group.resize(group.rfind('/'))) {
        limit = std::min(limit, NumberIn(root + group + "/memory.max"));
        if (group.find('/') == std::string::npos)
            return limit;
    }
}

} // namespace

int LimitOfOpenFiles() {
    const std::size_t limit = ResourceLimit(RLIMIT_NOFILE);
    return static_cast<int>(std::clamp<std::size_t>(limit, 1, INT_MAX));
}

std::size_t UsableMemory() {
    const auto machine = static_cast<std::size_t>(::sysconf(_SC_PHYS_PAGES)) *
                         static_cast<std::size_t>(::sysconf(_SC_PAGESIZE));
    return std::max(kLeast, std::min({machine, ControlGroupLimit(), ResourceLimit(RLIMIT_AS),
                                      ResourceLimit(RLIMIT_DATA)}));
}

} // namespace ryn
