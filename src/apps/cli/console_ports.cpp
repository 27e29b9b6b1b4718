#include "apps/cli/console_ports.h"

#include <ostream>

#include "strings/catalogue.h"

namespace ryn::cli {

ProgressLine::ProgressLine(Console& shownOn, std::chrono::milliseconds patience)
    : console(shownOn),
      shownFrom(std::chrono::steady_clock::now() + patience) {}

ProgressLine::~ProgressLine() {
    Clear();
}

void ProgressLine::ShowProgress(long long done, long long total) {
    if (!console.errIsTerminal || total <= 0)
        return;
    if (done >= total)
        return Clear();
    const auto percent =
        static_cast<int>(100.0 * static_cast<double>(done) / static_cast<double>(total));
    if (percent == shownPercent || std::chrono::steady_clock::now() < shownFrom)
        return;
    shownPercent = percent;
    console.err << '\r' << std::to_string(percent) << " %" << std::flush;
}

void ProgressLine::Clear() {
    if (shownPercent >= 0)
        console.err << "\r     \r" << std::flush;
    shownPercent = -1;
}

ConsolePorts::ConsolePorts(Console& shownOn, Consent answerToQuestions)
    : console(shownOn),
      consent(answerToQuestions),
      progress(shownOn),
      ports{this, this, this, this, this, this, &progress, this, this, this} {}

void ConsolePorts::Show(MessageKind kind, const std::string& text) {
    progress.Clear();
    ++messageCount;
    switch (kind) {
    case MessageKind::Error:
        ShowError(console, text);
        break;
    case MessageKind::Warning:
        ShowWarning(console, text);
        break;
    case MessageKind::Information:
        ShowNote(console, text);
        break;
    }
}

Answer ConsolePorts::AskYesNo(const std::string& question) {
    if (consent == Consent::Given)
        return Answer::Yes;
    ShowError(console, FormatText(kTextCliAnsweredNo, question));
    return Answer::No;
}

std::optional<std::string> ConsolePorts::ChooseFileToSave(const SaveRequest& /*request*/) {
    return std::nullopt;
}

} // namespace ryn::cli
