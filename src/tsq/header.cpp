#include <cmath>
#include <limits>

#include "tsq/errors.h"
#include "tsq/records.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

constexpr int kMaxItems = 100000;

int NoHeader() {
    return FailWriting(Status::InputFault("no header"));
}

} // namespace

void TsqHeaderDelete::operator()(TsqHeader* header) const {
    delete header;
}

int tsqHeaderCreate(int fileType, const std::string& title, const std::string& applicationName,
                    int applicationVersion, int numberOfItems, int statisticsKind,
                    TsqHeaderHandle* header) {
    if (numberOfItems < 1 || numberOfItems > kMaxItems)
        return FailWriting(Status::InputFault(title + ": a data file has 1 to 100000 items"));
    TsqHeaderHandle made(new TsqHeader);
    made->fileType = fileType;
    made->title = title;
    made->applicationName = applicationName;
    made->applicationVersion = applicationVersion;
    made->statisticsKind = statisticsKind;
    made->items.resize(static_cast<std::size_t>(numberOfItems));
    *header = std::move(made);
    return 0;
}

void tsqHeaderDestroy(TsqHeaderHandle* header) {
    if (header != nullptr)
        header->reset();
}

int tsqSetAppTitle(TsqHeader* header, const std::string& text) {
    if (header == nullptr)
        return NoHeader();
    header->applicationTitle = text;
    return 0;
}

int tsqSetDurability(TsqHeader* header, Durability durability) {
    if (header == nullptr)
        return NoHeader();
    header->durability = durability;
    return 0;
}

int tsqSetDeleteValFloat(TsqHeader* header, float value) {
    if (header == nullptr)
        return NoHeader();
    header->deleteFloat = value;
    return 0;
}

int tsqSetDeleteValDouble(TsqHeader* header, double value) {
    if (header == nullptr)
        return NoHeader();
    header->deleteDouble = value;
    return 0;
}

int tsqSetDataType(TsqHeader* header, int number) {
    if (header == nullptr)
        return NoHeader();
    header->dataType = number;
    return 0;
}

int tsqSetGeoInfoUTMProj(TsqHeader* header, const std::string& projection, double longitude,
                         double latitude, double rotation) {
    if (header == nullptr)
        return NoHeader();
    header->projection = {projection, longitude, latitude, rotation};
    return 0;
}

int tsqSetGridCoordinates(TsqHeader* header, const TsqGridCoordinates& coordinates) {
    if (header == nullptr)
        return NoHeader();
    header->coordinates = coordinates;
    return 0;
}

std::string tsqGetFileTitle(const TsqHeader* header) {
    return header != nullptr ? header->title : std::string();
}

float tsqGetDeleteValFloat(const TsqHeader* header) {
    return header != nullptr ? header->deleteFloat : std::numeric_limits<float>::quiet_NaN();
}

} // namespace ryn
