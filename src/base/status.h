#pragma once

#include <string>

namespace ryn {

/// Whose fault a failure is; the command line turns it into its exit code.
enum class Fault {
    None,
    Input,  ///< the user's input (a file's content, an argument)
    System, ///< the program could not do its work (disk, permission)
};

/// What an operation that can fail gives back: nothing for success, else a fault with a text that
/// names file, place and reason. Functions leave their outputs unchanged when they fail.
class [[nodiscard]] Status {
  public:
    Status() = default;

    static Status Ok() { return {}; }
    static Status InputFault(std::string text) { return {Fault::Input, std::move(text)}; }
    static Status SystemFault(std::string text) { return {Fault::System, std::move(text)}; }
    /// A system fault with the reason of an errno value: "PATH: REASON".
    static Status FromErrno(const std::string& path, int error);

    bool IsOk() const { return fault == Fault::None; }
    explicit operator bool() const { return IsOk(); }
    Fault Kind() const { return fault; }
    /// Empty for success.
    const std::string& Text() const { return text; }

  private:
    Status(Fault kind, std::string message) : fault(kind), text(std::move(message)) {}

    Fault fault = Fault::None;
    std::string text;
};

} // namespace ryn
