// Helpers shared by the waves tests: the sections of a document, and data files on disk.
#pragma once

#include "TestSupport.h"
#include "core/MudTransportModuleKiv.h"
#include "forcings/ForcingsWaveDBListKiv.h"
#include "forcings/ForcingsWavesKiv.h"
#include "forcings/MTWaveFieldKiv.h"
#include "host/ModuleSelection.h"
#include "hydro/HDWindForcingKiv.h"

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace forcingstest {

inline CForcingsWavesKiv* Waves(const CSetupDocument& doc) { return WavesSection(doc.Module()); }
inline CMTWaveFieldKiv* Field(const CSetupDocument& doc) { return Waves(doc)->WaveField(); }
inline CForcingsWaveDBListKiv* Database(const CSetupDocument& doc) {
    return Waves(doc)->WaveDatabase();
}

inline void SetWind(CSetupDocument& doc, bool include, int type) {
    doc.GetWind()->Include(include);
    doc.GetWind()->WindType(type);
}

// The header of a data file with the three wave items, covering the default period.
inline std::string WaveHeader(const std::string& kind, const std::string& layout,
                              const std::vector<long>& unitTypes = {100084, 100085, 100407}) {
    std::string text = kind + " 1\nstart 2000-01-01 00:00:00\nstep 3600\nsteps 2\n" + layout;
    text += "items " + std::to_string(unitTypes.size()) + "\n";
    for (size_t i = 0; i < unitTypes.size(); ++i)
        text += "item \"item " + std::to_string(i + 1) + "\" " + std::to_string(unitTypes[i]) + "\n";
    return text + "values\n";
}

// A folder of its own for each test, removed afterwards.
class DataFolder {
public:
    explicit DataFolder(const std::string& tag) {
        m_dir = std::filesystem::temp_directory_path() / ("mudsetup-waves-" + tag);
        std::filesystem::remove_all(m_dir);
        std::filesystem::create_directories(m_dir);
    }
    ~DataFolder() { std::filesystem::remove_all(m_dir); }
    // Writes a file and returns its absolute path.
    std::string Write(const std::string& name, const std::string& text) const {
        std::ofstream(m_dir / name, std::ios::binary) << text;
        return (m_dir / name).string();
    }
    std::string Path(const std::string& name) const { return (m_dir / name).string(); }

private:
    std::filesystem::path m_dir;
};

inline std::string TestName() {
    return ::testing::UnitTest::GetInstance()->current_test_info()->name();
}

}  // namespace forcingstest
