#include "apps/cli/descriptor_output.h"

#include <cerrno>
#include <unistd.h>

namespace ryn::cli {

DescriptorOutput::DescriptorOutput(int descriptor) : fd(descriptor), buffer(std::size_t{1} << 16) {
    setp(buffer.data(), buffer.data() + buffer.size());
}

DescriptorOutput::~DescriptorOutput() {
    WriteBuffer();
}

bool DescriptorOutput::WriteBuffer() {
    const char* place = pbase();
    while (error == 0 && place < pptr()) {
        const ssize_t written = ::write(fd, place, static_cast<std::size_t>(pptr() - place));
        if (written >= 0)
            place += written;
        else if (errno != EINTR)
            error = errno;
    }
    setp(buffer.data(), buffer.data() + buffer.size());
    return error == 0;
}

DescriptorOutput::int_type DescriptorOutput::overflow(int_type character) {
    if (!WriteBuffer())
        return traits_type::eof();
    if (!traits_type::eq_int_type(character, traits_type::eof()))
        sputc(traits_type::to_char_type(character));
    return traits_type::not_eof(character);
}

int DescriptorOutput::sync() {
    return WriteBuffer() ? 0 : -1;
}

} // namespace ryn::cli
