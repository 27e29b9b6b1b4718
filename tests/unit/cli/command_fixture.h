#pragma once

#include <cstdlib>
#include <filesystem>
#include <sstream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "apps/cli/run_ryn.h"
#include "kvf/kvf.h"
#include "support/sample_series.h"
#include "support/temporary_directory.h"

namespace ryn::cli {

/// Runs the program's commands without a process, in a directory of their own, in English.
class CommandTest : public testing::Test {
  protected:
    CommandTest() {
        ::setenv("LC_ALL", "C", 1);
        std::filesystem::current_path(files.Root());
    }

    /// Runs a command line and keeps what it printed. The exit code.
    int Run(const std::vector<std::string>& arguments, const std::string& input = "") {
        std::ostringstream outStream;
        std::ostringstream errStream;
        std::istringstream inStream(input);
        Console console{outStream, errStream, inStream, false};
        const int code = RunRyn(arguments, console);
        out = outStream.str();
        err = errStream.str();
        return code;
    }

    nlohmann::ordered_json Json() const { return nlohmann::ordered_json::parse(out); }

    /// A setting of a saved analysis, as `info` shows it.
    nlohmann::ordered_json Saved(const std::string& file, const std::string& pointer) {
        EXPECT_EQ(Run({"info", file, "--json"}), 0) << err;
        return Json()["RynEditor"][nlohmann::ordered_json::json_pointer(pointer)];
    }

    /// One value on 1 January of each year from 1990 on.
    std::string WriteYearly(const std::string& name, const std::vector<double>& values) {
        test::Samples samples;
        for (std::size_t i = 0; i < values.size(); ++i)
            samples.push_back(
                {COleDateTime(1990 + static_cast<int>(i), 1, 1, 0, 0, 0), values[i], 0});
        const Status written = test::WriteDataFile(files.Path(name), samples);
        EXPECT_TRUE(written) << written.Text();
        return name;
    }

    test::TemporaryDirectory files;
    std::string out;
    std::string err;
};

} // namespace ryn::cli
