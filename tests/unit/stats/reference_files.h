#pragma once

#include <charconv>
#include <cmath>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace ryn::stats::testing {

inline std::string ReferencePath(const std::string& name) {
    return std::string(RYN_SOURCE_DIR) + "/tests/reference/stats/" + name;
}

/// A number of a reference file; NA (R's missing value) is NaN.
inline double ReferenceNumber(const std::string& text) {
    double value = std::nan("");
    const char* begin = text.data() + text.find_first_not_of(' ');
    const auto parsed = std::from_chars(begin, text.data() + text.size(), value);
    if (parsed.ec != std::errc() && text.find("NA") == std::string::npos) {
        throw std::runtime_error("not a number in a reference file: " + text);
    }
    return value;
}

/// The rows of a comma-separated reference file, without its header line.
inline std::vector<std::vector<std::string>> ReferenceTable(const std::string& name) {
    std::ifstream file(ReferencePath(name));
    std::string line;
    std::getline(file, line);
    std::vector<std::vector<std::string>> rows;
    while (std::getline(file, line)) {
        std::istringstream cells(line);
        std::vector<std::string>& row = rows.emplace_back();
        for (std::string cell; std::getline(cells, cell, ',');) {
            row.push_back(cell);
        }
    }
    if (rows.empty()) {
        throw std::runtime_error("cannot read " + ReferencePath(name));
    }
    return rows;
}

/// A series of the reference folder, in time order.
inline std::vector<double> ReferenceSeries(const std::string& name) {
    std::ifstream file(ReferencePath("series/" + name + ".txt"));
    std::vector<double> values;
    for (std::string line; std::getline(file, line);) {
        if (line.rfind('#', 0) != 0) {
            values.push_back(ReferenceNumber(line));
        }
    }
    if (values.empty()) {
        throw std::runtime_error("no such series: " + name);
    }
    return values;
}

/// Half a unit of the last of `digits` significant digits: how far a rounded reference value may
/// lie from the exact one.
inline double HalfUnit(double reference, int digits) {
    const double exponent = std::floor(std::log10(std::abs(reference)));
    return 0.5000001 * std::pow(10.0, exponent + 1 - digits);
}

} // namespace ryn::stats::testing
