#pragma once

#include <chrono>
#include <string>
#include <vector>

#include "apps/cli/console.h"
#include "ports/ports.h"

namespace ryn::cli {

/// A terminal's line that shows how far long work has come: nothing in its first half second,
/// nothing where standard error is no terminal, and the line is gone when all is done.
class ProgressLine final : public ProgressPort {
  public:
    static constexpr std::chrono::milliseconds kPatience{500};

    explicit ProgressLine(Console& shownOn, std::chrono::milliseconds patience = kPatience);
    ~ProgressLine() override;
    ProgressLine(const ProgressLine&) = delete;
    ProgressLine& operator=(const ProgressLine&) = delete;

    void ShowProgress(long long done, long long total) override;
    /// Takes the line away, before something else is written there.
    void Clear();

  private:
    Console& console;
    std::chrono::steady_clock::time_point shownFrom;
    int shownPercent = -1;
};

/// The command line's answers to a document's ports: messages go to standard error, questions are
/// answered by --yes, no file is chosen. Missing years stand in the extraction's report, which the
/// command prints.
class ConsolePorts final : public MessagePort,
                           public MissingYearsPort,
                           public FileChoicePort,
                           public KeyboardFocusPort,
                           public RecentFilesPort,
                           public ApplicationPort,
                           public BusyPort,
                           public TextViewerPort,
                           public PlatformFontPort {
  public:
    ConsolePorts(Console& shownOn, Consent answerToQuestions);
    ConsolePorts(const ConsolePorts&) = delete;
    ConsolePorts& operator=(const ConsolePorts&) = delete;

    operator const Ports&() const { return ports; }

    /// How many messages were shown so far.
    int MessageCount() const { return messageCount; }

    void Show(MessageKind kind, const std::string& text) override;
    Answer AskYesNo(const std::string& question) override;
    Answer AskYesNoCancel(const std::string& question) override { return AskYesNo(question); }
    void ShowMissingYears(const std::vector<int>& /*years*/) override {}
    std::optional<std::string> ChooseFileToSave(const SaveRequest& request) override;
    void ReleaseFocus() override {}
    void AddRecentFile(const std::string& /*path*/) override {}
    std::string ApplicationName() override { return "ryn"; }
    void BeginBusy() override {}
    void RestoreBusy() override {}
    void EndBusy() override {}
    void ViewTextFile(const std::string& /*path*/) override {}
    FontRecord MessageFont() override { return SilentPorts().platformFont->MessageFont(); }

  private:
    Console& console;
    Consent consent;
    ProgressLine progress;
    int messageCount = 0;
    Ports ports;
};

} // namespace ryn::cli
