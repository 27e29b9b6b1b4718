#pragma once

namespace ryn {

/// The keyboard focus of the application's windows.
class KeyboardFocusPort {
  public:
    virtual ~KeyboardFocusPort() = default;
    /// Takes the focus from every control, so that a field being edited hands over its value.
    virtual void ReleaseFocus() = 0;
};

} // namespace ryn
