#include "netcdf/library_call.h"

#include <netcdf.h>
#include <unistd.h>

namespace ryn {

std::unique_lock<std::mutex> LockNetcdf() {
    static std::mutex mutex;
    return std::unique_lock(mutex);
}

Status NetcdfFault(const std::string& path, const std::string& place, int code) {
    const std::string text = path + ": " + place + ": " + nc_strerror(code);
    // The library gives errno values as they are, and its own codes as negative numbers.
    return code > 0 ? Status::SystemFault(text) : Status::InputFault(text);
}

Descriptor::~Descriptor() {
    if (descriptor >= 0)
        ::close(descriptor);
}

} // namespace ryn
