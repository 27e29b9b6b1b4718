#pragma once

namespace ryn {

/// The sign that the program works and takes no input (a desktop's busy cursor).
class BusyPort {
  public:
    virtual ~BusyPort() = default;
    virtual void BeginBusy() = 0;
    /// Puts the sign back after a dialog, which takes it away.
    virtual void RestoreBusy() = 0;
    virtual void EndBusy() = 0;
};

/// The sign stands as long as the object lives.
class BusyScope {
  public:
    explicit BusyScope(BusyPort& shown) : port(shown) { port.BeginBusy(); }
    ~BusyScope() { port.EndBusy(); }
    BusyScope(const BusyScope&) = delete;
    BusyScope& operator=(const BusyScope&) = delete;

    void Restore() { port.RestoreBusy(); }

  private:
    BusyPort& port;
};

} // namespace ryn
