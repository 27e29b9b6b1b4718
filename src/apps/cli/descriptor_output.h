#pragma once

#include <streambuf>
#include <vector>

namespace ryn::cli {

/// Buffered output to a file descriptor that remembers why a write failed, which the standard
/// streams do not tell. After a failure everything is dropped. The descriptor stays the caller's.
class DescriptorOutput : public std::streambuf {
  public:
    explicit DescriptorOutput(int descriptor);
    ~DescriptorOutput() override;
    DescriptorOutput(const DescriptorOutput&) = delete;
    DescriptorOutput& operator=(const DescriptorOutput&) = delete;

    /// The errno value of the first write that failed; 0 when none did.
    int Error() const { return error; }

  protected:
    int_type overflow(int_type character) override;
    int sync() override;

  private:
    bool WriteBuffer();

    int fd;
    int error = 0;
    std::vector<char> buffer;
};

} // namespace ryn::cli
