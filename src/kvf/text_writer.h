#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "kvf/kvf.h"

namespace ryn {

/// Writes what it is told as text; docs/formats/kvf.md.
class KvfTextWriter : public KvfVisitor {
  public:
    void BeginSection(std::string_view name) override;
    void EndSection() override;
    void BeginKeyword(std::string_view name, int parameterCount) override;
    void Parameter(const KvfParam& parameter) override;
    void EndKeyword() override;

    const std::string& Text() const { return text; }
    /// Levels of blocks at the deepest place; above kKvfMaxDepth the text cannot be read back.
    std::size_t Depth() const { return deepest; }

  private:
    void Indent(std::size_t level);

    std::string text;
    std::size_t lineStart = 0;
    std::size_t depth = 0;
    std::size_t deepest = 0;
    bool isFirstParameter = true;
};

} // namespace ryn
