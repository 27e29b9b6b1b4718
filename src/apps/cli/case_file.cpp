#include "apps/cli/case_file.h"

#include <ostream>

#include "apps/cli/input_file.h"
#include "apps/cli/plain_text.h"
#include "base/path_parts.h"
#include "document/parameter_file_name.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

constexpr const char* kExtension = "RYN";

} // namespace

CaseFile::CaseFile(Console& shownOn, Consent consent)
    : console(shownOn),
      answers(consent),
      ports(shownOn, consent) {
    document.UsePorts(ports);
}

int CaseFile::TestName(const std::string& name) {
    if (IsParameterFileName(name))
        return kExitDone;
    return Report(console, Status::InputFault(FormatText(kTextCliNoParameterFileName, name)));
}

int CaseFile::New(const std::string& name) {
    if (const int refused = TestName(name))
        return refused;
    path = FullPath(name);
    shownName = name;
    if (const int refused = Report(console, TestReplaceable(FindParameterFile(name), answers)))
        return refused;
    document.OnNewDocument();
    return kExitDone;
}

int CaseFile::Open(const std::string& name) {
    if (const int refused = TestName(name))
        return refused;
    path = FindParameterFile(FullPath(name));
    const PathParts asGiven = SplitPath(name);
    shownName = asGiven.directory + asGiven.name + SplitPath(path).extension;
    if (const int refused = Report(console, TestReadable(shownName)))
        return refused;
    document.OnOpenDocument(path);
    if (ports.MessageCount() > 0)
        return kExitInput;
    if (!document.WasReadWhole())
        return Report(console, Status::InputFault(FormatText(kTextCliNoTarget, shownName)));
    return kExitDone;
}

int CaseFile::SaveQuietly() {
    document.OnSaveDocument(path);
    if (const Status saved = document.TakeSaveError(); !saved) {
        ShowError(console, saved.Text());
        return kExitSystem;
    }
    shownName = SavedParameterFileName(shownName, kExtension);
    return kExitDone;
}

int CaseFile::Save() {
    if (const int failed = SaveQuietly())
        return failed;
    console.out << FormatText(kTextCliSaved, PlainLine(shownName)) << '\n';
    return kExitDone;
}

} // namespace ryn::cli
