// mudsetup: create, validate, reformat and inspect setups without a display.
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "host/SetupDocument.h"
#include "paramfile/ParamFile.h"
#include "setupeditor/NavigationTree.h"

#include <charconv>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <string>
#include <vector>

namespace {

constexpr int kExitOk = 0;
constexpr int kExitInvalid = 1;
constexpr int kExitError = 2;

const char* const kUsage =
    "usage: mudsetup <command> [options]\n"
    "\n"
    "commands:\n"
    "  new [--fractions N] [--layers N] [-o FILE]   write a new setup with all defaults\n"
    "                                               (standard output without -o)\n"
    "  validate FILE                                one line per message: \"PATH: message\";\n"
    "                                               exit 0 valid, 1 invalid\n"
    "  format FILE [-o FILE]                        load and save again in the canonical\n"
    "                                               form (in place without -o; -o - prints it)\n"
    "  show FILE                                    the navigation tree, one node a line\n"
    "\n"
    "A file that cannot be read or has a syntax error exits 2 with FILE:LINE:COLUMN.\n"
    "Every command answers --help.\n";

const char* const kNewHelp =
    "usage: mudsetup new [--fractions N] [--layers N] [-o FILE]\n"
    "Writes a new setup with every default: N fractions (1 to 8, default 1) and\n"
    "N bed layers (1 to 12, default 1). Without -o the setup goes to standard output.\n";
const char* const kValidateHelp =
    "usage: mudsetup validate FILE\n"
    "Validates the setup and prints one line per message, \"PATH: message\".\n"
    "Exit status: 0 valid, 1 invalid, 2 unreadable or syntax error.\n";
const char* const kFormatHelp =
    "usage: mudsetup format FILE [-o FILE]\n"
    "Loads the setup and saves it again in the canonical form: in place, to the file\n"
    "given with -o, or to standard output with -o -.\n";
const char* const kShowHelp =
    "usage: mudsetup show FILE\n"
    "Prints the module's navigation tree, one node a line, indented two spaces a level;\n"
    "nodes not used in the setup are marked \"(not used)\".\n";

int UsageError(const std::string& message, const char* help) {
    std::cerr << "mudsetup: " << message << "\n" << help;
    return kExitError;
}

bool WantsHelp(const std::vector<std::string>& args) {
    for (const std::string& a : args)
        if (a == "--help" || a == "-h")
            return true;
    return false;
}

bool ParseInt(const std::string& text, int& out) {
    const char* end = text.data() + text.size();
    auto [ptr, ec] = std::from_chars(text.data(), end, out);
    return ec == std::errc() && ptr == end;
}

void PrintWarnings(const std::vector<paramfile::Diagnostic>& warnings) {
    for (const paramfile::Diagnostic& w : warnings)
        std::cerr << "warning: " << w.ToString() << "\n";
}

// Opens a setup, reporting failure as the commands must; null on failure.
std::unique_ptr<CSetupDocument> OpenOrReport(const std::string& path) {
    CSetupDocument::OpenResult opened = CSetupDocument::Open(path);
    if (opened.error) {
        std::cerr << opened.error->ToString() << "\n";
        return nullptr;
    }
    PrintWarnings(opened.warnings);
    return std::move(opened.document);
}

// False, with a message, when standard output could not take everything (a full disk).
bool FlushStdout() {
    std::cout.flush();
    if (std::cout && std::fflush(stdout) == 0 && !std::ferror(stdout))
        return true;
    std::cerr << "mudsetup: cannot write to standard output\n";
    return false;
}

bool WriteOut(CSetupDocument& doc, const std::string& output) {
    if (output == "-") {
        const std::string text = doc.ToText();
        std::fwrite(text.data(), 1, text.size(), stdout);
        return FlushStdout();
    }
    std::string error;
    if (!doc.SaveAs(output, &error)) {
        std::cerr << "mudsetup: " << error << "\n";
        return false;
    }
    return true;
}

int CmdNew(const std::vector<std::string>& args) {
    if (WantsHelp(args)) {
        std::cout << kNewHelp;
        return kExitOk;
    }
    int fractions = 1;
    int layers = 1;
    std::string output = "-";
    for (size_t i = 0; i < args.size(); ++i) {
        const std::string& a = args[i];
        const bool hasValue = i + 1 < args.size();
        if (a == "--fractions" && hasValue) {
            if (!ParseInt(args[++i], fractions) || fractions < 1 || fractions > 8)
                return UsageError("--fractions takes a number from 1 to 8", kNewHelp);
        } else if (a == "--layers" && hasValue) {
            if (!ParseInt(args[++i], layers) || layers < 1 || layers > 12)
                return UsageError("--layers takes a number from 1 to 12", kNewHelp);
        } else if (a == "-o" && hasValue) {
            output = args[++i];
        } else {
            return UsageError("unexpected argument '" + a + "'", kNewHelp);
        }
    }
    CSetupDocument doc;
    CParameterSelectionKiv* model = ModelDefinition(doc.Module());
    model->NumberOfFractions(fractions);
    model->NumberOfLayers(layers);
    return WriteOut(doc, output) ? kExitOk : kExitError;
}

// The one FILE argument of validate and show.
bool SingleFile(const std::vector<std::string>& args, std::string& file) {
    if (args.size() != 1 || args[0].empty() || args[0][0] == '-')
        return false;
    file = args[0];
    return true;
}

int CmdValidate(const std::vector<std::string>& args) {
    std::string file;
    if (WantsHelp(args)) {
        std::cout << kValidateHelp;
        return kExitOk;
    }
    if (!SingleFile(args, file))
        return UsageError("validate takes one FILE", kValidateHelp);
    std::unique_ptr<CSetupDocument> doc = OpenOrReport(file);
    if (!doc)
        return kExitError;
    const int ok = doc->ValidateAll();
    for (const CZoSEKivGlobalBase::ErrorEntry& e : doc->Errors())
        std::cout << NodePath(e.node) << ": " << e.message << "\n";
    if (!FlushStdout())
        return kExitError;
    return ok && doc->Errors().empty() ? kExitOk : kExitInvalid;
}

int CmdFormat(const std::vector<std::string>& args) {
    if (WantsHelp(args)) {
        std::cout << kFormatHelp;
        return kExitOk;
    }
    std::string file;
    std::string output;
    for (size_t i = 0; i < args.size(); ++i) {
        if (args[i] == "-o" && i + 1 < args.size())
            output = args[++i];
        else if (file.empty() && !args[i].empty() && (args[i][0] != '-'))
            file = args[i];
        else
            return UsageError("unexpected argument '" + args[i] + "'", kFormatHelp);
    }
    if (file.empty())
        return UsageError("format takes a FILE", kFormatHelp);
    std::unique_ptr<CSetupDocument> doc = OpenOrReport(file);
    if (!doc)
        return kExitError;
    return WriteOut(*doc, output.empty() ? file : output) ? kExitOk : kExitError;
}

int CmdShow(const std::vector<std::string>& args) {
    if (WantsHelp(args)) {
        std::cout << kShowHelp;
        return kExitOk;
    }
    std::string file;
    if (!SingleFile(args, file))
        return UsageError("show takes one FILE", kShowHelp);
    std::unique_ptr<CSetupDocument> doc = OpenOrReport(file);
    if (!doc)
        return kExitError;
    WalkNavigationTree(doc->Module(), 0, [](CZoSEKivBase* node, int depth) {
        std::cout << std::string(static_cast<size_t>(depth) * 2, ' ') << node->GetTitle();
        if (!node->IsDlgUsedInSetup())
            std::cout << " (not used)";
        std::cout << "\n";
    });
    return FlushStdout() ? kExitOk : kExitError;
}

}  // namespace

int main(int argc, char** argv) {
    std::vector<std::string> args(argv + 1, argv + argc);
    if (args.empty()) {
        std::cerr << kUsage;
        return kExitError;
    }
    const std::string command = args.front();
    args.erase(args.begin());
    if (command == "--help" || command == "-h" || command == "help") {
        std::cout << kUsage;
        return kExitOk;
    }
    if (command == "new")
        return CmdNew(args);
    if (command == "validate")
        return CmdValidate(args);
    if (command == "format")
        return CmdFormat(args);
    if (command == "show")
        return CmdShow(args);
    std::cerr << "mudsetup: unknown command '" << command << "'\n" << kUsage;
    return kExitError;
}
