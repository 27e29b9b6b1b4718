#pragma once

#include <functional>
#include <string>
#include <vector>

#include "base/atomic_file.h"
#include "base/status.h"
#include "kvf/kvf.h"
#include "ports/ports.h"
#include "series/selection_rules.h"
#include "series/sts_item.h"

namespace ryn {

/// Kinds of time axis as CTsqValues numbers them.
enum class AxisKind : int {
    EquidistantRelative = 0,
    NonEquidistantRelative = 1,
    EquidistantCalendar = 2,
    NonEquidistantCalendar = 3,
};

/// The kind of a file's axis, which has one.
constexpr AxisKind AxisKindOf(int tsqAxisType) {
    return static_cast<AxisKind>(tsqAxisType - 1);
}

/// The index, from 0, of an item number, from 1; -1, which no file has, for a number below 1.
constexpr int ItemIndex(int itemNumber) {
    return itemNumber < 1 ? -1 : itemNumber - 1;
}

/// What an extraction did.
struct ExtractionReport {
    int selected = 0;
    COleDateTime first; ///< of the selection; invalid when it is empty
    COleDateTime last;
    std::vector<int> missingYears;
    bool parametersChanged = false; ///< Threshold and AvgAnNum of the rules
    Status written;                 ///< why the series file could not be written
};

/// One item of a one-dimensional data file: as a summary, or as all its samples.
///
/// The file's time steps are taken as ascending. A relative axis, which has no date, counts from
/// 1 January 1900. A value that equals the file's delete value is a value like any other; a file of
/// another program with values marked as missing is refused.
class CTsqValues {
  public:
    /// Ways to the outside for what an extraction shows, and for the progress of ReadSeries.
    void UsePorts(const Ports& outside) { ports = &outside; }

    /// One pass over an item (index from 0) that keeps count, first, last, smallest and largest
    /// sample, of equal extremes the earliest. False when the file cannot be read: then minimum and
    /// maximum hold their start values and all else is as it was.
    bool ReadSummary(const std::string& path, int itemIndex);
    /// Reads all samples of an item. False, with everything as it was, when the file cannot be
    /// read.
    bool ReadSeries(const std::string& path, int itemIndex);
    /// Frees the samples.
    void ClearSeries();
    /// How ExtractSeries writes its file; flushed unless told otherwise.
    void SetDurability(Durability wanted) { durability = wanted; }
    /// Why the last read gave false.
    const Status& ReadError() const { return readError; }

    /// Selects the extreme values of the samples by the rules and writes them as a series file.
    /// Shows the missing years of an annual maximum series; unless silent, tells that a selection
    /// by number found too few peaks, in which case Threshold and AvgAnNum of the rules are changed
    /// to fit. The samples' marks must be 0, as ReadSeries leaves them.
    ExtractionReport ExtractSeries(const std::string& outputPath, SelectionRules& rules,
                                   bool silent);

    /// Adds section ExtremeValueSection with the samples' values and, for each, the number of the
    /// subsample that its date belongs to.
    void WriteExtremeValueSection(KvfTree* file,
                                  const std::function<int(const COleDateTime&)>& subsampleOf) const;

    // What a read has found.
    AxisKind axisKind = AxisKind::EquidistantRelative;
    int count = 0; ///< time steps in the file; after ClearSeries 0
    int itemType = 0;
    int itemUnit = 0;
    std::string itemName;
    std::string title; ///< by ReadSeries only
    int timeUnit = 0;
    // By ReadSummary only.
    STSItem minimum{{}, kHighestValue, 0};
    STSItem maximum{{}, -kHighestValue, 0};
    STSItem first;
    STSItem last;
    // By ReadSeries only: one for each time step, in file order.
    SampleArray samples;

    static constexpr double kHighestValue = 1.7976931348623157e308;

  private:
    struct OpenItem;
    Status Open(const std::string& path, int itemIndex, OpenItem* open) const;
    void TakeOver(const OpenItem& open);
    /// Selects, shows what is to be shown, and changes the rules where the selection does.
    std::vector<const STSItem*> Select(SelectionRules& rules, bool silent,
                                       ExtractionReport* report);

    const Ports* ports = &SilentPorts();
    Durability durability = Durability::Flushed;
    Status readError;
};

} // namespace ryn
