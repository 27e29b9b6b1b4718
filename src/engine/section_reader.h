#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "kvf/kvf.h"

namespace ryn {

/// Sentences about a tree, each naming section and keyword: "DefineEVS/AvgAnNum is not a number".
using Sentences = std::vector<std::string>;

/// Reads the keywords of one section and notes what is wrong with them. Of a section that does not
/// exist, which is told once by whoever looked for it, every keyword has its default in silence.
class SectionReader {
  public:
    /// `path` is the section's name as sentences give it. `faults` must outlive the reader.
    SectionReader(const KvfSection* keywords, std::string path, Sentences& faults)
        : section(keywords),
          name(std::move(path)),
          noted(&faults) {}

    /// A section inside this one; whether it exists is the caller's affair.
    SectionReader Inside(std::string_view child) const;
    bool Exists() const { return section != nullptr; }
    bool Has(std::string_view keyword) const {
        return kvfKeywordByNameNum(section, keyword, 1) != nullptr;
    }
    const KvfSection* Section() const { return section; }
    /// "PATH/KEYWORD"
    std::string PathOf(std::string_view keyword) const;

    /// The first value of a keyword: `fallback` where there is none. A value of another type is a
    /// fault. `Type` is int, bool, double or std::string.
    template <typename Type>
    Type Optional(const char* keyword, Type fallback) const;
    /// The same where it is a fault too that there is none.
    template <typename Type>
    Type Required(const char* keyword) const;

    /// Notes "PATH/KEYWORD REST".
    void Fault(std::string_view keyword, std::string_view rest) const;

  private:
    const KvfSection* section;
    std::string name;
    Sentences* noted;
};

} // namespace ryn
