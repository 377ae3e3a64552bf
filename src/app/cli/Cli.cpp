#include "Commands.h"

#include <cstdio>
#include <iostream>
#include <memory>

namespace cli {
namespace {

// Help is the command's own text: the hand-written usage lines read better than a generated
// option table, and scripts may rely on them.
class VerbatimFormatter : public CLI::Formatter {
public:
    std::string make_help(const CLI::App* app, std::string, CLI::AppFormatMode) const override {
        return app->get_description();
    }
};

// The command the user was running when parsing stopped: the deepest one selected.
const CLI::App* Innermost(const CLI::App* app) {
    for (;;) {
        std::vector<const CLI::App*> chosen;
        for (const CLI::App* sub : app->get_subcommands({}))
            if (sub->parsed())
                chosen.push_back(sub);
        if (chosen.empty())
            return app;
        app = chosen.front();
    }
}

bool Known(const CLI::App& app, const std::string& name) {
    for (const CLI::App* sub : app.get_subcommands({}))
        if (sub->check_name(name))
            return true;
    return false;
}

}  // namespace

CLI::App* AddCommand(CLI::App& parent, const std::string& name, const std::string& help) {
    CLI::App* sub = parent.add_subcommand(name, help);
    sub->formatter(std::make_shared<VerbatimFormatter>());
    return sub;
}

bool FlushStdout() {
    std::cout.flush();
    if (std::cout && std::fflush(stdout) == 0 && !std::ferror(stdout))
        return true;
    std::cerr << "mudsetup: cannot write to standard output\n";
    return false;
}

int Run(CLI::App& app, int argc, char** argv, const int& status) {
    app.formatter(std::make_shared<VerbatimFormatter>());
    if (argc > 1 && argv[1][0] != '-' && !Known(app, argv[1])) {
        std::cerr << "mudsetup: unknown command '" << argv[1] << "'\n" << app.help();
        return kExitError;
    }
    try {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp&) {
        std::cout << Innermost(&app)->help();
        return FlushStdout() ? kExitOk : kExitError;
    } catch (const CLI::ParseError& e) {
        std::cerr << "mudsetup: " << e.what() << "\n" << Innermost(&app)->help();
        return kExitError;
    }
    return status;
}

}  // namespace cli
