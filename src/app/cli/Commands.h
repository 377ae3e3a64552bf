// The command groups of mudsetup. Each group adds its subcommands to the app; the one that
// runs stores its exit status, so main only parses and returns it.
#pragma once

#include <CLI/CLI.hpp>

#include <string>

namespace cli {

constexpr int kExitOk = 0;
constexpr int kExitInvalid = 1;
constexpr int kExitError = 2;

// new, validate, format, show.
void AddSetupCommands(CLI::App& app, int& status);
// datafile info, datafile new.
void AddDatafileCommands(CLI::App& app, int& status);
// mesh info.
void AddMeshCommands(CLI::App& app, int& status);
// keywords.
void AddKeywordCommands(CLI::App& app, int& status);

// A subcommand whose help is the hand-written text, printed as it stands by --help and
// after a usage error.
CLI::App* AddCommand(CLI::App& parent, const std::string& name, const std::string& help);

// False, with a message, when standard output could not take everything (a full disk).
bool FlushStdout();

// Parses argv and runs the chosen command; usage errors exit 2 with the command's help.
int Run(CLI::App& app, int argc, char** argv, const int& status);

}  // namespace cli
