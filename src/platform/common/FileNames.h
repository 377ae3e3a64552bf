// File names as a setup stores them: relative to the setup's folder or absolute, with '/' or
// (as written on Windows) '\' between folders.
#pragma once

#include <string>
#include <string_view>

// Absolute on this system, or a Windows name that no folder can make relative ("C:\x",
// "\\server\share\x", "\x").
bool IsAbsoluteFileName(std::string_view name);

// The name that stands, from the folder toFolder, for the file that name stands for from the
// folder fromFolder (both absolute). Absolute names and empty ones stay as they are. A file
// that shares no folder with toFolder but the root is named absolutely; otherwise the new name
// is relative, climbing with ".." where it must, and keeps '\' as its separator when the old
// name had only that one.
std::string RebasedFileName(std::string_view name, const std::string& fromFolder,
                            const std::string& toFolder);
