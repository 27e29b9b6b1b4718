#pragma once

#include <string>
#include <vector>

#include "base/atomic_file.h"
#include "base/status.h"
#include "ports/ports.h"
#include "series/sts_item.h"

namespace ryn {

/// What a series file takes over from its source.
struct SeriesFileContent {
    std::string title;
    std::string itemName;
    int itemType = 0;
    int itemUnit = 0;
    bool hasCalendarAxis = false; ///< else a relative one
    Durability durability = Durability::Flushed;
};

/// Writes an extreme value series: one item on a non-equidistant axis in seconds from its first
/// sample, which lies at 0. An empty selection gives a valid file without time steps, whose
/// calendar axis starts on 1 January 1900. Errors of the data file store are shown through the
/// message port; the old file then stands as it was.
Status WriteSeriesFile(const std::string& path, const SeriesFileContent& content,
                       const std::vector<const STSItem*>& selection, const Ports& ports);

} // namespace ryn
