#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "base/atomic_file.h"
#include "base/status.h"
#include "units/units.h"

/// The store of one-dimensional data files (.tsq0, .tq0): a time axis and one or more items with a
/// value for each time step. docs/formats/tsq.md describes the file, which is netCDF with CF
/// conventions. Operations return 0 on success and another value on failure unless told otherwise;
/// the reason of the last failure is told by tsqTakeError. A null handle fails.
///
/// Reading and writing go step by step, and behind them the store works in blocks. Times of steps
/// count from the axis's start, which lies `start` behind the axis's date; a relative axis has
/// 1900-01-01 00:00:00 for its date. Different files may be used in different threads at the same
/// time; the last failure and the error handler are each thread's own.
namespace ryn {

struct TsqHeader;
struct TsqFile;
struct TsqItem;

struct TsqHeaderDelete {
    void operator()(TsqHeader* header) const;
};
struct TsqFileDelete {
    void operator()(TsqFile* file) const;
};
using TsqHeaderHandle = std::unique_ptr<TsqHeader, TsqHeaderDelete>;
using TsqFileHandle = std::unique_ptr<TsqFile, TsqFileDelete>;

inline constexpr int kTsqDataTypeFloat = 1; ///< 32-bit float

/// Answers of tsqGetTimeAxisType.
enum TsqAxisType : int {
    kTsqEqTimeAxis = 1,      ///< equidistant relative
    kTsqNeqTimeAxis = 2,     ///< non-equidistant relative
    kTsqEqCalendarAxis = 3,  ///< equidistant calendar
    kTsqNeqCalendarAxis = 4, ///< non-equidistant calendar
};

/// A time axis of any type.
struct TsqAxis {
    int type = 0; ///< TsqAxisType; 0 before one is set
    int unit = kUnitSecond;
    std::string date; ///< of a calendar axis, "YYYY-MM-DD"
    std::string time; ///< "HH:MM:SS"
    double start = 0.0;
    double step = 0.0; ///< of an equidistant axis
    double span = 0.0; ///< time of the last step
    int count = 0;     ///< time steps
    int index = 0;     ///< the number given when the axis was set

