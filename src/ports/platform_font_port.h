#pragma once

#include "base/font_record.h"

namespace ryn {

/// The font in which the platform shows its messages.
class PlatformFontPort {
  public:
    virtual ~PlatformFontPort() = default;
    virtual FontRecord MessageFont() = 0;
};

} // namespace ryn
