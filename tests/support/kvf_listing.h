#pragma once

#include <bit>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "kvf/kvf.h"

namespace ryn::test {

/// A tree as lines, one for each part, in which numbers stand by their bits: two trees are the same
/// to the bit when their listings are equal.
class KvfListing : public KvfVisitor {
  public:
    std::vector<std::string> lines;

    void BeginSection(std::string_view name) override { Add("section " + std::string(name)); }
    void EndSection() override { Add("end"); }
    void BeginKeyword(std::string_view name, int parameterCount) override {
        Add("keyword " + std::string(name) + " of " + std::to_string(parameterCount));
    }
    void Parameter(const KvfParam& parameter) override { Add(Describe(parameter)); }
    void EndKeyword() override {}

  private:
    void Add(std::string line) { lines.push_back(std::move(line)); }

    static std::string Describe(const KvfParam& parameter) {
        switch (kvfParamType(parameter)) {
        case KvfType::Int:
            return "int " + std::to_string(kvfParamInt(parameter));
        case KvfType::Float:
            return "float " + Bits(std::bit_cast<std::uint32_t>(kvfParamFloat(parameter)));
        case KvfType::Double:
            return "double " + Bits(std::bit_cast<std::uint64_t>(kvfParamDouble(parameter)));
        case KvfType::Bool:
            return kvfGetBool(&parameter) ? "true" : "false";
        case KvfType::Text:
            return "text " + std::string(kvfParamText(parameter));
        case KvfType::FileName:
            return "file " + std::string(kvfParamText(parameter));
        }
        return "no type";
    }

    static std::string Bits(std::uint64_t bits) { return std::to_string(bits); }
};

inline std::vector<std::string> ListKvf(const KvfHandle& tree) {
    KvfListing listing;
    kvfVisit(tree.get(), listing);
    return listing.lines;
}

/// The description of the last failed load.
inline std::string KvfErrorText() {
    std::string text;
    kvfGetSyntaxErr(nullptr, nullptr, nullptr, &text);
    return text;
}

} // namespace ryn::test
