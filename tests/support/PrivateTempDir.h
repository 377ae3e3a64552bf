// Each test process gets a temporary folder of its own: ctest runs the tests in parallel
// processes, and many tests use fixed names under the temporary folder.
#pragma once

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <system_error>

namespace testsupport {

class PrivateTempDir {
public:
    // Points TMPDIR (read by std::filesystem and Qt alike), the settings folder and Qt's
    // runtime folder into a new folder under the one given (mode 0700, as the runtime folder
    // must be), which is removed again when the tests end.
    PrivateTempDir() {
        const char* base = std::getenv("TMPDIR");
        std::string pattern = std::string(base && *base ? base : "/tmp") + "/mudtests-XXXXXX";
        if (!mkdtemp(pattern.data())) {
            std::perror("mudtests: cannot make a temporary folder");
            std::exit(2);
        }
        m_path = pattern;
        setenv("TMPDIR", m_path.c_str(), 1);
        setenv("XDG_CONFIG_HOME", (m_path + "/config").c_str(), 1);
        setenv("XDG_RUNTIME_DIR", m_path.c_str(), 1);
    }
    ~PrivateTempDir() {
        std::error_code ignored;
        std::filesystem::remove_all(m_path, ignored);
    }
    PrivateTempDir(const PrivateTempDir&) = delete;
    PrivateTempDir& operator=(const PrivateTempDir&) = delete;

private:
    std::string m_path;
};

}  // namespace testsupport
