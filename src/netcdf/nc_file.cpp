#include "netcdf/nc_file.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <utility>

#include <netcdf.h>

#include "netcdf/library_call.h"

namespace ryn {

namespace {

constexpr std::size_t kMaxTextBytes = 65536;
constexpr std::size_t kMaxNumbers = 1024;
// The library's window on a classic file. Its own default reads a series half as fast, and a large
// one is filled anew whenever the reading goes from the times to the values.
constexpr std::size_t kWindowOfLongRuns = 65536;
// Of short runs a larger one would read what lies between them too.
constexpr std::size_t kWindowOfShortRuns = 4096;

Status CheckRegular(int descriptor, const std::string& path, std::uint64_t* size) {
    struct stat info {};
    if (descriptor < 0 || ::fstat(descriptor, &info) != 0)
        return Status::FromErrno(path, errno);
    if (S_ISDIR(info.st_mode))
        return Status::FromErrno(path, EISDIR);
    if (!S_ISREG(info.st_mode))
        return Status::InputFault(path + ": not a regular file");
    *size = static_cast<std::uint64_t>(info.st_size);
    return Status::Ok();
}

int LibraryId(int variable) {
    return variable == kNcGlobal ? NC_GLOBAL : variable;
}

/// A netCDF-4 text attribute is a list of strings, mostly of one.
std::string FirstString(int handle, int variable, const std::string& name, std::size_t length) {
    std::vector<char*> texts(length, nullptr);
    std::string first;
    if (nc_get_att_string(handle, variable, name.c_str(), texts.data()) == NC_NOERR) {
        if (texts[0] != nullptr)
            first = texts[0];
        nc_free_string(length, texts.data());
    }
    return first;
}

} // namespace

NcFile::~NcFile() {
    Close();
}

NcFile::NcFile(NcFile&& other) noexcept {
    *this = std::move(other);
}

NcFile& NcFile::operator=(NcFile&& other) noexcept {
    if (this == &other)
        return *this;
    Close();
    handle = std::exchange(other.handle, kClosed);
    path = std::move(other.path);
    container = other.container;
    fileSize = other.fileSize;
    dimensions = std::move(other.dimensions);
    variables = std::move(other.variables);
    return *this;
}

void NcFile::Close() {
    if (handle == kClosed)
        return;
    const auto lock = LockNetcdf();
    nc_close(handle);
    handle = kClosed;
}

Status NcFile::Open(const std::string& path, NcFile* file, NcRuns runs) {
    NcFile opened;
    opened.path = path;
    // Without O_NONBLOCK a named pipe without a writer would stop the program here.
    const Descriptor descriptor(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (Status status = CheckRegular(descriptor.Get(), path, &opened.fileSize); !status)
        return status;
    if (Status status = CheckContainer(descriptor.Get(), path, &opened.container); !status)
        return status;
    {
        const auto lock = LockNetcdf();
        std::size_t window = runs == NcRuns::Short ? kWindowOfShortRuns : kWindowOfLongRuns;
        const int code = nc__open(descriptor.Name().c_str(), NC_NOWRITE, &window, &opened.handle);
        if (code != NC_NOERR) {
            opened.handle = kClosed;
            return NetcdfFault(path, "opening", code);
        }
    }
    if (Status status = opened.ReadLayout(); !status)
        return status;
    *file = std::move(opened);
    return Status::Ok();
}

Status NcFile::ReadLayout() {
    const auto lock = LockNetcdf();
    if (Status status = ReadDimensions(); !status)
        return status;
    int count = 0;
    if (const int code = nc_inq_nvars(handle, &count); code != NC_NOERR)
        return NetcdfFault(path, "counting variables", code);
    for (int id = 0; id < count; ++id)
        if (Status status = ReadVariable(id); !status)
            return status;
    return Status::Ok();
}

Status NcFile::ReadDimensions() {
    int count = 0;
    if (const int code = nc_inq_ndims(handle, &count); code != NC_NOERR)
        return NetcdfFault(path, "counting dimensions", code);
    for (int id = 0; id < count; ++id) {
        std::array<char, NC_MAX_NAME + 1> name{};
        std::size_t length = 0;
        // The root group's dimensions are numbered without gaps.
        if (const int code = nc_inq_dim(handle, id, name.data(), &length); code != NC_NOERR)
            return NetcdfFault(path, "reading a dimension", code);
        dimensions.push_back({name.data(), length});
    }
    return Status::Ok();
}

Status NcFile::ReadVariable(int id) {
    std::array<char, NC_MAX_NAME + 1> name{};
    std::array<int, NC_MAX_VAR_DIMS> places{};
    int type = 0;
    int count = 0;
    int code = nc_inq_varndims(handle, id, &count);
    if (code == NC_NOERR && count > NC_MAX_VAR_DIMS)
        code = NC_EMAXDIMS;
    if (code == NC_NOERR)
        code = nc_inq_var(handle, id, name.data(), &type, nullptr, places.data(), nullptr);
    if (code != NC_NOERR)
        return NetcdfFault(path, "reading a variable", code);
    NcVariable variable{id,
                        name.data(),
                        static_cast<NcType>(std::min(type, static_cast<int>(NcType::String))),
                        {places.begin(), places.begin() + count}};
    // A forged file may name dimensions that the root group does not have.
    const auto exists = [&](int place) {
        return place >= 0 && static_cast<std::size_t>(place) < dimensions.size();
    };
    if (!std::ranges::all_of(variable.dimensions, exists))
        return InputFault(variable, "has a dimension that does not exist");
    variables.push_back(std::move(variable));
    return Status::Ok();
}

const NcVariable* NcFile::FindVariable(const std::string& name) const {
    const auto found = std::ranges::find(variables, name, &NcVariable::name);
    return found != variables.end() ? &*found : nullptr;
}

std::optional<std::string> NcFile::Text(int variable, const std::string& name) const {
    const auto lock = LockNetcdf();
    const int id = LibraryId(variable);
    int type = 0;
    std::size_t length = 0;
    if (nc_inq_att(handle, id, name.c_str(), &type, &length) != NC_NOERR || length > kMaxTextBytes)
        return std::nullopt;
    if (type == NC_STRING && length > 0)
        return FirstString(handle, id, name, length);
    if (type != NC_CHAR)
        return std::nullopt;
    std::string text(length, '\0');
    if (nc_get_att_text(handle, id, name.c_str(), text.data()) != NC_NOERR)
        return std::nullopt;
    // C programs often store the terminating NUL with the text.
    text.erase(text.find_last_not_of('\0') + 1);
    return text;
}

std::optional<std::vector<double>> NcFile::Numbers(int variable, const std::string& name) const {
    const auto lock = LockNetcdf();
    const int id = LibraryId(variable);
    int type = 0;
    std::size_t length = 0;
    if (nc_inq_att(handle, id, name.c_str(), &type, &length) != NC_NOERR || type >= NC_STRING ||
        type == NC_CHAR || length > kMaxNumbers)
        return std::nullopt;
    std::vector<double> values(length);
    if (nc_get_att_double(handle, id, name.c_str(), values.data()) != NC_NOERR)
        return std::nullopt;
    return values;
}

std::optional<double> NcFile::Number(int variable, const std::string& name) const {
    const auto values = Numbers(variable, name);
    return values && values->size() == 1 ? std::optional(values->front()) : std::nullopt;
}

std::vector<std::size_t> NcFile::ChunkShape(const NcVariable& variable) const {
    std::vector<std::size_t> lengths(variable.dimensions.size(), 0);
    if (container != NcContainer::Hdf5 || lengths.empty())
        return {};
    const auto lock = LockNetcdf();
    int storage = NC_CONTIGUOUS;
    const int code = nc_inq_var_chunking(handle, variable.id, &storage, lengths.data());
    const bool isChunked =
        code == NC_NOERR && storage == NC_CHUNKED && !std::ranges::count(lengths, std::size_t{0});
    return isChunked ? lengths : std::vector<std::size_t>();
}

Status NcFile::Read(const NcVariable& variable, std::span<const std::size_t> start,
                    std::span<const std::size_t> count, double* values) const {
    const auto lock = LockNetcdf();
    const int code = nc_get_vara_double(handle, variable.id, start.data(), count.data(), values);
    return code == NC_NOERR ? Status::Ok()
                            : NetcdfFault(path, "reading \"" + variable.name + "\"", code);
}

Status NcFile::Read(const NcVariable& variable, std::span<const std::size_t> start,
                    std::span<const std::size_t> count, float* values) const {
    const auto lock = LockNetcdf();
    const int code = nc_get_vara_float(handle, variable.id, start.data(), count.data(), values);
    return code == NC_NOERR ? Status::Ok()
                            : NetcdfFault(path, "reading \"" + variable.name + "\"", code);
}

Status NcFile::InputFault(const std::string& reason) const {
    return Status::InputFault(path + ": " + reason);
}

Status NcFile::InputFault(const NcVariable& variable, const std::string& reason) const {
    return InputFault("\"" + variable.name + "\" " + reason);
}

} // namespace ryn
