#pragma once

#include <vector>

#include "document/ryn_edit_doc.h"
#include "ports/ports.h"

namespace ryn {

/// Gives a document the ports of a batch as long as it lives: messages go where they went, and what
/// would be shown for every point is counted or passed over.
class BatchPorts : private MissingYearsPort {
  public:
    explicit BatchPorts(CRynEditDoc& document);
    ~BatchPorts() override;
    BatchPorts(const BatchPorts&) = delete;
    BatchPorts& operator=(const BatchPorts&) = delete;

    /// How many extractions found years without a value.
    int ExtractionsWithMissingYears() const { return withMissingYears; }

  private:
    void ShowMissingYears(const std::vector<int>& years) override;

    CRynEditDoc& owner;
    const Ports& before;
    Ports quiet;
    int withMissingYears = 0;
};

} // namespace ryn
