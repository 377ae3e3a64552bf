// Reads any input; whatever reads must write, read back and write again to the same text
// (comments included), and every kiv getter must cope with every value it finds. The same bytes also drive the
// builder, and every value built must read back with the same bits.
#include "paramfile/Kiv.h"
#include "paramfile/ParamFile.h"

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <unordered_map>
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
        std::unordered_map<std::string, int> seen, seenSections;
        for (int i = 0; i < s->EntryCount(); ++i) {
            if (s->EntryIsSection(i)) {
                const Section& sub = s->SectionAt(i);
                const std::string name(sub.Name());
                todo.push_back(&sub);
                Check(kivSectionByNameNum(h, name.c_str(), ++seenSections[name]) == &sub,
                      "section not found by occurrence", name);
                continue;
            }
            const Keyword& k = s->KeywordAt(i);
            const std::string name(k.Name());
            // Counted as the entries pass, so that long sections of one name stay linear.
            const int occurrence = ++seen[name];
            Check(s->FindKeyword(name, occurrence) == &k, "keyword not found by name", name);
            void* kw = kivKeywordByNameNum(h, name.c_str(), occurrence);
            Check(kw == &k, "keyword not found by occurrence", name);
            // A value stands on its keyword's line, after it, and after the value before.
            for (int p = 0, column = k.Pos().column; p < k.ParamCount(); ++p) {
                const Position at = k.ParamPos(p);
                Check(at.line == k.Pos().line && at.column > column, "value out of place", name);
                column = at.column;
            }
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

// The input read as a script for the builder, so that values come from raw bits.
class Script {
public:
    Script(const std::uint8_t* data, std::size_t size) : p_(data), end_(data + size) {}
    template <class T> bool Take(T& out) {
        if (static_cast<std::size_t>(end_ - p_) < sizeof out)
            return false;
        std::memcpy(&out, p_, sizeof out);
        p_ += sizeof out;
        return true;
    }
    bool TakeText(std::string& out) {
        std::uint8_t n = 0;
        if (!Take(n) || static_cast<std::size_t>(end_ - p_) < n)
            return false;
        out.assign(reinterpret_cast<const char*>(p_), n);
        p_ += n;
        return true;
    }

private:
    const std::uint8_t* p_;
    const std::uint8_t* end_;
};

void Build(Builder& b, const std::uint8_t* data, std::size_t size) {
    static const char* const names[] = {"A", "b", "_c1", "Fraction", "x"};
    Script s(data, size);
    std::uint8_t op = 0;
    std::string text;
    while (s.Take(op)) {
        const char* name = names[(op / 10) % 5];
        switch (op % 10) {
        case 0:
            b.BeginSection(name);
            break;
        case 1:
            b.EndSection();
            break;
        case 2:
            b.AddKeyword(name);
            break;
        case 3:
            if (std::int32_t v; s.Take(v))
                b.AddInt(v);
            break;
        case 4:
            if (double v; s.Take(v))
                b.AddDouble(v);
            break;
        case 5:
            if (float v; s.Take(v))
                b.AddFloat(v);
            break;
        case 6:
            b.AddBool(op & 0x10);
            break;
        case 7:
            if (s.TakeText(text))
                b.AddString(text);
            break;
        case 8:
            if (s.TakeText(text))
                b.AddFileName(text);
            break;
        default:
            if (s.TakeText(text))
                b.BeginSection(text); // names the reader could not take get repaired
            break;
        }
    }
}

template <class T> bool SameBits(T a, T b) {
    return std::isnan(a) ? std::isnan(b) : std::memcmp(&a, &b, sizeof a) == 0;
}

bool SameParam(const Param& built, const Param& read) {
    std::string a, b;
    switch (built.Type()) {
    case ParamType::Integer:
    case ParamType::Boolean: {
        std::int32_t x = 0, y = 0;
        bool p = false, q = false;
        return read.Type() == built.Type() && built.AsInt(x) == read.AsInt(y) && x == y &&
               built.AsBool(p) == read.AsBool(q) && p == q;
    }
    case ParamType::Double: {
        double x = 0, y = 0;
        float fx = 0, fy = 0;
        return read.Type() == ParamType::Double && built.AsDouble(x) && read.AsDouble(y) &&
               SameBits(x, y) && built.AsFloat(fx) == read.AsFloat(fy) && SameBits(fx, fy);
    }
    case ParamType::Float: {
        float x = 0, y = 0;
        return read.Type() == ParamType::Double && built.AsFloat(x) && read.AsFloat(y) &&
               SameBits(x, y);
    }
    case ParamType::String:
    case ParamType::FileName: {
        built.AsString(a);
        read.AsString(b);
        // A file name holding a line break can only be written as a string.
        const ParamType want = a.find('\n') != std::string::npos ? ParamType::String : built.Type();
        return read.Type() == want && a == b;
    }
    }
    return false;
}

void CompareTrees(const Section& built, const Section& read, const std::string& text) {
    std::vector<std::pair<const Section*, const Section*>> todo{{&built, &read}};
    while (!todo.empty()) {
        const auto [a, b] = todo.back();
        todo.pop_back();
        Check(a->Name() == b->Name() && a->EntryCount() == b->EntryCount(),
              "sections differ after a round trip", text);
        for (int i = 0; i < a->EntryCount(); ++i) {
            Check(a->EntryIsSection(i) == b->EntryIsSection(i), "entries differ", text);
            if (a->EntryIsSection(i)) {
                todo.push_back({&a->SectionAt(i), &b->SectionAt(i)});
                continue;
            }
            const Keyword& ka = a->KeywordAt(i);
            const Keyword& kb = b->KeywordAt(i);
            Check(ka.Name() == kb.Name() && ka.ParamCount() == kb.ParamCount(),
                  "keywords differ after a round trip", text);
            for (int p = 0; p < ka.ParamCount(); ++p)
                Check(SameParam(ka.ParamAt(p), kb.ParamAt(p)), "a value changed in a round trip",
                      text);
        }
    }
}

void RoundTripBuilt(const std::uint8_t* data, std::size_t size) {
    Document doc;
    {
        Builder b(doc);
        Build(b, data, size);
    }
    const std::string text = WriteText(doc);
    const ParseResult r = ParseText(text, "built");
    Check(r.document != nullptr, "a built document does not read back",
          r.error ? r.error->ToString() + "\n" + text : text);
    CompareTrees(doc.Root(), r.document->Root(), text);
    Check(WriteText(*r.document) == text, "a built document writes differently", text);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    RoundTripBuilt(data, size);

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

    // Before any look-up nothing counts as read: each top-level section is reported once.
    Check(UnreadEntries(r.document->Root(), "").size() ==
              static_cast<std::size_t>(r.document->Root().EntryCount()),
          "unread entries miscounted", first);

    // A deep copy writes the same text as its original, comments and all.
    Document copy;
    {
        Builder b(copy);
        b.TakeCommentsFrom(*r.document);
        for (int i = 0; i < r.document->Root().EntryCount(); ++i)
            b.CopySection(r.document->Root().SectionAt(i));
    }
    Check(WriteText(copy) == first, "a copied document writes differently", first);

    ReadEverything(r.document->Root());
    // Every section, keyword and value has been read: nothing is left to report.
    Check(UnreadEntries(r.document->Root(), "").empty(), "read content reported as unread",
          first);
    return 0;
}
