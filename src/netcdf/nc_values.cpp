#include "netcdf/nc_values.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>
#include <string>

namespace ryn {

namespace {

constexpr float kMissing = std::numeric_limits<float>::quiet_NaN();
constexpr double kLargestFloat = std::numeric_limits<float>::max();

/// What the library puts where nothing was written; bytes have none, since each of their few values
/// may be data.
std::optional<double> DefaultFill(NcType type) {
    switch (type) {
    case NcType::Short:
        return -32767.0;
    case NcType::Int:
        return -2147483647.0;
    case NcType::Float:
    case NcType::Double:
        return 9.9692099683868690e+36;
    case NcType::UShort:
        return 65535.0;
    case NcType::UInt:
        return 4294967295.0;
    case NcType::Int64:
        return -9223372036854775806.0;
    case NcType::UInt64:
        return 18446744073709551614.0;
    default:
        return std::nullopt;
    }
}

std::size_t Product(std::span<const std::size_t> count) {
    std::size_t product = 1;
    for (const std::size_t length : count)
        product *= length;
    return product;
}

bool IsFloating(NcType type) {
    return type == NcType::Float || type == NcType::Double;
}

} // namespace

NcValues::NcValues(const NcFile* source, const NcVariable* of) : file(source), variable(of) {
    scale = file->Number(variable->id, "scale_factor").value_or(1.0);
    offset = file->Number(variable->id, "add_offset").value_or(0.0);
    const bool isUnsigned = file->Text(variable->id, "_Unsigned").value_or("") == "true";
    if (isUnsigned && !IsFloating(variable->type))
        wrap = std::ldexp(1.0, 8 * BytesOf(variable->type));
    ReadMarks();
}

void NcValues::ReadMarks() {
    for (const char* const name : {"_FillValue", "missing_value"})
        if (const auto values = file->Numbers(variable->id, name))
            marks.insert(marks.end(), values->begin(), values->end());
    isPlain = variable->type == NcType::Float && scale == 1.0 && offset == 0.0 && marks.empty();
    const auto fill = DefaultFill(variable->type);
    if (fill && !file->Numbers(variable->id, "_FillValue"))
        marks.push_back(*fill);
    if (!IsFloating(variable->type))
        return;
    // A mark is often written in another type than the values: -999.9 as a double beside floats.
    // One that no float can equal has no work to do, since such numbers are missing by themselves.
    std::erase_if(marks, [](double mark) { return !(std::abs(mark) <= kLargestFloat); });
    for (double& mark : marks)
        mark = static_cast<double>(static_cast<float>(mark));
}

float NcValues::Decode(double raw) const {
    const double compared = IsFloating(variable->type) && std::abs(raw) <= kLargestFloat
                                ? static_cast<double>(static_cast<float>(raw))
                                : raw;
    if (std::ranges::find(marks, compared) != marks.end())
        return kMissing;
    const double value = (raw < 0.0 ? raw + wrap : raw) * scale + offset;
    return std::abs(value) <= kLargestFloat ? static_cast<float>(value) : kMissing;
}

Status NcValues::ReadFloats(std::span<const std::size_t> start, std::span<const std::size_t> count,
                            std::size_t size, float* values) const {
    if (Status status = file->Read(*variable, start, count, values); !status)
        return status;
    // Without branches, so that several values are looked at in one instruction.
    for (const double wide : marks) {
        const auto mark = static_cast<float>(wide);
        for (std::size_t i = 0; i < size; ++i)
            values[i] = values[i] == mark ? kMissing : values[i];
    }
    for (std::size_t i = 0; i < size; ++i)
        values[i] =
            std::fabs(values[i]) <= std::numeric_limits<float>::max() ? values[i] : kMissing;
    return Status::Ok();
}

Status NcValues::Read(std::span<const std::size_t> start, std::span<const std::size_t> count,
                      float* values) {
    const std::size_t size = Product(count);
    if (variable->type == NcType::Float && scale == 1.0 && offset == 0.0)
        return ReadFloats(start, count, size, values);
    block.resize(size);
    if (Status status = file->Read(*variable, start, count, block.data()); !status)
        return status;
    std::ranges::transform(block, values, [this](double raw) { return Decode(raw); });
    return Status::Ok();
}

} // namespace ryn
