#include "run/batch_ports.h"

namespace ryn {

BatchPorts::BatchPorts(CRynEditDoc& document)
    : owner(document),
      before(document.GetPorts()),
      quiet(document.GetPorts()) {
    quiet.missingYears = this;
    quiet.progress = SilentPorts().progress;
    // The parameter file of a point is no file that a user would open again.
    quiet.recentFiles = SilentPorts().recentFiles;
    owner.UsePorts(quiet);
}

BatchPorts::~BatchPorts() {
    owner.UsePorts(before);
}

void BatchPorts::ShowMissingYears(const std::vector<int>& /*years*/) {
    ++withMissingYears;
}

} // namespace ryn
