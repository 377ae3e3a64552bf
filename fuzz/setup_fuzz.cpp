// Any text as a setup: it loads or is refused, never crashes; what is saved loads again to
// the same setup, so a second save writes the same text, and every entry saved is read.
#include "host/SetupDocument.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::string text(reinterpret_cast<const char*>(data), size);
    CSetupDocument::OpenResult first = CSetupDocument::FromText(std::move(text), "fuzz.setup");
    if (!first.document)
        return 0;
    first.document->ValidateAll();
    const std::string saved = first.document->ToText();
    CSetupDocument::OpenResult second = CSetupDocument::FromText(saved, "saved.setup");
    if (!second.document) {
        std::fprintf(stderr, "a saved setup does not load: %s\n", second.error->ToString().c_str());
        std::abort();
    }
    if (!second.document->DroppedOnSave().empty()) {
        std::fprintf(stderr, "a saved setup holds what it does not read: %s\n",
                     second.document->DroppedOnSave().front().ToString().c_str());
        std::abort();
    }
    if (second.document->ToText() != saved) {
        std::fprintf(stderr, "saving a saved setup changed it\n");
        std::abort();
    }
    return 0;
}
