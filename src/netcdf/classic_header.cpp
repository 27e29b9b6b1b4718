#include "netcdf/classic_header.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace ryn {

namespace {

constexpr std::uint64_t kMaxNameBytes = 256; // the library's own limits
constexpr std::uint64_t kMaxDimensionsOfOne = 1024;
constexpr std::uint64_t kTagDimension = 10;
constexpr std::uint64_t kTagVariable = 11;
constexpr std::uint64_t kTagAttribute = 12;

/// Numbers and stretches of bytes one behind the other; the first fault stays, and everything
/// behind it reads as 0.
class Cursor {
  public:
    Cursor(int fd, std::uint64_t size) : descriptor(fd), fileSize(size) {}

    std::uint64_t Number(int bytes) {
        std::uint64_t value = 0;
        for (int i = 0; i < bytes; ++i)
            value = value << 8 | NextByte();
        return fault.empty() ? value : 0;
    }
    void Skip(std::uint64_t bytes) {
        if (bytes > fileSize - position)
            Fail("the file ends within its header");
        else
            position += bytes;
    }
    /// A stretch that is filled up to a multiple of four.
    void SkipPadded(std::uint64_t bytes) {
        Skip(bytes);
        Skip((4 - bytes % 4) % 4);
    }
    void Fail(const std::string& reason) {
        if (fault.empty())
            fault = reason;
    }
    bool Good() const { return fault.empty(); }
    const std::string& Fault() const { return fault; }
    std::uint64_t Position() const { return position; }
    std::uint64_t FileSize() const { return fileSize; }

  private:
    unsigned char NextByte() {
        if (!Good())
            return 0;
        if (position < bufferStart || position >= bufferStart + filled)
            Fill();
        return Good() ? buffer[position++ - bufferStart] : static_cast<unsigned char>(0);
    }
    void Fill() {
        const ssize_t got =
            ::pread(descriptor, buffer.data(), buffer.size(), static_cast<off_t>(position));
        bufferStart = position;
        filled = static_cast<std::uint64_t>(std::max<ssize_t>(got, 0));
        if (got < 0)
            Fail(std::strerror(errno));
        else if (got == 0)
            Fail("the file ends within its header");
    }

    int descriptor;
    std::uint64_t fileSize;
    std::uint64_t position = 0;
    std::uint64_t bufferStart = 0;
    std::uint64_t filled = 0;
    std::array<unsigned char, 16384> buffer{};
    std::string fault;
};

/// Bytes of one value; 0 for a type that the format's version does not know.
std::uint64_t TypeBytes(std::uint64_t type, int version) {
    constexpr std::array<std::uint64_t, 12> kBytes = {0, 1, 1, 2, 4, 4, 8, 1, 2, 4, 8, 8};
    const std::uint64_t last = version == 5 ? 11 : 6;
    return type <= last ? kBytes[type] : 0;
}

std::uint64_t SaturatingProduct(std::uint64_t a, std::uint64_t b) {
    std::uint64_t product = 0;
    return __builtin_mul_overflow(a, b, &product) ? UINT64_MAX : product;
}

std::uint64_t SaturatingSum(std::uint64_t a, std::uint64_t b) {
    std::uint64_t sum = 0;
    return __builtin_add_overflow(a, b, &sum) ? UINT64_MAX : sum;
}

/// Walks the header in the order of the format's grammar: number of records, dimensions,
/// attributes of the file, variables with theirs. No count is used before it was tested, so that
/// neither time nor memory grows beyond what the file's size allows.
class ClassicHeader {
  public:
    ClassicHeader(Cursor* source, int formatVersion)
        : cursor(*source),
          version(formatVersion),
          width(formatVersion == 5 ? 8 : 4) {}

    void Check() {
        records = cursor.Number(width);
        if (records == (width == 8 ? UINT64_MAX : UINT32_MAX))
            cursor.Fail("the number of records was never written");
        ReadDimensions();
        SkipAttributes();
        ReadVariables();
        headerEnd = cursor.Position();
        CheckExtents();
    }

  private:
    struct Variable {
        std::uint64_t begin = 0;
        std::uint64_t bytes = 0; // of one record where it has records
        bool hasRecords = false;
    };

