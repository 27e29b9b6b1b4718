#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>

#include "kvf/kvf.h"

namespace ryn {

/// Writes what it is told as text; docs/formats/kvf.md.
class KvfTextWriter : public KvfVisitor {
  public:
    /// Writes behind `before`, which is empty or ends with a line feed.
    explicit KvfTextWriter(std::string before = {}) : text(std::move(before)) {}

    void BeginSection(std::string_view name) override;
    void EndSection() override;
    void BeginKeyword(std::string_view name, int parameterCount) override;
    void Parameter(const KvfParam& parameter) override;
    void EndKeyword() override;

    /// The text, which the writer no longer has.
    std::string TakeText() { return std::move(text); }
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
