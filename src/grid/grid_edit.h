#pragma once

#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <vector>

#include "base/qx_array2d.h"
#include "base/qx_date_time.h"
#include "base/status.h"
#include "grid/grid_records.h"
#include "units/units.h"

/// Two-dimensional grids in time, from CF netCDF files as they come: classic, CDF-5 and netCDF-4;
/// time and the axes of space in any order; packed values; any CF time. docs/formats/grid.md says
/// what opens and how it is seen.
namespace ryn {

struct GridHeader;
class GridFile;
class SliceCache;

/// What an operation of the engine gives back; CGridEditEngine::LastError has the reason.
enum EGridEditErrors : int {
    kGridOk = 0,
    kGridNotOpened = 1,  ///< cannot be read, is no netCDF file, or holds no grid
    kGridNoFile = 2,     ///< no file is open
    kGridBadRequest = 3, ///< an item, layer, step or place that the file does not have
    kGridNotRead = 4,    ///< the values cannot be read, or their count is a lie
    kGridReadOnly = 5,   ///< writing was asked for
};

/// One item of a grid file.
class CGridEditItemInfo {
  public:
    CGridEditItemInfo() = default;
    CGridEditItemInfo(int itemType, int unit, int layers, std::string name);

    /// The item type code; kItemTypeUndefined where the unit suggests none.
    int GetItemTag() const { return itemType; }
    /// The unit code.
    int GetUnitTag() const { return unit; }
    const std::string& GetName() const { return name; }
    /// Layers, counted from 0: places on a level axis, members. 1 for a plain item.
    int Layers() const { return layers; }

  private:
    int itemType = kItemTypeUndefined;
    int unit = kUnitUndefined;
    int layers = 1;
    std::string name;
};

/// What a file says of its grid. Copies are cheap, and stay valid when the file is closed. A header
/// of no file has no steps and no items.
class CGridEditHeaderInfo {
  public:
    CGridEditHeaderInfo();
    explicit CGridEditHeaderInfo(std::shared_ptr<const GridHeader> header);

    /// The first step, 0, and the one behind the last.
    int TimeStepFirst() const { return 0; }
    int TimeStepPast() const;
    /// Stands for every missing value, and is finite.
    float DeleteValue() const;
    /// Seconds from step to step; the mean where they differ, and a day where there is but one.
    double TimeStep() const;
    /// True when all steps, turned into real dates, are equally far apart to the millisecond.
    bool EqualTimeSteps() const;
    CQxDateTime GetStartTime() const;
    /// The date of a step; invalid for a step that there is not.
    CQxDateTime TimeOfStep(int step) const;

    int Items() const;
    /// Items count from 1; an item that there is not is undefined and has no name.
    CGridEditItemInfo DynamicItem(int number) const;

    int SizeX() const;
    int SizeY() const;
    /// Coordinates of the first place, and the spacing, which is positive; 0 and 1 for a grid that
    /// runs by place number. Z0 is the first level of the first item, 0 without levels.
    float X0() const;
    float Y0() const;
    float Z0() const;
    float DX() const;
    float DY() const;
    /// Unit code of the plane's axes; kUnitUndefined for a grid that runs by place number.
    int QtyUnit() const;
    /// True where the axes are not regular, belong to a rotated pole, or have no coordinates:
    /// CGridEditEngine::ReadCoordinates has the real ones.
    bool RunsByIndex() const;

    /// Always 0: netCDF has no such number.
    int DataType() const { return 0; }
    /// Well-known text or CF name of the projection; empty where the file says nothing.
    const std::string& MapProjection() const;
    /// Origin of the projection, or its rotated pole, in degrees; 0 where the file says nothing.
    double Longitude() const;
    double Latitude() const;
    double Rotation() const;

    /// Sentences for the user: days placed anew, axes by number, variables left out.
    const std::vector<std::string>& Notes() const;

  private:
    friend class CGridEditEngine;

