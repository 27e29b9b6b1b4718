#include "grid/grid_edit.h"

#include <utility>

#include "grid/description.h"
#include "grid/grid_file.h"
#include "grid/slice_cache.h"

namespace ryn {

CGridEditItemInfo::CGridEditItemInfo(int type, int unitCode, int layerCount, std::string itemName)
    : itemType(type),
      unit(unitCode),
      layers(layerCount),
      name(std::move(itemName)) {}

CGridEditHeaderInfo::CGridEditHeaderInfo() : header(std::make_shared<const GridHeader>()) {}

CGridEditHeaderInfo::CGridEditHeaderInfo(std::shared_ptr<const GridHeader> of)
    : header(std::move(of)) {}

int CGridEditHeaderInfo::TimeStepPast() const {
    return static_cast<int>(header->milliseconds.size());
}

float CGridEditHeaderInfo::DeleteValue() const {
    return header->deleteValue;
}

double CGridEditHeaderInfo::TimeStep() const {
    return header->stepSeconds;
}

bool CGridEditHeaderInfo::EqualTimeSteps() const {
    return header->hasEqualSteps;
}

CQxDateTime CGridEditHeaderInfo::GetStartTime() const {
    return TimeOfStep(0);
}

CQxDateTime CGridEditHeaderInfo::TimeOfStep(int step) const {
    if (step < 0 || step >= TimeStepPast())
        return {};
    return CQxDateTime::FromUnixMilliseconds(header->milliseconds[static_cast<std::size_t>(step)]);
}

int CGridEditHeaderInfo::Items() const {
    return static_cast<int>(header->items.size());
}

CGridEditItemInfo CGridEditHeaderInfo::DynamicItem(int number) const {
    if (number < 1 || number > Items())
        return {};
    const GridItem& item = header->items[static_cast<std::size_t>(number - 1)];
    return {item.type, item.unit, item.layers, item.name};
}

int CGridEditHeaderInfo::SizeX() const {
    return header->sizeX;
}

int CGridEditHeaderInfo::SizeY() const {
    return header->sizeY;
}

float CGridEditHeaderInfo::X0() const {
    return header->originX;
}

float CGridEditHeaderInfo::Y0() const {
    return header->originY;
}

float CGridEditHeaderInfo::Z0() const {
    return header->originZ;
}

float CGridEditHeaderInfo::DX() const {
    return header->spacingX;
}

float CGridEditHeaderInfo::DY() const {
    return header->spacingY;
}

int CGridEditHeaderInfo::QtyUnit() const {
    return header->unit;
}

bool CGridEditHeaderInfo::RunsByIndex() const {
    return header->runsByIndex;
}

const std::string& CGridEditHeaderInfo::MapProjection() const {
    return header->projection.text;
}

double CGridEditHeaderInfo::Longitude() const {
    return header->projection.longitude;
}

double CGridEditHeaderInfo::Latitude() const {
    return header->projection.latitude;
}

double CGridEditHeaderInfo::Rotation() const {
    return header->projection.rotation;
}

const std::vector<std::string>& CGridEditHeaderInfo::Notes() const {
    return header->notes;
}

void CGridEditSlice::Initilize(const CGridEditHeaderInfo& of, int wantedPlane) {
    *this = CGridEditSlice();
    header = of;
    plane = wantedPlane;
}

void CGridEditSlice::SetDynamic(bool isDynamic) {
    dynamic = isDynamic;
}

CGridEditEngine::CGridEditEngine() : cache(std::make_unique<SliceCache>()) {}

CGridEditEngine::~CGridEditEngine() = default;

EGridEditErrors CGridEditEngine::Take(Status status, EGridEditErrors error) {
    lastError = std::move(status);
    return lastError ? kGridOk : error;
}

EGridEditErrors CGridEditEngine::NoFile() {
    return Take(Status::InputFault("no grid file is open"), kGridNoFile);
}

EGridEditErrors CGridEditEngine::OpenFile(const std::string& name, bool readOnly) {
    CloseFile();
    if (!readOnly)
        return Take(Status::InputFault(name + ": grid files are opened for reading only"),
                    kGridReadOnly);
    return Take(GridFile::Open(name, &grid), kGridNotOpened);
}

CGridEditHeaderInfo CGridEditEngine::QueryHeaderInfo() const {
    return grid ? CGridEditHeaderInfo(grid->Header()) : CGridEditHeaderInfo();
}

EGridEditErrors CGridEditEngine::GetSlice(CGridEditSlice& slice) {
    if (!grid)
        return NoFile();
    if (slice.plane != 0 || !slice.dynamic)
        return Take(grid->File().InputFault("it has only the plane of x and y, and only items that "
                                            "change in time"),
                    kGridBadRequest);
    if (slice.header.header != grid->Header())
        return Take(grid->File().InputFault("the slice was not made for this file"),
                    kGridBadRequest);
    const GridTile plane = grid->PlaneTile(slice.item, slice.layer, slice.step);
    if (Status status = grid->CheckTile(plane); !status)
        return Take(std::move(status), kGridBadRequest);
    const EGridEditErrors result = Take(cache->Read(*grid, plane, &slice.array), kGridNotRead);
    if (result == kGridOk)
        slice.time = CGridEditHeaderInfo(grid->Header()).TimeOfStep(slice.step);
    return result;
}

EGridEditErrors CGridEditEngine::ReturnSlice(CGridEditSlice& /*slice*/, bool write) {
    if (!grid)
        return NoFile();
    return Take(write ? grid->File().InputFault("grid files are not written") : Status::Ok(),
                kGridReadOnly);
}

EGridEditErrors CGridEditEngine::CloseFile() {
    cache->Clear();
    grid.reset();
    return Take(Status::Ok(), kGridOk);
}

EGridEditErrors CGridEditEngine::PlanTiles(const GridTile& whole, std::size_t memoryLimit,
                                           std::vector<GridTile>* tiles) {
    return grid ? Take(grid->PlanTiles(whole, memoryLimit, tiles), kGridBadRequest) : NoFile();
}

std::size_t CGridEditEngine::BytesForValues(std::size_t memoryLimit) {
    return memoryLimit - GridFile::ScratchOf(memoryLimit);
}

EGridEditErrors CGridEditEngine::DividePlane(const GridTile& whole, int pieces,
                                             std::vector<GridTile>* tiles) {
    return grid ? Take(grid->DividePlane(whole, pieces, tiles), kGridBadRequest) : NoFile();
}

EGridEditErrors CGridEditEngine::ReadTile(const GridTile& tile, std::size_t memoryLimit,
                                          std::span<float> values) {
    if (!grid)
        return NoFile();
    if (Status status = grid->CheckTile(tile); !status)
        return Take(std::move(status), kGridBadRequest);
    return Take(grid->ReadTile(tile, GridFile::ScratchOf(memoryLimit), values), kGridNotRead);
}

EGridEditErrors CGridEditEngine::ReadCoordinates(GridCoordinates* coordinates) {
    return grid ? Take(grid->ReadCoordinates(coordinates), kGridNotRead) : NoFile();
}

GridDescription CGridEditEngine::Describe() const {
    return grid ? DescribeGrid(*grid) : GridDescription();
}

EGridEditErrors CGridEditEngine::Summarise(int item, int layer, GridSummary* summary) {
    if (!grid)
        return NoFile();
    if (Status status = grid->CheckTile(grid->PlaneTile(item, layer, 0)); !status)
        return Take(std::move(status), kGridBadRequest);
    return Take(grid->Summarise(item, layer, summary), kGridNotRead);
}

} // namespace ryn
