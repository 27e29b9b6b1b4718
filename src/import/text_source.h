#pragma once

#include <cstddef>
#include <cstdio>
#include <memory>
#include <string>
#include <string_view>

#include "base/status.h"

namespace ryn {

/// Bytes of a table, read in blocks from the start, as often as asked.
class TextSource {
  public:
    virtual ~TextSource() = default;

    /// Reads up to `size` bytes; *got is their number, 0 at the end.
    virtual Status Read(char* buffer, std::size_t size, std::size_t* got) = 0;
    /// Goes back to the first byte.
    virtual Status Rewind() = 0;
    /// How messages call it.
    virtual const std::string& Name() const = 0;
};

/// A regular file. Directories and what cannot go back to its start (a pipe) are refused, since a
/// table is read twice.
class FileSource : public TextSource {
  public:
    static Status Open(const std::string& path, std::unique_ptr<TextSource>* source);

    Status Read(char* buffer, std::size_t size, std::size_t* got) override;
    Status Rewind() override;
    const std::string& Name() const override { return path; }

  private:
    struct Close {
        void operator()(std::FILE* stream) const { std::fclose(stream); }
    };

    std::string path;
    std::unique_ptr<std::FILE, Close> file;
};

/// Text in memory; the text has to outlive the source.
class MemorySource : public TextSource {
  public:
    MemorySource(std::string sourceName, std::string_view content)
        : name(std::move(sourceName)),
          text(content) {}

    Status Read(char* buffer, std::size_t size, std::size_t* got) override;
    Status Rewind() override;
    const std::string& Name() const override { return name; }

  private:
    std::string name;
    std::string_view text;
    std::size_t position = 0;
};

} // namespace ryn
