#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "ports/ports.h"

namespace ryn::test {

/// Ports that record what was shown and answer what they were told.
class RecordingPorts final : public MessagePort,
                             public MissingYearsPort,
                             public FileChoicePort,
                             public KeyboardFocusPort,
                             public RecentFilesPort,
                             public ApplicationPort,
                             public ProgressPort,
                             public BusyPort,
                             public TextViewerPort,
                             public PlatformFontPort {
  public:
    operator const Ports&() const { return ports; }

    std::vector<std::string> messages;
    std::vector<std::vector<int>> missingYears;
    std::vector<std::string> questions;
    std::vector<std::string> recentFiles;
    std::vector<std::pair<long long, long long>> progress;
    std::vector<std::string> viewedFiles;
    FontRecord messageFont;
    int focusReleases = 0;
    int busy = 0; ///< depth of the sign that stands now
    int busyRestores = 0;
    Answer answer = Answer::No;
    std::optional<std::string> chosenFile;

    void Show(MessageKind /*kind*/, const std::string& text) override { messages.push_back(text); }
    Answer AskYesNo(const std::string& question) override {
        questions.push_back(question);
        return answer;
    }
    Answer AskYesNoCancel(const std::string& question) override { return AskYesNo(question); }
    void ShowMissingYears(const std::vector<int>& years) override { missingYears.push_back(years); }
    std::optional<std::string> ChooseFileToSave(const SaveRequest& /*request*/) override {
        return chosenFile;
    }
    void ReleaseFocus() override { ++focusReleases; }
    void AddRecentFile(const std::string& path) override { recentFiles.push_back(path); }
    std::string ApplicationName() override { return "Test"; }
    void ShowProgress(long long done, long long total) override {
        progress.emplace_back(done, total);
    }
    void BeginBusy() override { ++busy; }
    void RestoreBusy() override { ++busyRestores; }
    void EndBusy() override { --busy; }
    void ViewTextFile(const std::string& path) override { viewedFiles.push_back(path); }
    FontRecord MessageFont() override { return messageFont; }

  private:
    Ports ports{this, this, this, this, this, this, this, this, this, this};
};

} // namespace ryn::test
