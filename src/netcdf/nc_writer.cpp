#include "netcdf/nc_writer.h"

#include <cerrno>
#include <fcntl.h>
#include <utility>

#include <netcdf.h>

#include "netcdf/library_call.h"

namespace ryn {

NcFormat FormatForVariable(std::size_t largestVariableBytes) {
    constexpr std::size_t kOffset64Limit = 0xFFFFFFFCU; // 4 GiB less the filling
    return largestVariableBytes < kOffset64Limit ? NcFormat::Offset64 : NcFormat::Data64;
}

NcWriter::NcWriter(const std::string& path, std::string shownPath, NcFormat format)
    : shown(std::move(shownPath)) {
    const Descriptor descriptor(::open(path.c_str(), O_RDWR | O_CLOEXEC));
    if (descriptor.Get() < 0) {
        status = Status::FromErrno(shown, errno);
        return;
    }
    const auto lock = LockNetcdf();
    const int mode = NC_CLOBBER | (format == NcFormat::Data64 ? NC_64BIT_DATA : NC_64BIT_OFFSET);
    Note("creating", nc_create(descriptor.Name().c_str(), mode, &handle));
    if (!Good())
        handle = kClosed;
    else // every value is written, so filling them first would write the file twice
        Note("creating", nc_set_fill(handle, NC_NOFILL, nullptr));
}

NcWriter::~NcWriter() {
    // Not finished: what was written is thrown away with the temporary file.
    if (handle == kClosed)
        return;
    const auto lock = LockNetcdf();
    nc_abort(handle);
}

void NcWriter::Note(const std::string& place, int code) {
    if (code != NC_NOERR && status.IsOk())
        status = NetcdfFault(shown, place, code);
}

int NcWriter::DefineDimension(const std::string& name, std::size_t length) {
    int id = 0;
    const auto lock = LockNetcdf();
    if (Good())
        Note("dimension " + name, nc_def_dim(handle, name.c_str(), length, &id));
    return id;
}

int NcWriter::DefineVariable(const std::string& name, NcType type,
                             std::span<const int> dimensions) {
    int id = 0;
    const auto lock = LockNetcdf();
    if (Good())
        Note("variable " + name,
             nc_def_var(handle, name.c_str(), static_cast<int>(type),
                        static_cast<int>(dimensions.size()), dimensions.data(), &id));
    return id;
}

void NcWriter::PutText(int variable, const std::string& name, std::string_view text) {
    const auto lock = LockNetcdf();
    if (Good())
        Note("attribute " + name,
             nc_put_att_text(handle, variable, name.c_str(), text.size(), text.data()));
}

void NcWriter::PutInt(int variable, const std::string& name, int value) {
    const auto lock = LockNetcdf();
    if (Good())
        Note("attribute " + name,
             nc_put_att_int(handle, variable, name.c_str(), NC_INT, 1, &value));
}

void NcWriter::PutFloats(int variable, const std::string& name, std::span<const float> values) {
    const auto lock = LockNetcdf();
    if (Good())
        Note("attribute " + name, nc_put_att_float(handle, variable, name.c_str(), NC_FLOAT,
                                                   values.size(), values.data()));
}

void NcWriter::PutDoubles(int variable, const std::string& name, std::span<const double> values) {
    const auto lock = LockNetcdf();
    if (Good())
        Note("attribute " + name, nc_put_att_double(handle, variable, name.c_str(), NC_DOUBLE,
                                                    values.size(), values.data()));
}

void NcWriter::EndDefinitions() {
    const auto lock = LockNetcdf();
    if (Good())
        Note("writing the header", nc_enddef(handle));
}

void NcWriter::Write(int variable, std::span<const std::size_t> start,
                     std::span<const std::size_t> count, const double* values) {
    const auto lock = LockNetcdf();
    if (Good())
        Note("writing", nc_put_vara_double(handle, variable, start.data(), count.data(), values));
}

void NcWriter::Write(int variable, std::span<const std::size_t> start,
                     std::span<const std::size_t> count, const float* values) {
    const auto lock = LockNetcdf();
    if (Good())
        Note("writing", nc_put_vara_float(handle, variable, start.data(), count.data(), values));
}

Status NcWriter::Finish() {
    const auto lock = LockNetcdf();
    if (handle != kClosed)
        Note("writing", nc_close(std::exchange(handle, kClosed)));
    return status;
}

} // namespace ryn