    /// Number of entries of a list; each takes at least `leastBytes`.
    std::uint64_t ListLength(std::uint64_t expectedTag, std::uint64_t leastBytes) {
        const std::uint64_t tag = cursor.Number(4);
        const std::uint64_t count = cursor.Number(width);
        if (tag != expectedTag && (tag != 0 || count != 0))
            cursor.Fail("the header is broken");
        if (count > (cursor.FileSize() - cursor.Position()) / leastBytes)
            cursor.Fail("the header counts more entries than the file has room for");
        return cursor.Good() ? count : 0;
    }
    void SkipName() {
        const std::uint64_t length = cursor.Number(width);
        if (length > kMaxNameBytes)
            cursor.Fail("a name is longer than 256 bytes");
        else
            cursor.SkipPadded(length);
    }
    void ReadDimensions() {
        const std::uint64_t count = ListLength(kTagDimension, 8);
        for (std::uint64_t i = 0; i < count && cursor.Good(); ++i) {
            SkipName();
            dimensions.push_back(cursor.Number(width));
        }
        if (std::ranges::count(dimensions, 0U) > 1)
            cursor.Fail("the header has several dimensions without a length");
    }
    void SkipAttributes() {
        const std::uint64_t count = ListLength(kTagAttribute, 12);
        for (std::uint64_t i = 0; i < count && cursor.Good(); ++i) {
            SkipName();
            const std::uint64_t bytes = TypeBytes(cursor.Number(4), version);
            if (bytes == 0)
                cursor.Fail("an attribute has an unknown type");
            cursor.SkipPadded(SaturatingProduct(cursor.Number(width), bytes));
        }
    }
    void ReadVariables() {
        const std::uint64_t count = ListLength(kTagVariable, 28);
        for (std::uint64_t i = 0; i < count && cursor.Good(); ++i)
            variables.push_back(ReadVariable());
    }
    Variable ReadVariable() {
        Variable variable;
        SkipName();
        const std::uint64_t count = cursor.Number(width);
        if (count > kMaxDimensionsOfOne)
            cursor.Fail("a variable has more than 1024 dimensions");
        std::uint64_t elements = 1;
        for (std::uint64_t i = 0; i < count && cursor.Good(); ++i) {
            const std::uint64_t length = DimensionLength(cursor.Number(width), i);
            variable.hasRecords = variable.hasRecords || length == 0;
            elements = SaturatingProduct(elements, std::max<std::uint64_t>(length, 1));
        }
        SkipAttributes();
        const std::uint64_t bytes = TypeBytes(cursor.Number(4), version);
        if (bytes == 0)
            cursor.Fail("a variable has an unknown type");
        cursor.Number(width); // the size as written; the dimensions tell it better
        variable.bytes = SaturatingProduct(elements, bytes);
        variable.begin = cursor.Number(version == 1 ? 4 : 8);
        return variable;
    }
    std::uint64_t DimensionLength(std::uint64_t index, std::uint64_t place) {
        if (index >= dimensions.size())
            cursor.Fail("a variable has a dimension that does not exist");
        else if (dimensions[index] == 0 && place != 0)
            cursor.Fail("a variable's records are not its first dimension");
        return cursor.Good() ? dimensions[index] : 1;
    }

    /// Bytes from one record to the next: each variable's part is filled up to a multiple of four,
    /// but for a variable that has the records to itself.
    std::uint64_t RecordBytes() const {
        std::uint64_t padded = 0;
        std::uint64_t exact = 0;
        std::uint64_t count = 0;
        for (const Variable& variable : variables) {
            if (!variable.hasRecords)
                continue;
            ++count;
            exact = variable.bytes;
            padded = SaturatingSum(padded, SaturatingSum(variable.bytes, 3) & ~std::uint64_t{3});
        }
        return count == 1 ? exact : padded;
    }
    void CheckExtents() {
        if (!cursor.Good())
            return;
        // The last record needs no filling behind it, so that the exact sizes count.
        const std::uint64_t recordBytes = RecordBytes();
        for (const Variable& variable : variables) {
            if (variable.hasRecords && records == 0)
                continue;
            const std::uint64_t before =
                variable.hasRecords ? SaturatingProduct(records - 1, recordBytes) : 0;
            const std::uint64_t end =
                SaturatingSum(SaturatingSum(variable.begin, before), variable.bytes);
            if (variable.begin < headerEnd)
                cursor.Fail("a variable lies within the header");
            else if (end > cursor.FileSize())
                cursor.Fail("the file is cut off: it has " + std::to_string(cursor.FileSize()) +
                            " bytes, and its header describes at least " + std::to_string(end));
        }
    }

    Cursor& cursor;
    int version;
    int width; // bytes of a count
    std::uint64_t records = 0;
    std::uint64_t headerEnd = 0;
    std::vector<std::uint64_t> dimensions;
    std::vector<Variable> variables;
};

bool IsHdf5(int descriptor, std::uint64_t fileSize) {
    constexpr std::array<unsigned char, 8> kSignature = {0x89, 'H',  'D',  'F',
                                                         '\r', '\n', 0x1a, '\n'};
    std::array<unsigned char, 8> bytes{};
    // A block of the user's may stand before the signature.
    for (std::uint64_t place = 0; place + 8 <= fileSize; place = place == 0 ? 512 : place * 2)
        if (::pread(descriptor, bytes.data(), 8, static_cast<off_t>(place)) == 8 &&
            bytes == kSignature)
            return true;
    return false;
}

} // namespace

Status CheckContainer(int descriptor, const std::string& path, NcContainer* container) {
    struct stat info {};
    if (::fstat(descriptor, &info) != 0)
        return Status::FromErrno(path, errno);
    const auto fileSize = static_cast<std::uint64_t>(info.st_size);
    Cursor cursor(descriptor, fileSize);
    const std::uint64_t magic = cursor.Number(4);
    const int version = static_cast<int>(magic & 0xff);
    if (magic >> 8 == 0x434446 && (version == 1 || version == 2 || version == 5)) {
        ClassicHeader(&cursor, version).Check();
        if (!cursor.Good())
            return Status::InputFault(path + ": " + cursor.Fault());
        *container = NcContainer::Classic;
        return Status::Ok();
    }
    if (!IsHdf5(descriptor, fileSize))
        return Status::InputFault(path + ": no netCDF file");
    *container = NcContainer::Hdf5;
    return Status::Ok();
}

} // namespace ryn
