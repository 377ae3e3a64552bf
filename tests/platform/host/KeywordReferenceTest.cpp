// The keyword reference against what setups really write: every keyword written is
// declared with its type, and every declared keyword is written by some setup.
#include "TestSupport.h"

#include "host/KeywordReference.h"

#include <map>
#include <set>

namespace {

// Setups that between them populate every section: outputs of each kind, dredgers,
// sources, boundaries, wave-database points, data-input values of each format.
const char* const kPopulated[] = {
    MUD_SOURCE_DIR "/examples/estuary.setup",
    MUD_SOURCE_DIR "/fuzz/corpus-setup/outputs.setup",
    MUD_SOURCE_DIR "/fuzz/corpus-setup/dredging.setup",
    MUD_SOURCE_DIR "/fuzz/corpus-setup/conditions.setup",
    MUD_SOURCE_DIR "/fuzz/corpus-setup/waves-database.setup",
};

bool TypeFits(KeywordType declared, const paramfile::Keyword& k) {
    using P = paramfile::ParamType;
    for (int i = 0; i < k.ParamCount(); ++i) {
        const P t = k.ParamAt(i).Type();
        bool fits = false;
        switch (declared) {
        case KeywordType::Int:
        case KeywordType::Flag:
        case KeywordType::IntList: fits = t == P::Integer; break;
        case KeywordType::Double:
        case KeywordType::DoubleList: fits = t == P::Double; break;
        case KeywordType::Float: fits = t == P::Float || t == P::Double; break;
        case KeywordType::Bool: fits = t == P::Boolean; break;
        case KeywordType::String: fits = t == P::String; break;
        case KeywordType::FileName:
        case KeywordType::ResultFileName: fits = t == P::FileName; break;
        case KeywordType::Values: fits = true; break;
        }
        if (!fits)
            return false;
    }
    const bool list = declared == KeywordType::IntList || declared == KeywordType::DoubleList ||
                      declared == KeywordType::Values;
    return list || k.ParamCount() == 1;
}

// Every keyword of the sections the document owns, by its path pattern.
void Collect(const paramfile::Section& s, const std::string& path,
             std::map<std::string, const paramfile::Keyword*>& out) {
    for (int i = 0; i < s.EntryCount(); ++i) {
        if (s.EntryIsSection(i)) {
            const paramfile::Section& sub = s.SectionAt(i);
            const std::string name(sub.Name());
            Collect(sub, path.empty() ? name : path + "/" + name, out);
        } else {
            const paramfile::Keyword& k = s.KeywordAt(i);
            out.emplace(KeywordPathPattern(path + "/" + std::string(k.Name())), &k);
        }
    }
}

}  // namespace

TEST(KeywordReference, EveryKeywordWrittenIsDeclaredAndEveryDeclaredOneIsWritten) {
    std::map<std::string, const KeywordEntry*> declared;
    for (const KeywordEntry& e : KeywordReference())
        EXPECT_TRUE(declared.emplace(e.FullPath(), &e).second) << "declared twice: " << e.FullPath();

    std::set<std::string> written;
    for (const char* file : kPopulated) {
        CSetupDocument::OpenResult r = CSetupDocument::Open(file);
        ASSERT_TRUE(r.document) << file;
        paramfile::ParseResult saved = paramfile::ParseText(r.document->ToText(), file);
        ASSERT_TRUE(saved.document) << file;
        std::map<std::string, const paramfile::Keyword*> keywords;
        Collect(saved.document->Root(), "", keywords);
        for (const auto& [path, keyword] : keywords) {
            if (path.rfind("FOREIGN/", 0) == 0)
                continue;  // another module's section, kept as read
            written.insert(path);
            auto d = declared.find(path);
            if (d == declared.end()) {
                ADD_FAILURE() << "written but not declared: " << path << " (" << file << ")";
                continue;
            }
            EXPECT_TRUE(TypeFits(d->second->type, *keyword))
                << path << " is declared " << KeywordTypeName(d->second->type) << " (" << file
                << ")";
        }
    }
    for (const auto& [path, entry] : declared)
        EXPECT_TRUE(written.count(path)) << "declared but written by no setup: " << path;
}

TEST(KeywordReference, DeclarationsSayWhatTheyAre) {
    for (const KeywordEntry& e : KeywordReference()) {
        EXPECT_FALSE(e.description.empty()) << e.FullPath();
        if (e.unitType) {
            EXPECT_FALSE(e.UnitText().empty()) << e.FullPath() << ": unknown unit type "
                                               << e.unitType;
        }
    }
}

TEST(KeywordReference, NumbersInSectionNamesBecomePatterns) {
    const std::pair<const char*, const char*> cases[] = {
        {"MUD_TRANSPORT_MODULE/DREDGING/DREDGER_12", "MUD_TRANSPORT_MODULE/DREDGING/DREDGER_%d"},
        {"A/Data_Base_Item_1_2_3/file_name", "A/Data_Base_Item_%d_%d_%d/file_name"},
        {"BED/BED_DISTRIBUTION_LAYER_2/BED_DISTRIBUTION_FRACTION_1",
         "BED/BED_DISTRIBUTION_LAYER_%d/BED_DISTRIBUTION_FRACTION_%d"},
        {"SPACE/number_of_2D_mesh", "SPACE/number_of_2D_mesh"},
        {"X/PARAMETERS_2D", "X/PARAMETERS_2D"},
    };
    for (const auto& [path, pattern] : cases)
        EXPECT_EQ(KeywordPathPattern(path), pattern);
}
