#include <cerrno>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <iostream>
#include <string>
#include <unistd.h>
#include <vector>

#include "apps/cli/descriptor_output.h"
#include "apps/cli/run_ryn.h"
#include "base/temporary_mark.h"
#include "strings/catalogue.h"

namespace {

/// Takes the places of standard streams that the caller closed, so that no file that a command
/// opens gets the number of one and is written into. Writing to such a stream still fails.
void FillClosedStreams() {
    int fd = 0;
    do
        fd = ::open("/dev/null", O_RDONLY);
    while (fd >= 0 && fd <= STDERR_FILENO);
    if (fd > STDERR_FILENO)
        ::close(fd);
}

/// What the exit code becomes when standard output failed. A reader that has seen enough (`| head`)
/// is no failure.
int AfterOutput(int exitCode, int outputError, ryn::cli::Console& console) {
    if (outputError == 0 || outputError == EPIPE)
        return exitCode;
    ryn::cli::ShowError(console, ryn::FormatText(ryn::kTextCliOutputFailed,
                                                 std::string(std::strerror(outputError))));
    return ryn::cli::kExitSystem;
}

} // namespace

int main(int argumentCount, char** arguments) {
    FillClosedStreams();
    // A reader that goes away must not end the program in the middle of making a file.
    std::signal(SIGPIPE, SIG_IGN);
    // Nor a limit on the size of files: the write fails, and what was written is taken away.
    std::signal(SIGXFSZ, SIG_IGN);
    ryn::RemoveTemporariesOnSignals();
    ryn::cli::DescriptorOutput buffer(STDOUT_FILENO);
    std::ostream out(&buffer);
    ryn::cli::Console console{out, std::cerr, std::cin, ::isatty(STDERR_FILENO) != 0};
    const std::vector<std::string> given(arguments + (argumentCount > 0 ? 1 : 0),
                                         arguments + argumentCount);
    const int exitCode = ryn::cli::RunRyn(given, console);
    out.flush();
    return AfterOutput(exitCode, buffer.Error(), console);
}
