#pragma once

#include <cmath>
#include <cstddef>
#include <map>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <netcdf.h>

namespace ryn::test {

/// Writes a small netCDF file through the C library itself, so that it can hold what this system
/// never writes. Definitions come first, values after them.
class NetcdfSample {
  public:
    explicit NetcdfSample(std::string name, int mode = 0) : path(std::move(name)) {
        Ok(nc_create(path.c_str(), NC_CLOBBER | mode, &handle));
    }
    ~NetcdfSample() { Finish(); }
    NetcdfSample(const NetcdfSample&) = delete;
    NetcdfSample& operator=(const NetcdfSample&) = delete;

    NetcdfSample& Dimension(const std::string& name, std::size_t length) {
        int id = 0;
        Ok(nc_def_dim(handle, name.c_str(), length, &id));
        return *this;
    }

    NetcdfSample& Variable(const std::string& name, int type,
                           const std::vector<std::string>& dimensions) {
        std::vector<int> places(dimensions.size());
        for (std::size_t i = 0; i < places.size(); ++i)
            Ok(nc_inq_dimid(handle, dimensions[i].c_str(), &places[i]));
        int id = 0;
        Ok(nc_def_var(handle, name.c_str(), type, static_cast<int>(places.size()), places.data(),
                      &id));
        return *this;
    }

    NetcdfSample& Text(const std::string& variable, const std::string& name,
                       const std::string& text) {
        Ok(nc_put_att_text(handle, Id(variable), name.c_str(), text.size(), text.c_str()));
        return *this;
    }

    /// A number of the variable's own type.
    NetcdfSample& Mark(const std::string& variable, const std::string& name, double value) {
        int type = 0;
        Ok(nc_inq_vartype(handle, Id(variable), &type));
        return Number(variable, name, value, type);
    }
    NetcdfSample& Number(const std::string& variable, const std::string& name, double value,
                         int type = NC_DOUBLE) {
        Ok(nc_put_att_double(handle, Id(variable), name.c_str(), type, 1, &value));
        return *this;
    }

    NetcdfSample& Chunks(const std::string& variable, const std::vector<std::size_t>& lengths) {
        Ok(nc_def_var_chunking(handle, Id(variable), NC_CHUNKED, lengths.data()));
        Ok(nc_def_var_deflate(handle, Id(variable), 1, 1, 1));
        return *this;
    }

    NetcdfSample& Values(const std::string& variable, const std::vector<double>& values) {
        if (isDefining)
            Ok(nc_enddef(handle));
        isDefining = false;
        int places[NC_MAX_VAR_DIMS] = {};
        int rank = 0;
        Ok(nc_inq_varndims(handle, Id(variable), &rank));
        Ok(nc_inq_vardimid(handle, Id(variable), places));
        const std::vector<std::size_t> start(static_cast<std::size_t>(rank), 0);
        std::vector<std::size_t> count(start);
        std::size_t known = 1;
        for (std::size_t i = count.size(); i-- > 0;) {
            Ok(nc_inq_dimlen(handle, places[i], &count[i]));
            // An unlimited dimension has no length before its values.
            if (i == 0)
                count[i] = values.size() / known;
            known *= count[i];
        }
        EXPECT_EQ(known, values.size()) << variable;
        const int code =
            nc_put_vara_double(handle, Id(variable), start.data(), count.data(), values.data());
        // What the type cannot hold, an infinity among floats, is told and written.
        EXPECT_TRUE(code == NC_NOERR || code == NC_ERANGE) << nc_strerror(code);
        return *this;
    }

    const std::string& Finish() {
        if (handle >= 0)
            Ok(nc_close(handle));
        handle = -1;
        return path;
    }

  private:
    static void Ok(int code) { EXPECT_EQ(code, NC_NOERR) << nc_strerror(code); }
    int Id(const std::string& variable) const {
        int id = NC_GLOBAL;
        if (!variable.empty())
            Ok(nc_inq_varid(handle, variable.c_str(), &id));
        return id;
    }

    std::string path;
    int handle = -1;
    bool isDefining = true;
};

} // namespace ryn::test
