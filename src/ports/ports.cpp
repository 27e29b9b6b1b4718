#include "ports/ports.h"

#include "strings/catalogue.h"

namespace ryn {

namespace {

class SilentPort final : public MessagePort,
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
    void Show(MessageKind /*kind*/, const std::string& /*text*/) override {}
    Answer AskYesNo(const std::string& /*question*/) override { return Answer::No; }
    Answer AskYesNoCancel(const std::string& /*question*/) override { return Answer::Cancel; }
    void ShowMissingYears(const std::vector<int>& /*years*/) override {}
    std::optional<std::string> ChooseFileToSave(const SaveRequest& /*request*/) override {
        return std::nullopt;
    }
    void ReleaseFocus() override {}
    void AddRecentFile(const std::string& /*path*/) override {}
    std::string ApplicationName() override { return std::string(Text(kTextApplicationName)); }
    void ShowProgress(long long /*done*/, long long /*total*/) override {}
    void BeginBusy() override {}
    void RestoreBusy() override {}
    void EndBusy() override {}
    void ViewTextFile(const std::string& /*path*/) override {}
    FontRecord MessageFont() override {
        FontRecord font;
        font.height = -12;
        font.weight = 400;
        font.faceName = "Sans Serif";
        return font;
    }
};

} // namespace

const Ports& SilentPorts() {
    static SilentPort port;
    static const Ports ports{&port, &port, &port, &port, &port, &port, &port, &port, &port, &port};
    return ports;
}

} // namespace ryn
