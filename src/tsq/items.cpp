#include <climits>
#include <cmath>

#include "tsq/errors.h"
#include "tsq/records.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

int NoItem() {
    return FailWriting(Status::InputFault("no such item"));
}

template <typename T>
void Give(T* output, const T& value) {
    if (output != nullptr)
        *output = value;
}

bool AreFinite(const TsqPlane& plane) {
    return std::isfinite(plane.originX) && std::isfinite(plane.originY) &&
           std::isfinite(plane.stepX) && std::isfinite(plane.stepY);
}

} // namespace

int tsqGetNoOfItems(const TsqHeader* header) {
    return header != nullptr ? static_cast<int>(header->items.size()) : 0;
}

TsqItem* tsqItemD(TsqHeader* header, int itemNumber) {
    if (header == nullptr || itemNumber < 1 || itemNumber > tsqGetNoOfItems(header))
        return nullptr;
    return &header->items[static_cast<std::size_t>(itemNumber - 1)];
}

int tsqGetItemInfo(const TsqItem* item, int* type, std::string* typeText, std::string* name,
                   int* unit, std::string* unitText, int* dataType) {
    if (item == nullptr)
        return FailReading(Status::InputFault("no such item"));
    Give(type, item->type);
    if (typeText != nullptr)
        *typeText = ItemTypeText(item->type);
    Give(name, item->name);
    Give(unit, item->unit);
    if (unitText != nullptr)
        *unitText = UnitText(item->unit);
    Give(dataType, item->dataType);
    return 0;
}

int tsqGetItemDimensions(const TsqItem* item) {
    return item != nullptr ? item->dimensions : 0;
}

std::size_t tsqGetItemSize(const TsqItem* item) {
    return item != nullptr ? item->cells : 0;
}

int tsqSetItemInfo(TsqHeader* header, TsqItem* item, int type, const std::string& name, int unit,
                   int dataType) {
    if (header == nullptr || item == nullptr)
        return NoItem();
    if (dataType != kTsqDataTypeFloat)
        return FailWriting(
            Status::InputFault(header->title + ": items are written as 32-bit floats"));
    item->type = type;
    item->name = name;
    item->unit = unit;
    item->dataType = dataType;
    return 0;
}

int tsqSetItemValueType(TsqItem* item, int kind) {
    if (item == nullptr)
        return NoItem();
    item->valueType = kind;
    return 0;
}

int tsqSetItemRefCoords(TsqItem* item, float x, float y, float z) {
    if (item == nullptr)
        return NoItem();
    item->reference = {x, y, z};
    return 0;
}

int tsqSetItemAxisOrientation(TsqItem* item, float alpha, float phi, float theta) {
    if (item == nullptr)
        return NoItem();
    item->orientation = {alpha, phi, theta};
    return 0;
}

int tsqSetItemAxisEqD0(TsqItem* item, int unit) {
    if (item == nullptr)
        return NoItem();
    item->dimensions = 0;
    item->plane = {};
    item->plane.unit = unit;
    item->cells = 1;
    return 0;
}

int tsqSetItemAxisEqD2(TsqItem* item, int unit, int sizeX, int sizeY, float originX, float originY,
                       float stepX, float stepY) {
    if (item == nullptr)
        return NoItem();
    const TsqPlane plane{unit, sizeX, sizeY, originX, originY, stepX, stepY};
    if (sizeX < 1 || sizeY < 1 || sizeX > INT_MAX / sizeY)
        return FailWriting(Status::InputFault("a plane's size is below 1 or too large"));
    if (!AreFinite(plane))
        return FailWriting(Status::InputFault("a plane's axis is not finite"));
    item->dimensions = 2;
    item->plane = plane;
    item->cells = static_cast<std::size_t>(sizeX) * static_cast<std::size_t>(sizeY);
    return 0;
}

} // namespace ryn
