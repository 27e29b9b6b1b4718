#pragma once

#include "import/import.h"
#include "import/text_source.h"

namespace ryn {

/// Another source that tells how far it was read. Both outlive it.
class WatchedSource final : public TextSource {
  public:
    WatchedSource(TextSource& watched, long long totalBytes, const ImportProgress& listener)
        : source(watched),
          total(totalBytes),
          progress(listener) {}

    Status Read(char* buffer, std::size_t size, std::size_t* got) override;
    Status Rewind() override;
    const std::string& Name() const override { return source.Name(); }

  private:
    TextSource& source;
    long long total;
    const ImportProgress& progress;
    long long done = 0;
};

} // namespace ryn
