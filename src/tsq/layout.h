#pragma once

/// Names in the files that this system writes, shared by writer and reader. docs/formats/tsq.md
/// describes the format.
namespace ryn::layout {

inline constexpr int kFormat = 1; ///< value of kFormatName

// Attributes of the file.
inline constexpr auto* kFormatName = "ryn_format"; ///< marks a file of ours
inline constexpr auto* kFileType = "ryn_file_type";
inline constexpr auto* kStatisticsKind = "ryn_statistics_kind";
inline constexpr auto* kApplication = "ryn_application";
inline constexpr auto* kApplicationVersion = "ryn_application_version";
inline constexpr auto* kApplicationTitle = "ryn_application_title";
inline constexpr auto* kDataType = "ryn_data_type";
inline constexpr auto* kDeleteFloat = "ryn_delete_value_float";
inline constexpr auto* kDeleteDouble = "ryn_delete_value_double";
inline constexpr auto* kProjection = "ryn_projection";
inline constexpr auto* kProjectionOrigin =
    "ryn_projection_origin"; ///< longitude, latitude, rotation

// Attributes of the time variable.
inline constexpr auto* kAxis = "ryn_axis";
inline constexpr auto* kAxisUnit = "ryn_unit";
inline constexpr auto* kStart = "ryn_start";
inline constexpr auto* kStep = "ryn_step";
inline constexpr auto* kIndex = "ryn_index";

// Attributes of an item's variable.
inline constexpr auto* kItemType = "ryn_type";
inline constexpr auto* kItemUnit = "ryn_unit";
inline constexpr auto* kValueType = "ryn_value_type";
inline constexpr auto* kReference = "ryn_reference";     ///< x, y, z
inline constexpr auto* kOrientation = "ryn_orientation"; ///< alpha, phi, theta
inline constexpr auto* kAxesUnit = "ryn_axes_unit";

inline constexpr auto* kTime = "time";

} // namespace ryn::layout
