// new, validate, format, show: the commands on whole setups.
#include "Commands.h"
#include "Json.h"

#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "host/SetupDocument.h"
#include "paramfile/ParamFile.h"
#include "setupeditor/NavigationTree.h"

#include <cstdio>
#include <iostream>
#include <memory>
#include <string>
#include <vector>

namespace cli {
namespace {

const char* const kNewHelp =
    "usage: mudsetup new [--fractions N] [--layers N] [-o FILE]\n"
    "Writes a new setup with every default: N fractions (1 to 8, default 1) and\n"
    "N bed layers (1 to 12, default 1). Without -o the setup goes to standard output.\n";
const char* const kValidateHelp =
    "usage: mudsetup validate FILE [--json]\n"
    "Validates the setup and prints one line per message, \"PATH: message\".\n"
    "--json prints one JSON document of every message instead (docs/json.md).\n"
    "Exit status: 0 valid, 1 invalid, 2 unreadable or syntax error.\n"
    "Warnings on reading (content no node reads, values that cannot be used, counts\n"
    "that disagree) make the file invalid: exit 0 means the file holds what it says.\n";
const char* const kFormatHelp =
    "usage: mudsetup format FILE [-o FILE] [--force]\n"
    "Loads the setup and saves it again in the canonical form: in place, to the file\n"
    "given with -o, or to standard output with -o -.\n"
    "When saving would drop content that reading reported (unknown keywords or\n"
    "sections), nothing is written and the exit status is 1; --force writes anyway.\n";
const char* const kShowHelp =
    "usage: mudsetup show FILE [--json]\n"
    "Prints the module's navigation tree, one node a line, indented two spaces a level;\n"
    "nodes not used in the setup are marked \"(not used)\".\n"
    "--json prints one JSON document of the nodes instead (docs/json.md).\n";

// A file argument that is empty would name the current folder or, for -o, the input itself
// (an unset shell variable); it is a usage error, not a path.
const CLI::Validator kNotEmpty(
    [](std::string& value) { return value.empty() ? std::string("must not be empty") : std::string(); },
    "FILE");

void PrintWarnings(const std::vector<paramfile::Diagnostic>& warnings) {
    for (const paramfile::Diagnostic& w : warnings)
        std::cerr << "warning: " << w.ToString() << "\n";
}

// Opens a setup, reporting failure as the commands must; null on failure.
std::unique_ptr<CSetupDocument> OpenOrReport(const std::string& path, size_t* warnings = nullptr) {
    CSetupDocument::OpenResult opened = CSetupDocument::Open(path);
    if (opened.error) {
        // A file that cannot be read, or is no setup at all, has no place to point to.
        const paramfile::Diagnostic& e = *opened.error;
        std::cerr << (e.pos.line > 0 ? e.ToString() : "mudsetup: " + e.message) << "\n";
        return nullptr;
    }
    PrintWarnings(opened.warnings);
    if (warnings)
        *warnings = opened.warnings.size();
    return std::move(opened.document);
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

int New(int fractions, int layers, const std::string& output) {
    CSetupDocument doc;
    CParameterSelectionKiv* model = ModelDefinition(doc.Module());
    model->NumberOfFractions(fractions);
    model->NumberOfLayers(layers);
    return WriteOut(doc, output) ? kExitOk : kExitError;
}

int Validate(const std::string& file) {
    size_t warnings = 0;
    std::unique_ptr<CSetupDocument> doc = OpenOrReport(file, &warnings);
    if (!doc)
        return kExitError;
    const int ok = doc->ValidateAll();
    for (const CZoSEKivGlobalBase::ErrorEntry& e : doc->Errors())
        std::cout << NodePath(e.node) << ": " << e.Text() << "\n";
    if (!FlushStdout())
        return kExitError;
    return ok && doc->Errors().empty() && warnings == 0 ? kExitOk : kExitInvalid;
}

// --json: everything goes into one document on standard output, reading's warnings and a
// file that cannot be read included.
struct JsonOpen {
    std::unique_ptr<CSetupDocument> doc;
    std::vector<std::string> messages;
};

JsonOpen OpenForJson(const std::string& path) {
    CSetupDocument::OpenResult opened = CSetupDocument::Open(path);
    JsonOpen r;
    if (opened.error)
        r.messages.push_back(JsonMessage("error", *opened.error));
    for (const paramfile::Diagnostic& w : opened.warnings)
        r.messages.push_back(JsonMessage("warning", w));
    r.doc = std::move(opened.document);
    return r;
}

int ValidateJson(const std::string& file) {
    JsonOpen opened = OpenForJson(file);
    bool valid = false;
    if (opened.doc) {
        const size_t warnings = opened.messages.size();
        const int ok = opened.doc->ValidateAll();
        for (const CZoSEKivGlobalBase::ErrorEntry& e : opened.doc->Errors())
            opened.messages.push_back(JsonMessage("error", e.node, e.message));
        valid = ok && opened.doc->Errors().empty() && warnings == 0;
    }
    std::cout << "{\n  \"file\": " << JsonString(file) << ",\n  \"valid\": "
              << (valid ? "true" : "false") << ",\n  \"messages\": "
              << JsonArray(opened.messages, 2) << "\n}\n";
    if (!FlushStdout() || !opened.doc)
        return kExitError;
    return valid ? kExitOk : kExitInvalid;
}

int ShowJson(const std::string& file) {
    JsonOpen opened = OpenForJson(file);
    std::vector<std::string> nodes;
    if (opened.doc)
        WalkNavigationTree(opened.doc->Module(), 0, [&nodes](CZoSEKivBase* node, int depth) {
            nodes.push_back("{\"depth\": " + std::to_string(depth) + ", \"title\": " +
                            JsonString(node->GetTitle()) + ", \"path\": " +
                            JsonString(NodePath(node)) + ", \"used\": " +
                            (node->IsDlgUsedInSetup() ? "true" : "false") + "}");
        });
    std::cout << "{\n  \"file\": " << JsonString(file) << ",\n  \"messages\": "
              << JsonArray(opened.messages, 2) << ",\n  \"nodes\": " << JsonArray(nodes, 2)
              << "\n}\n";
    if (!FlushStdout() || !opened.doc)
        return kExitError;
    return kExitOk;
}

int Format(const std::string& file, const std::string& output, bool force) {
    std::unique_ptr<CSetupDocument> doc = OpenOrReport(file);
    if (!doc)
        return kExitError;
    const std::string target = output.empty() ? file : output;
    const size_t dropped = doc->DroppedOnSave().size();
    if (dropped > 0 && !force && target != "-") {
        std::cerr << "mudsetup: " << target << " not written: saving would drop "
                  << (dropped == 1 ? "the entry" : std::to_string(dropped) + " entries")
                  << " reported above; --force writes it anyway\n";
        return kExitInvalid;
    }
    return WriteOut(*doc, target) ? kExitOk : kExitError;
}

int Show(const std::string& file) {
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

// A count option whose refusal names its range, as the help text does.
CLI::Option* AddCount(CLI::App* cmd, const std::string& name, int& value, int lo, int hi) {
    const std::string message = "takes a number from " + std::to_string(lo) + " to " + std::to_string(hi);
    return cmd->add_option(name, value)->check(CLI::Validator(
        [lo, hi, message](std::string& text) {
            int n = 0;
            return CLI::detail::lexical_cast(text, n) && n >= lo && n <= hi ? std::string() : message;
        },
        "N"));
}

}  // namespace

void AddSetupCommands(CLI::App& app, int& status) {
    struct Options {
        int fractions = 1;
        int layers = 1;
        std::string file;
        std::string output;
        bool force = false;
        bool json = false;
    };
    auto opts = std::make_shared<Options>();

    CLI::App* cmdNew = AddCommand(app, "new", kNewHelp);
    AddCount(cmdNew, "--fractions", opts->fractions, 1, 8);
    AddCount(cmdNew, "--layers", opts->layers, 1, 12);
    cmdNew->add_option("-o", opts->output)->check(kNotEmpty);
    cmdNew->callback([opts, &status] {
        status = New(opts->fractions, opts->layers, opts->output.empty() ? "-" : opts->output);
    });

    CLI::App* cmdValidate = AddCommand(app, "validate", kValidateHelp);
    cmdValidate->add_option("FILE", opts->file)->required()->check(kNotEmpty);
    cmdValidate->add_flag("--json", opts->json);
    cmdValidate->callback([opts, &status] {
        status = opts->json ? ValidateJson(opts->file) : Validate(opts->file);
    });

    CLI::App* cmdFormat = AddCommand(app, "format", kFormatHelp);
    cmdFormat->add_option("FILE", opts->file)->required()->check(kNotEmpty);
    cmdFormat->add_option("-o", opts->output)->check(kNotEmpty);
    cmdFormat->add_flag("--force", opts->force);
    cmdFormat->callback([opts, &status] { status = Format(opts->file, opts->output, opts->force); });

    CLI::App* cmdShow = AddCommand(app, "show", kShowHelp);
    cmdShow->add_option("FILE", opts->file)->required()->check(kNotEmpty);
    cmdShow->add_flag("--json", opts->json);
    cmdShow->callback([opts, &status] {
        status = opts->json ? ShowJson(opts->file) : Show(opts->file);
    });
}

}  // namespace cli
