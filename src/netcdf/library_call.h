#pragma once

#include <mutex>
#include <string>

#include "base/status.h"

namespace ryn {

/// The C library is not made for several threads; who calls it holds this.
std::unique_lock<std::mutex> LockNetcdf();

/// A failure of the C library with the file's name and what was being done: "PATH: PLACE: REASON".
/// It counts as the system's when the reason is the operating system's.
Status NetcdfFault(const std::string& path, const std::string& place, int code);

/// An open descriptor, closed in the end.
class Descriptor {
  public:
    explicit Descriptor(int fd) : descriptor(fd) {}
    ~Descriptor();
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    int Get() const { return descriptor; }
    /// A name under which the C library opens this very file. It reads some ordinary names as
    /// addresses of servers and rewrites others (a backslash, a "#"), and a name may lead elsewhere
    /// by the time it is opened again.
    std::string Name() const { return "/proc/self/fd/" + std::to_string(descriptor); }

  private:
    int descriptor;
};

} // namespace ryn
