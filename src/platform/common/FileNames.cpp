#include "FileNames.h"

#include <algorithm>
#include <cctype>
#include <filesystem>

namespace fs = std::filesystem;

namespace {

std::string_view Trimmed(std::string_view s) {
    const auto b = s.find_first_not_of(" \t\r\n");
    if (b == std::string_view::npos)
        return {};
    return s.substr(b, s.find_last_not_of(" \t\r\n") - b + 1);
}

// The first folder below the root, empty for the root itself.
fs::path TopFolder(const fs::path& p) {
    auto it = p.begin();
    if (it != p.end() && p.has_root_directory())
        ++it;
    return it == p.end() ? fs::path() : *it;
}

}  // namespace

bool IsAbsoluteFileName(std::string_view name) {
    name = Trimmed(name);
    if (name.empty())
        return false;
    if (name[0] == '/' || name[0] == '\\')
        return true;
    // A drive letter: no folder here leads there.
    return name.size() >= 2 && std::isalpha(static_cast<unsigned char>(name[0])) && name[1] == ':';
}

std::string RebasedFileName(std::string_view name, const std::string& fromFolder,
                            const std::string& toFolder) {
    const std::string_view trimmed = Trimmed(name);
    if (trimmed.empty() || IsAbsoluteFileName(trimmed))
        return std::string(name);
    const fs::path from = fs::path(fromFolder).lexically_normal();
    const fs::path to = fs::path(toFolder).lexically_normal();
    if (from == to)
        return std::string(name);
    std::string slashed(trimmed);
    std::replace(slashed.begin(), slashed.end(), '\\', '/');
    const fs::path file = (from / slashed).lexically_normal();
    if (TopFolder(file) != TopFolder(to))
        return file.string();
    const fs::path relative = file.lexically_relative(to);
    if (relative.empty())
        return file.string();
    std::string out = relative.string();
    const bool backslashes = trimmed.find('\\') != std::string_view::npos &&
                             trimmed.find('/') == std::string_view::npos;
    if (backslashes)
        std::replace(out.begin(), out.end(), '/', '\\');
    return out;
}
