// Setups and data files shared by the dredging tests.
#pragma once

#include "TestSupport.h"
#include "core/MudTransportModuleKiv.h"
#include "dredging/MTDredgingFile.h"
#include "dredging/MTDredgingKiv.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

namespace dredgingtest {

inline CMTDredgingKiv* Dredging(CSetupDocument& doc) {
    return GetImportant<CMTDredgingKiv>(doc.Module(), "MTDredgings");
}

// A setup of the given number of fractions whose DREDGING section holds body.
inline std::string DredgingSetup(int fractions, std::string_view body) {
    return "MUD_TRANSPORT_MODULE {\n    MODEL_DEFINITION {\n        number_of_fractions = " +
           std::to_string(fractions) + "\n    }\n    DREDGING {\n" + std::string(body) +
           "\n    }\n}\n";
}

// The header of a dredger's time series: x, y, rate and spill with the given unit types,
// hourly over a day from 2024-01-01 (values are not read by the check).
inline std::string Series(long xy = 100183, long rate = 100195, long spill = 100013,
                          const char* kind = "qrd0") {
    return std::string(kind) + " 1\nstart 2024-01-01 00:00:00\nstep 3600\nsteps 25\nitems 4\n" +
           "item \"x\" " + std::to_string(xy) + "\nitem \"y\" " + std::to_string(xy) +
           "\nitem \"rate\" " + std::to_string(rate) + "\nitem \"spill\" " +
           std::to_string(spill) + "\nvalues\n";
}

// A folder of its own per test, removed afterwards.
class TempDir {
public:
    TempDir() {
        path_ = std::filesystem::temp_directory_path() /
                ("mudsetup-dredging-" +
                 std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        std::filesystem::remove_all(path_);
        std::filesystem::create_directories(path_);
    }
    ~TempDir() { std::filesystem::remove_all(path_); }
    TempDir(const TempDir&) = delete;
    TempDir& operator=(const TempDir&) = delete;
    std::string Write(const std::string& name, const std::string& text) const {
        std::ofstream(path_ / name, std::ios::binary) << text;
        return (path_ / name).string();
    }
    std::string Path(const std::string& name) const { return (path_ / name).string(); }

private:
    std::filesystem::path path_;
};

}  // namespace dredgingtest
