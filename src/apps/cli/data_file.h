#pragma once

#include <functional>
#include <span>
#include <string>
#include <vector>

#include "base/ole_date_time.h"
#include "base/status.h"
#include "series/tsq_values.h"
#include "tsq/tsq.h"

namespace ryn::cli {

/// One item of a data file.
struct DataItem {
    int number = 0; ///< from 1
    std::string name;
    std::string unit;
    bool isPlainSeries = true; ///< one value for each time step; else it has spatial dimensions
};

/// One time step of the items that a walk asked for.
struct DataStep {
    int index = 0; ///< from 0
    COleDateTime date;
    double seconds = 0.0;          ///< since what the axis counts from, with their fraction
    std::span<const float> values; ///< in the order asked for; NaN where the file marks one missing
};

/// A data file read step by step, all items in one pass and in constant memory. Dates are to the
/// second, as the analysis sees them; those of a relative axis count from 1 January 1900.
class DataFile {
  public:
    DataFile() = default;
    ~DataFile();
    DataFile(const DataFile&) = delete;
    DataFile& operator=(const DataFile&) = delete;

    Status Open(const std::string& path);

    const std::string& Title() const { return title; }
    AxisKind Axis() const { return AxisKindOf(axis.type); }
    int StepCount() const { return axis.count; }
    const std::vector<DataItem>& Items() const { return items; }
    /// Numbers of the items that are plain series.
    std::vector<int> PlainItems() const;

    /// Calls `use` for each step until it gives false. `itemNumbers` ascend and are of plain
    /// series. A file is walked as often as asked.
    Status Walk(const std::vector<int>& itemNumbers,
                const std::function<bool(const DataStep&)>& use);

  private:
    Status ReadAxis();
    void ReadItems();
    Status ReadStep(const std::vector<int>& itemNumbers, double* time, float* values);
    double SecondsOf(int index, double time) const;
    COleDateTime DateOf(double seconds) const;

    std::string fileName;
    TsqHeaderHandle header;
    TsqFileHandle file;
    std::string title;
    TsqAxis axis;
    COleDateTime origin; ///< what the axis's times count from
    double unitSeconds = 1.0;
    std::vector<DataItem> items;
};

} // namespace ryn::cli
