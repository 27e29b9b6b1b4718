#include "base/status.h"

#include <system_error>

namespace ryn {

Status Status::FromErrno(const std::string& path, int error) {
    return SystemFault(path + ": " + std::generic_category().message(error));
}

} // namespace ryn
