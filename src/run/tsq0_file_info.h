#pragma once

#include <cstddef>
#include <string>

#include "grid/grid_edit.h"
#include "run/grid_plan.h"
#include "run/scratch_files.h"
#include "tsq/tsq.h"

namespace ryn {

/// One point of a batch: its temporary series while it is written, and afterwards the names of its
/// files, which go with the object.
class CTsq0FileInfo {
  public:
    /// `scratch` must outlive the object.
    explicit CTsq0FileInfo(ScratchFiles& scratchFiles) : scratch(&scratchFiles) {}
    ~CTsq0FileInfo();
    CTsq0FileInfo(CTsq0FileInfo&& other) noexcept;
    CTsq0FileInfo(const CTsq0FileInfo&) = delete;
    CTsq0FileInfo& operator=(const CTsq0FileInfo&) = delete;

    /// Absolute grid indices.
    void SetPosition(int x, int y) { position = {x, y}; }
    /// Begins the point's temporary series; nothing for a point that is not active. Dates are
    /// "YYYY-MM-DD" and "HH:MM:SS". True when every operation of the store succeeded; the store
    /// has the reason (tsqTakeError).
    bool Create(const CGridEditHeaderInfo& grid, int point, int itemNumber,
                const std::string& startDate, const std::string& startTime, bool isActive);
    /// Appends one time step, in seconds from the start; nothing when not active.
    bool WriteValue(double seconds, float value);
    /// Appends several; `seconds` has `count` numbers.
    bool WriteValues(const double* seconds, const float* values, std::size_t count);
    /// Completes the series; nothing when not active.
    bool Close();

    /// Takes the name of the point's extreme value series, beside the temporary one.
    const std::string& NameSeries();

    bool IsActive() const { return active; }
    const GridPoint& Position() const { return position; }
    const std::string& Path() const { return path; }
    const std::string& SeriesPath() const { return seriesPath; }

  private:
    ScratchFiles* scratch;
    TsqFileHandle file;
    TsqHeaderHandle header;
    std::string path;
    std::string seriesPath;
    bool active = true;
    GridPoint position;
};

} // namespace ryn
