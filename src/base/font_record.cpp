#include "base/font_record.h"

namespace ryn {

namespace {

bool IsContinuation(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

} // namespace

std::string FaceName(const std::string& name) {
    std::size_t characters = 0;
    for (std::size_t i = 0; i < name.size(); ++i)
        if (!IsContinuation(name[i]) && ++characters > FontRecord::kMaxFaceLength)
            return name.substr(0, i);
    return name;
}

} // namespace ryn
