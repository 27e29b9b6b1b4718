#pragma once

#include <string>

#include "base/status.h"
#include "document/ryn_edit_doc.h"
#include "ports/missing_years_port.h"
#include "run/run_command.h"

namespace ryn {

/// The files of one point.
struct PointFiles {
    std::string series;   ///< all values; exists
    std::string extremes; ///< the extreme value series, to be written
    std::string kept;     ///< where a copy of that stays; empty for none
};

/// How a point's analysis ended.
enum class PointEnd {
    Good,        ///< the document holds the point's results
    Failed,      ///< status 1: this series cannot be analysed
    SetUpFailed, ///< status 3: no other point would fare better
    Broken,      ///< one of its files could not be read or written, or another process changed it
};

struct PointOutcome {
    PointEnd end = PointEnd::Good;
    Status reason; ///< of Broken
    bool hasFewerPeaks = false;
};

/// What a point leaves behind on the disk.
enum class PointTrace {
    Files, ///< parameter file, result file and the engine's files, which the next point replaces
    None,  ///< nothing; the numbers are the same
};

/// Analyses points one by one with the sections of one document, as if a user had set the series
/// file, extracted, and pressed Run. A point's result depends on that point alone: what an
/// extraction changes is set back.
///
/// The current directory is to be the parameter file's.
class PointAnalysis {
  public:
    struct Engines {
        AnalysisEngine withFiles = RYNENGINE;
        AnalysisEngine withoutFiles = RynEngineWithoutFiles;
    };

    PointAnalysis(CRynEditDoc& analysed, const Engines& used);

    PointOutcome Run(const PointFiles& files, PointTrace trace);

    /// The parameter file of each point in turn.
    const std::string& ParameterFile() const { return parameterFile; }

  private:
    void PointSections(const PointFiles& files);
    Status Extract(const PointFiles& files, bool* hasFewerPeaks);
    Status Keep(const PointFiles& files) const;
    Status SaveAndLoad(const PointFiles& files, KvfHandle* input, bool* isRead);
    KvfHandle MakeTree();

    CRynEditDoc& document;
    CGlobalKvf& root;
    Engines engines;
    std::string parameterFile;
    double threshold; ///< as the parameter file has it, and so the next
    double annualNumber;
};

} // namespace ryn
