// mudsetup: create, validate, reformat and inspect setups and their data without a display.
#include "Commands.h"

#include <csignal>
#include <cstring>
#include <iostream>

namespace {

const char* const kUsage =
    "usage: mudsetup <command> [options]\n"
    "       mudsetup --version\n"
    "\n"
    "commands:\n"
    "  new [--fractions N] [--layers N] [-o FILE]   write a new setup with all defaults\n"
    "                                               (standard output without -o)\n"
    "  validate FILE                                one line per message: \"PATH: message\";\n"
    "                                               exit 0 valid, 1 invalid\n"
    "  format FILE [-o FILE] [--force]              load and save again in the canonical\n"
    "                                               form (in place without -o; -o - prints it;\n"
    "                                               --force even when content is dropped)\n"
    "  show FILE                                    the navigation tree, one node a line\n"
    "  datafile info FILE | new KIND ...            inspect or make a data file (.qrd0, .qrd1,\n"
    "                                               .qrd2, .qrdu, .kx0, .kx2, .xyz)\n"
    "  mesh info FILE                               a mesh's counts, extent and open\n"
    "                                               boundaries (.2dm, UGRID .nc)\n"
    "\n"
    "A file that cannot be read or has a syntax error exits 2 with FILE:LINE:COLUMN.\n"
    "Every command answers --help.\n";

}  // namespace

int main(int argc, char** argv) {
    // Past a file-size limit a write then fails, and the save cleans up and says so, rather
    // than the process dying silently.
    std::signal(SIGXFSZ, SIG_IGN);
    if (argc == 2 && !std::strcmp(argv[1], "--version")) {
        std::cout << "mudsetup " MUDSETUP_VERSION "\n";
        return cli::FlushStdout() ? cli::kExitOk : cli::kExitError;
    }
    int status = cli::kExitOk;
    CLI::App app(kUsage, "mudsetup");
    app.require_subcommand(1);
    cli::AddSetupCommands(app, status);
    cli::AddDatafileCommands(app, status);
    cli::AddMeshCommands(app, status);
    cli::AddCommand(app, "help", kUsage)->group("")->callback([] { std::cout << kUsage; });
    return cli::Run(app, argc, argv, status);
}