    bool IsEquidistant() const { return type == kTsqEqTimeAxis || type == kTsqEqCalendarAxis; }
    bool IsCalendar() const { return type == kTsqEqCalendarAxis || type == kTsqNeqCalendarAxis; }
};

// Reading.

/// Opens a file of ours or any netCDF file with items along one time axis. On failure both handles
/// stay null. Refused with a reason: no netCDF, no time axis, counts that disagree with the file,
/// more than 2^31 - 1 steps, and in a file of another program steps that do not ascend.
///
/// Another program's file has a non-equidistant axis in seconds from the second of its first step
/// (a calendar axis, or a relative one where its time unit names no date); its items are the
/// numeric variables along the time axis in file order, unpacked.
int tsqFileRead(const std::string& path, TsqHeaderHandle* header, TsqFileHandle* file);
/// The same, and takes steps in any order, also equal ones: for who sorts them.
int tsqFileReadUnordered(const std::string& path, TsqHeaderHandle* header, TsqFileHandle* file);
/// True when a data file of this name exists in memory, or on disk and can be opened for reading.
bool tsqFileExists(const std::string& path);
/// 0 for a header without an axis.
int tsqGetTimeAxisType(const TsqHeader* header);
/// The axis of a header, whatever its type; a relative one has 1900-01-01 00:00:00 for its date.
/// Type 0 for a header without an axis.
TsqAxis tsqGetTimeAxis(const TsqHeader* header);
// Axis operations: each answers for its own axis type and fails, outputs unchanged, for another.
// Null outputs are passed over. `start` and `step` are in the axis's unit, `span` is the time of
// the last step, `count` the number of time steps, `index` the number given when the axis was set.
// Dates are "YYYY-MM-DD", times "HH:MM:SS".
int tsqGetEqTimeAxis(const TsqHeader* header, int* unit, std::string* unitText, double* start,
                     double* step, int* count, int* index);
int tsqGetNeqTimeAxis(const TsqHeader* header, int* unit, std::string* unitText, double* start,
                      double* span, int* count, int* index);
int tsqGetEqCalendarAxis(const TsqHeader* header, std::string* dateText, std::string* timeText,
                         int* unit, std::string* unitText, double* start, double* step, int* count,
                         int* index);
int tsqGetNeqCalendarAxis(const TsqHeader* header, std::string* dateText, std::string* timeText,
                          int* unit, std::string* unitText, double* start, double* span, int* count,
                          int* index);
int tsqGetNoOfItems(const TsqHeader* header);
/// Item by number, from 1; null when there is none.
TsqItem* tsqItemD(TsqHeader* header, int itemNumber);
/// Null outputs are passed over.
int tsqGetItemInfo(const TsqItem* item, int* type, std::string* typeText, std::string* name,
                   int* unit, std::string* unitText, int* dataType);
/// Number of spatial dimensions of an item: 0 for a plain series.
int tsqGetItemDimensions(const TsqItem* item);
/// Number of values of an item in a time step: 1 for a plain series; 0 for a null item.
std::size_t tsqGetItemSize(const TsqItem* item);
std::string tsqGetFileTitle(const TsqHeader* header);
/// The file's delete value; of another program's file what its first item marks missing values
/// with.
float tsqGetDeleteValFloat(const TsqHeader* header);
/// Counts the values of an item that are marked missing or not finite, in a file that another
/// program made (fill value, missing value, NaN); always 0 in a file of ours, whose delete value is
/// an ordinary value to this system. The place in the file does not move.
int tsqCountMissing(TsqHeader* header, TsqFile* file, int itemNumber, int* missing);
/// Places the file at the first time step.
int tsqFindBlockDynamic(TsqHeader* header, TsqFile* file);
/// Reads the next item of the current time step, in item order, and the time of the step in the
/// axis's unit. A value that another program marked as missing comes as NaN. A null buffer passes
/// over the item without reading it; a null time likewise. An item with spatial dimensions fills
/// tsqGetItemSize values. What tsqCountMissing counts reads as NaN. On failure, behind the last
/// step too, nothing moves.
int tsqReadItemTimeStep(TsqHeader* header, TsqFile* file, double* time, float* buffer);

/// Consecutive time steps of one item, in the store's own memory until the next operation on the
/// file.
struct TsqBlock {
    const double* times = nullptr; ///< in the axis's unit; null on an equidistant axis
    const float* values = nullptr;
    int count = 0; ///< steps
};
/// Reads the steps from the current one on that the store has at hand, of one item without spatial
/// dimensions, and passes over them. The current step must not be begun. At the end of the file the
/// block is empty.
int tsqReadItemBlock(TsqHeader* header, TsqFile* file, int itemNumber, TsqBlock* block);

// Writing.

int tsqHeaderCreate(int fileType, const std::string& title, const std::string& applicationName,
                    int applicationVersion, int numberOfItems, int statisticsKind,
                    TsqHeaderHandle* header);
// Axes: months and years are no units of a calendar axis; a step is above 0; dates are valid.
int tsqSetAppTitle(TsqHeader* header, const std::string& text);
int tsqSetDeleteValFloat(TsqHeader* header, float value);
int tsqSetDeleteValDouble(TsqHeader* header, double value);
int tsqSetEqTimeAxis(TsqHeader* header, int unit, double start, double step, int index);
int tsqSetNeqTimeAxis(TsqHeader* header, int unit, double start, int index);
int tsqSetEqCalendarAxis(TsqHeader* header, const std::string& dateText,
                         const std::string& timeText, int unit, double start, double step,
                         int index);
int tsqSetNeqCalendarAxis(TsqHeader* header, const std::string& dateText,
                          const std::string& timeText, int unit, double start, int index);
int tsqSetDataType(TsqHeader* header, int number);
int tsqSetGeoInfoUTMProj(TsqHeader* header, const std::string& projection, double longitude,
                         double latitude, double rotation);
int tsqSetItemInfo(TsqHeader* header, TsqItem* item, int type, const std::string& name, int unit,
                   int dataType);
int tsqSetItemValueType(TsqItem* item, int kind);
int tsqSetItemRefCoords(TsqItem* item, float x, float y, float z);
int tsqSetItemAxisOrientation(TsqItem* item, float alpha, float phi, float theta);
/// No spatial axes.
int tsqSetItemAxisEqD0(TsqItem* item, int unit);
/// Two equidistant spatial axes.
int tsqSetItemAxisEqD2(TsqItem* item, int unit, int sizeX, int sizeY, float originX, float originY,
                       float stepX, float stepY);
/// Where the cells of a grid really lie, for grids that are run by index.
struct TsqGridCoordinates {
    struct Axis {
        std::string name;           ///< of the coordinate variable; empty for the usual one
        std::string units;          ///< as in the grid's own file
        std::string standardName;   ///< of CF; may be empty
        std::vector<double> values; ///< empty: from the item's origin and step
    };
    Axis x;
    Axis y;
    /// Degrees of each cell, x fast; both empty for a grid that its two axes describe.
    std::vector<double> longitudes;
    std::vector<double> latitudes;
};
/// Coordinates of every item with two spatial axes, whose sizes they must have (tsqFileCreate
/// fails otherwise). Without this call they follow from origin and step.
int tsqSetGridCoordinates(TsqHeader* header, const TsqGridCoordinates& coordinates);
/// Whether the file is flushed to the disk when it is closed; it is without this call.
int tsqSetDurability(TsqHeader* header, Durability durability);
/// Makes the file: it takes its name when it is closed, so that an old file stands until then.
int tsqFileCreate(const std::string& path, TsqHeader* header, TsqFileHandle* file);
/// Appends the next item of the current time step. The time counts with the first item of a step
/// and is stored rounded to the millisecond; it must be finite. On an equidistant axis it is
/// ignored: there the axis tells it. An item with two spatial axes takes a whole plane, x fast; a
/// NaN in it becomes the delete value. After a failure the file cannot be completed any more.
int tsqWriteItemTimeStep(TsqHeader* header, TsqFile* file, double time, const float* values);

/// Appends whole steps of a file with one item without spatial dimensions. `times` has `count`
/// numbers, as tsqWriteItemTimeStep takes them; null on an equidistant axis.
int tsqWriteItemBlock(TsqHeader* header, TsqFile* file, const double* times, const float* values,
                      std::size_t count);

/// Closes; a file being written is completed, flushed to the disk unless its header says otherwise,
/// and takes its name here. On failure an old file of that name stays as it was. A null file is no
/// error.
int tsqFileClose(TsqHeader* header, TsqFileHandle* file);
void tsqHeaderDestroy(TsqHeaderHandle* header);

// Errors.

/// Why the last operation of this thread that failed did so; names the file. Ok when none did since
/// the last call.
Status tsqTakeError();

/// Gets an error's type, the library's source file and its line; returns 0.
using TsqErrorHandler = std::function<int(int type, const char* sourceFile, int line)>;
/// Installs the handler that is called for each library error while a file is made or written; an
/// empty one removes it. Returns the handler that was installed before.
TsqErrorHandler tsqAddCommonErrorHandler(TsqErrorHandler handler);

/// While an object lives, every data file whose absolute path lies directly in its directory exists
/// in memory alone, under the same operations: nothing reaches the disk, and the directory itself
/// need not exist there. A file being read stays readable when it is removed or replaced, and when
/// the object is gone.
class TsqMemoryDirectory {
  public:
    explicit TsqMemoryDirectory(const std::string& directory);
    ~TsqMemoryDirectory();
    TsqMemoryDirectory(const TsqMemoryDirectory&) = delete;
    TsqMemoryDirectory& operator=(const TsqMemoryDirectory&) = delete;

    /// Removes one file; false when there is none.
    bool Remove(const std::string& path);
    /// Bytes held.
    std::size_t Size() const;

  private:
    std::string directory;
};

/// Copies a data file; between disk and memory too. A copy to disk replaces an old file whole, and
/// is not flushed.
Status tsqCopyFile(const std::string& from, const std::string& to);

} // namespace ryn
