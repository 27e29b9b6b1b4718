#pragma once

#include <string>

namespace ryn {

enum class MessageKind { Error, Warning, Information };
enum class Answer { Yes, No, Cancel };

/// Messages and questions to the user. Desktop: modal message boxes. Command line: standard error,
/// and answers from options. Tests: a recorder that is told its answers.
class MessagePort {
  public:
    virtual ~MessagePort() = default;
    virtual void Show(MessageKind kind, const std::string& text) = 0;
    virtual Answer AskYesNo(const std::string& question) = 0;
    virtual Answer AskYesNoCancel(const std::string& question) = 0;
};

} // namespace ryn