    std::shared_ptr<const GridHeader> header;
};

/// The plane of one step. It chooses what CGridEditEngine::GetSlice reads, and holds what was read.
class CGridEditSlice {
  public:
    /// Empties the slice and binds it to the open file whose header this is: GetSlice fails for one
    /// of another file. `plane` is 0, the plane of x and y, the only one there is; any other makes
    /// GetSlice fail too. The choices fall back to item 1, layer 0, step 0.
    void Initilize(const CGridEditHeaderInfo& header, int plane);
    /// Items that change in time are all there are: false makes GetSlice fail.
    void SetDynamic(bool isDynamic);
    void SetItem(int number) { item = number; }     ///< from 1
    void SetLayer(int number) { layer = number; }   ///< from 0
    void SetTimeStep(int number) { step = number; } ///< from 0

    /// What was read last: absolute places, x fast, both axes ascending.
    const CQxArray2D<float>& GetArray() const { return array; }
    /// The time of the step that was read last.
    CQxDateTime CurrentTime() const { return time; }

  private:
    friend class CGridEditEngine;

    CGridEditHeaderInfo header;
    int plane = 0;
    bool dynamic = true;
    int item = 1;
    int layer = 0;
    int step = 0;
    CQxArray2D<float> array;
    CQxDateTime time;
};

/// Reads one grid file at a time. Each thread has its own engine.
class CGridEditEngine {
  public:
    CGridEditEngine();
    ~CGridEditEngine();
    CGridEditEngine(const CGridEditEngine&) = delete;
    CGridEditEngine& operator=(const CGridEditEngine&) = delete;

    /// Opens a file for reading, and closes the one before. Grid files are not written: a false
    /// `readOnly` fails. 0 on success; LastError has one line that names the file otherwise.
    EGridEditErrors OpenFile(const std::string& name, bool readOnly);
    /// The open file's header; one of no file without.
    CGridEditHeaderInfo QueryHeaderInfo() const;
    /// Reads the plane that the slice chooses. On failure the slice keeps what it had.
    EGridEditErrors GetSlice(CGridEditSlice& slice);
    /// Hands a slice back; `write` is false.
    EGridEditErrors ReturnSlice(CGridEditSlice& slice, bool write);
    EGridEditErrors CloseFile();

    /// Cuts a part of the grid into tiles with all its steps, each of which ReadTile reads with no
    /// more than `memoryLimit` bytes, its result included (the netCDF library keeps some 16 MiB of
    /// unpacked chunks besides). No chunk of the file is cut between two
    /// tiles unless its places alone exceed the limit, so that each is decompressed once; what is
    /// not chunked is cut so that tiles lie in long runs. (A file with one chunk for each step has
    /// to be unpacked once for each tile, whatever is done.) Refused when the limit does not hold
    /// one point.
    EGridEditErrors PlanTiles(const GridTile& whole, std::size_t memoryLimit,
                              std::vector<GridTile>* tiles);
    /// What a limit of memory leaves for a tile's values.
    static std::size_t BytesForValues(std::size_t memoryLimit);
    /// Cuts a part of the grid into `pieces` tiles or some more, of about the same size, along what
    /// lies furthest apart in the file: for processes that share the work. The same file, part and
    /// number give the same tiles everywhere. Chunks are kept whole where there are enough of them;
    /// without chunks there are as many tiles as wanted, as even as can be.
    EGridEditErrors DividePlane(const GridTile& whole, int pieces, std::vector<GridTile>* tiles);
    /// Reads a tile point by point: the steps of a point lie together, and point (firstX + i,
    /// firstY + j) begins at (i * countY + j) * countSteps. `memoryLimit` is the one that the tile
    /// was planned with; `values` holds at least tile.Values() numbers.
    EGridEditErrors ReadTile(const GridTile& tile, std::size_t memoryLimit,
                             std::span<float> values);

    /// The real coordinates.
    EGridEditErrors ReadCoordinates(GridCoordinates* coordinates);
    /// What `ryn info` tells; everything empty when no file is open.
    GridDescription Describe() const;
    /// Reads a whole layer of an item for its range and its missing values.
    EGridEditErrors Summarise(int item, int layer, GridSummary* summary);

    /// Why the last operation failed; Ok after one that did not.
    const Status& LastError() const { return lastError; }

  private:
    EGridEditErrors Take(Status status, EGridEditErrors error);
    EGridEditErrors NoFile();

    std::unique_ptr<GridFile> grid;
    std::unique_ptr<SliceCache> cache;
    Status lastError;
};

} // namespace ryn
