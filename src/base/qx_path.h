#pragma once

#include <string>

namespace ryn {

/// A file name that can tell its directory and its form relative to another directory.
class CQxPath {
  public:
    CQxPath() = default;
    explicit CQxPath(std::string fileName);

    void SetFileName(std::string fileName);
    const std::string& GetFileName() const { return fileName; }

    /// The directory with its trailing separator; empty when the name has none.
    std::string GetDirectoryName() const;

    /// The name as seen from `baseDirectory`, both taken as FullPath gives them. An empty name
    /// stays empty; a relative name, or an empty base directory, gives the name as it stands.
    std::string GetFileNameRelativeTo(const std::string& baseDirectory) const;

  private:
    std::string fileName;
};

} // namespace ryn
