#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace ryn::test {

/// A directory of its own for a test, gone afterwards. The current directory is put back too.
class TemporaryDirectory {
  public:
    TemporaryDirectory() : previous(std::filesystem::current_path()) {
        std::string pattern = (std::filesystem::temp_directory_path() / "ryn-XXXXXX").string();
        root = ::mkdtemp(pattern.data());
    }
    ~TemporaryDirectory() {
        std::error_code error;
        std::filesystem::current_path(previous, error);
        std::filesystem::remove_all(root, error);
    }
    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    std::string Path(const std::string& name) const { return (root / name).string(); }
    const std::filesystem::path& Root() const { return root; }
    bool Has(const std::string& name) const { return std::filesystem::exists(root / name); }
    /// Names in the directory, hidden ones included.
    std::size_t EntryCount() const {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(root),
                                                      std::filesystem::directory_iterator()));
    }

    std::string Read(const std::string& name) const {
        std::ifstream file(root / name, std::ios::binary);
        std::ostringstream text;
        text << file.rdbuf();
        return text.str();
    }
    std::string Write(const std::string& name, const std::string& content) const {
        std::ofstream(root / name, std::ios::binary) << content;
        return Path(name);
    }

  private:
    std::filesystem::path previous;
    std::filesystem::path root;
};

} // namespace ryn::test
