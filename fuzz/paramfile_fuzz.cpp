// Reads any input; whatever reads must write, read back and write again to the same text,
// and every kiv getter must cope with every value it finds.
#include "paramfile/Kiv.h"
#include "paramfile/ParamFile.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

using namespace paramfile;

namespace {

void Check(bool ok, const char* what, const std::string& detail) {
    if (ok)
        return;
    std::fprintf(stderr, "%s\n%s\n", what, detail.c_str());
    std::abort();
}

void ReadEverything(const Section& root) {
    std::vector<const Section*> todo{&root};
    while (!todo.empty()) {
        const Section* s = todo.back();
        todo.pop_back();
        void* h = const_cast<Section*>(s);
        for (int i = 0; i < s->EntryCount(); ++i) {
            if (s->EntryIsSection(i)) {
                todo.push_back(&s->SectionAt(i));
                Check(kivSectionByNameNum(h, std::string(s->SectionAt(i).Name()).c_str(), 1) !=
                          nullptr,
                      "section not found by name", std::string(s->SectionAt(i).Name()));
                continue;
            }
            const Keyword& k = s->KeywordAt(i);
            const std::string name(k.Name());
            int occurrence = 1;
            for (const Keyword* found; (found = s->FindKeyword(name, occurrence)) != &k;
                 ++occurrence)
                Check(found != nullptr, "keyword not found by name", name);
            void* kw = kivKeywordByNameNum(h, name.c_str(), occurrence);
            Check(kw == &k, "keyword not found by occurrence", name);
            for (int p = 0; p <= kivParamCount(kw) + 1; ++p) {
                int iv = 0;
                double dv = 0;
                float fv = 0;
                bool bv = false;
                std::string sv, fn;
                kivGetParam(h, name.c_str(), &iv, occurrence, p);
                kivGetParam(h, name.c_str(), &dv, occurrence, p);
                kivGetParam(h, name.c_str(), &fv, occurrence, p);
                kivGetParam(h, name.c_str(), &bv, occurrence, p);
                kivGetParam(h, name.c_str(), &sv, occurrence, p);
                kivGetParamFilename(h, name.c_str(), &fn, occurrence, p);
                void* param = kivParamByNum(kw, p);
                kivGetInt(param);
                kivGetDouble(param);
                kivGetResultFilename(param);
            }
            int iv = 0;
            double dv = 0;
            float fv = 0;
            bool bv = false;
            std::string sv, fn;
            kivGetListParam(h, name.c_str(), occurrence, "idfbsFi", &iv, &dv, &fv, &bv, &sv, &fn,
                            &iv);
            kivWarn(h, name.c_str(), "checked");
        }
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string input(reinterpret_cast<const char*>(data), size);
    ParseResult r = ParseText(input, "fuzz");
    Check(!r.document != !r.error, "a result needs a document or an error, not both", input);
    if (!r.document)
        return 0;

    const std::string first = WriteText(*r.document);
    ParseResult again = ParseText(first, "again");
    Check(again.document != nullptr, "the writer's output does not read",
          again.error ? again.error->ToString() + "\n" + first : first);
    const std::string second = WriteText(*again.document);
    Check(second == first, "writing is not idempotent", first + "\n----\n" + second);

    // A deep copy writes the same text as its original.
    Document copy;
    {
        Builder b(copy);
        for (int i = 0; i < r.document->Root().EntryCount(); ++i)
            b.CopySection(r.document->Root().SectionAt(i));
    }
    Check(WriteText(copy) == first, "a copied document writes differently", first);

    ReadEverything(r.document->Root());
    return 0;
}
