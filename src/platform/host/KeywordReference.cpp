#include "KeywordReference.h"

#include "SetupDocument.h"

namespace {

// An item of every list, and two layers for the transition between them, so that every
// kind of node stands in the tree.
constexpr const char* kSample = R"(DOMAIN {
    BOUNDARY_NAMES {
        ZoSEKivListItemCount = 1
    }
}
HYDRODYNAMIC_SOURCES {
    ZoSEKivListItemCount = 1
}
MUD_TRANSPORT_MODULE {
    MODEL_DEFINITION {
        number_of_fractions = 1
        number_of_layers = 2
    }
    FORCINGS {
        WAVES {
            WAVE_DATABASE {
                ZoSEKivListItemCount = 1
            }
        }
    }
    DREDGING {
        ZoSEKivListItemCount = 1
    }
    OUTPUTS {
        ZoSEKivListItemCount = 1
    }
}
)";

std::vector<KeywordEntry> BuildReference() {
    KeywordSink sink;
    CSetupDocument::OpenResult sample = CSetupDocument::FromText(kSample, "sample.setup");
    if (!sample.document)
        return {};
    POSITION pos = 0;
    for (CZoSEKivBase* c = sample.document->GetFirstChild(pos); c;
         c = sample.document->GetNextChild(pos))
        DescribeTree(c, "", sink);
    return sink.Entries();
}

}  // namespace

void DescribeTree(CZoSEKivBase* node, const std::string& outer, KeywordSink& sink) {
    const std::string name = node->GetSectionName();
    const std::string path = name.empty() ? outer : (outer.empty() ? name : outer + "/" + name);
    sink.Begin(path, outer);
    node->DescribeSize(sink);
    node->DescribeKeywords(sink);
    POSITION pos = 0;
    for (CZoSEKivBase* p = node->GetFirstProperty(pos); p; p = node->GetNextProperty(pos))
        DescribeTree(p, path, sink);
    pos = 0;
    for (CZoSEKivBase* c = node->GetFirstChild(pos); c; c = node->GetNextChild(pos))
        DescribeTree(c, path, sink);
}

const std::vector<KeywordEntry>& KeywordReference() {
    static const std::vector<KeywordEntry> reference = BuildReference();
    return reference;
}
