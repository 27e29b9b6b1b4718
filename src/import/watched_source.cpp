#include "import/watched_source.h"

namespace ryn {

Status WatchedSource::Read(char* buffer, std::size_t size, std::size_t* got) {
    Status status = source.Read(buffer, size, got);
    done += static_cast<long long>(*got);
    if (progress)
        progress(done, total);
    return status;
}

Status WatchedSource::Rewind() {
    done = 0;
    return source.Rewind();
}

} // namespace ryn
