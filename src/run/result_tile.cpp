#include "run/result_tile.h"

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <string_view>
#include <system_error>

#include <fmt/format.h>

#include "kvf/kvf.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr const char* kTarget = "RynResultTile";
constexpr const char* kFingerprint = "Fingerprint";
constexpr const char* kWithMissing = "WithMissing";
constexpr const char* kWithFewerPeaks = "WithFewerPeaks";
constexpr const char* kWithMissingYears = "WithMissingYears";
constexpr const char* kPoints = "Points";
constexpr const char* kPoint = "Point"; // number, whether good, results

/// FNV-1a, 64 bits: no defence against malice, which tiles need none against.
std::uint64_t HashOf(std::string_view text) {
    std::uint64_t hash = 14695981039346656037ULL;
    for (const char byte : text) {
        hash ^= static_cast<unsigned char>(byte);
        hash *= 1099511628211ULL;
    }
    return hash;
}

Status Unfit(const std::string& path) {
    return Status::InputFault(FormatText(kTextGridTileUnfit, path));
}

bool ReadPoint(const KvfKeyword* keyword, std::size_t items, ResultTile::Point* point) {
    const int count = kvfGetNoParams(keyword);
    if (count < 2)
        return false;
    const auto& number = *kvfParamByNum(keyword, 1);
    const auto& good = *kvfParamByNum(keyword, 2);
    if (kvfParamType(number) != KvfType::Int || kvfIsBool(&good) == 0)
        return false;
    point->number = kvfParamInt(number);
    point->isGood = kvfGetBool(&good);
    for (int i = 3; i <= count; ++i) {
        const KvfParam& value = *kvfParamByNum(keyword, i);
        if (kvfParamType(value) != KvfType::Float)
            return false;
        point->results.push_back(kvfParamFloat(value));
    }
    return point->results.size() == (point->isGood ? items : 0);
}

} // namespace

Status WriteResultTile(const ResultTile& tile, const std::string& path) {
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), kTarget);
    kvfPutParam(tree.get(), kFingerprint, tile.fingerprint);
    kvfPutParam(tree.get(), kWithMissing, tile.withMissing);
    kvfPutParam(tree.get(), kWithFewerPeaks, tile.withFewerPeaks);
    kvfPutParam(tree.get(), kWithMissingYears, tile.withMissingYears);
    kvfPutParam(tree.get(), kPoints, static_cast<int>(tile.points.size()));
    for (const ResultTile::Point& point : tile.points) {
        kvfAddKeyword(tree.get(), kPoint);
        kvfAddInt(tree.get(), point.number);
        kvfAddBool(tree.get(), point.isGood);
        for (const float result : point.results)
            kvfAddFloat(tree.get(), result);
    }
    kvfEndSection(tree.get());
    return kvfWrite(tree.get(), path, Durability::Unflushed);
}

Status ReadResultTile(const std::string& path, const std::string& fingerprint, std::size_t items,
                      ResultTile* tile) {
    const KvfHandle tree = kvfLoadFile(path, 0);
    if (kvfGetErrorGlb() != 0) {
        std::string reason;
        kvfGetSyntaxErr(tree.get(), nullptr, nullptr, &reason);
        return Status::InputFault(reason);
    }
    const KvfSection* const target = kvfTargetByNameNum(tree.get(), kTarget, 1);
    ResultTile read;
    int count = -1;
    kvfGetParam(target, kFingerprint, &read.fingerprint, 1, 1);
    kvfGetParam(target, kWithMissing, &read.withMissing, 1, 1);
    kvfGetParam(target, kWithFewerPeaks, &read.withFewerPeaks, 1, 1);
    kvfGetParam(target, kWithMissingYears, &read.withMissingYears, 1, 1);
    kvfGetParam(target, kPoints, &count, 1, 1);
    if (read.fingerprint != fingerprint)
        return Unfit(path);
    for (int i = 1; i <= count; ++i) {
        ResultTile::Point point;
        if (!ReadPoint(kvfKeywordByNameNum(target, kPoint, i), items, &point))
            return Unfit(path);
        read.points.push_back(std::move(point));
    }
    *tile = std::move(read);
    return Status::Ok();
}

std::string BatchFingerprint(CGlobalKvf& root, const GridPlan& plan,
                             const std::string& baseDirectory) {
    const KvfHandle tree = kvfCreate();
    root.Write(tree.get(), baseDirectory);
    std::error_code error;
    const std::filesystem::path grid(plan.gridFile);
    const auto time = std::filesystem::last_write_time(grid, error).time_since_epoch();
    const std::string source = fmt::format(
        "{} {} {} {}", RYN_VERSION, plan.gridFile, std::filesystem::file_size(grid, error),
        std::chrono::duration_cast<std::chrono::nanoseconds>(time).count());
    return fmt::format("{:016x}{:016x}", HashOf(kvfText(tree.get())), HashOf(source));
}

} // namespace ryn
