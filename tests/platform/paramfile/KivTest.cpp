#include "paramfile/Kiv.h"
#include "paramfile/ParamFile.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <string>
#include <vector>

using namespace paramfile;

namespace {

std::unique_ptr<Document> Parse(const std::string& text) {
    ParseResult r = ParseText(text, "mud.par");
    EXPECT_FALSE(r.error) << r.error->ToString();
    return std::move(r.document);
}

void* Handle(const Section& s) {
    return const_cast<Section*>(&s);
}

void* Sec(const Document& doc, const char* name) {
    return kivSectionByNameNum(Handle(doc.Root()), name, 1);
}

TEST(Kiv, WrittenValuesReadBack) {
    Document doc;
    Builder b(doc);
    void* h = &b;
    kivAddSection(h, "MUD");
    kivPutParam(h, "fractions", 3);
    kivPutParam(h, "density", 2650.5);
    kivPutParam(h, "ratio", 0.1f);
    kivPutParam(h, "enabled", true);
    kivPutParam(h, "title", "estuary"); // a literal must not become a boolean
    kivPutParam(h, "note", std::string("a \"quoted\" note"));
    kivPutParamFilename(h, "bed", "C:\\data\\bed.qrdu");
    kivAddKeyword(h, "list");
    kivAddInt(h, -4);
    kivAddDouble(h, 1e-9);
    kivAddFloat(h, 2.5f);
    kivAddString(h, "s");
    kivAddFilename(h, "in.qrd0");
    kivAddResultFilename(h, "out.qrd0");
    kivPutListParam(h, "mixed", "idfbsF", 7, 0.25, 0.1, 1, "txt", "f'q.txt");
    kivAddSection(h, "Fraction");
    kivPutParam(h, "d50", 1);
    kivEndSection(h);
    kivAddSection(h, "Fraction");
    kivPutParam(h, "d50", 2);
    kivEndSection(h);
    kivEndSection(h);

    const ParseResult r = ParseText(WriteText(doc), "again.par");
    ASSERT_FALSE(r.error) << r.error->ToString();
    void* mud = Sec(*r.document, "MUD");
    ASSERT_NE(mud, nullptr);

    int n = 0;
    double d = 0;
    float f = 0;
    bool flag = false;
    std::string s;
    kivGetParam(mud, "fractions", &n, 1, 1);
    EXPECT_EQ(n, 3);
    kivGetParam(mud, "density", &d, 1, 1);
    EXPECT_EQ(d, 2650.5);
    kivGetParam(mud, "ratio", &f, 1, 1);
    EXPECT_EQ(f, 0.1f);
    kivGetParam(mud, "enabled", &flag, 1, 1);
    EXPECT_TRUE(flag);
    kivGetParam(mud, "title", &s, 1, 1);
    EXPECT_EQ(s, "estuary");
    kivGetParam(mud, "note", &s, 1, 1);
    EXPECT_EQ(s, "a \"quoted\" note");
    kivGetParamFilename(mud, "bed", &s, 1, 1);
    EXPECT_EQ(s, "C:\\data\\bed.qrdu");

    void* list = kivKeywordByNameNum(mud, "list", 1);
    ASSERT_EQ(kivParamCount(list), 6);
    EXPECT_EQ(kivGetInt(kivParamByNum(list, 1)), -4);
    EXPECT_EQ(kivGetDouble(kivParamByNum(list, 2)), 1e-9);
    EXPECT_EQ(kivGetDouble(kivParamByNum(list, 1)), -4.0);
    EXPECT_EQ(kivGetInt(kivParamByNum(list, 2)), 0);    // not an integer
    EXPECT_EQ(kivGetDouble(kivParamByNum(list, 4)), 0); // not a number
    EXPECT_EQ(kivGetResultFilename(kivParamByNum(list, 6)), "out.qrd0");
    EXPECT_EQ(kivParamByNum(list, 7), nullptr);
    EXPECT_EQ(kivParamByNum(list, 0), nullptr);

    int i = 0;
    double dd = 0;
    float ff = 0;
    bool bb = false;
    std::string ss, fn;
    kivGetListParam(mud, "mixed", 1, "idfbsF", &i, &dd, &ff, &bb, &ss, &fn);
    EXPECT_EQ(i, 7);
    EXPECT_EQ(dd, 0.25);
    EXPECT_EQ(ff, 0.1f);
    EXPECT_TRUE(bb);
    EXPECT_EQ(ss, "txt");
    EXPECT_EQ(fn, "f'q.txt");
    EXPECT_TRUE(r.document->Warnings().empty());
}

TEST(Kiv, OccurrenceAndIndexSelectTheValue) {
    auto doc =
        Parse("S {\n  k = 1, 2\n  Sub {\n    k = 9\n  }\n  k = 3, 4\n  Sub {\n    k = 8\n  }\n}\n");
    void* s = Sec(*doc, "S");
    int v = 0;
    kivGetParam(s, "k", &v, 2, 2);
    EXPECT_EQ(v, 4);
    kivGetParam(s, "k", &v, 1, 2);
    EXPECT_EQ(v, 2);
    void* sub = kivSectionByNameNum(s, "Sub", 2);
    kivGetParam(sub, "k", &v, 1, 1);
    EXPECT_EQ(v, 8);
    EXPECT_EQ(kivSectionByNameNum(s, "Sub", 3), nullptr);
    EXPECT_EQ(kivKeywordByNameNum(s, "k", 3), nullptr);
    EXPECT_EQ(kivParamCount(kivKeywordByNameNum(s, "k", 2)), 2);
}

TEST(Kiv, MissingValuesLeaveTargetsSilently) {
    auto doc = Parse("S {\n  k = 1\n}\n");
    void* s = Sec(*doc, "S");
    int v = 77;
    kivGetParam(nullptr, "k", &v, 1, 1);
    kivGetParam(s, "absent", &v, 1, 1);
    kivGetParam(s, "k", &v, 2, 1);
    kivGetParam(s, "k", &v, 1, 2);
    kivGetParam(s, "k", &v, 1, 0);
    kivGetParam(kivSectionByNameNum(s, "None", 1), "k", &v, 1, 1);
    EXPECT_EQ(v, 77);
    std::string str = "kept";
    int i = 5;
    kivGetListParam(s, "k", 1, "is", &i, &str);
    EXPECT_EQ(i, 1);
    EXPECT_EQ(str, "kept");
    EXPECT_EQ(kivParamCount(nullptr), 0);
    EXPECT_EQ(kivGetInt(nullptr), 0);
    EXPECT_TRUE(doc->Warnings().empty());
}

TEST(Kiv, WrongTypesLeaveTargetsAndWarnAtTheKeyword) {
    auto doc = Parse("MUD {\n"
                     "  number_of_fractions = \"three\"\n"
                     "  x = 2000000000000\n"
                     "  y = 1e300, 16777217\n"
                     "  flag = 2\n"
                     "  name = 4.5\n"
                     "    path = true\n"
                     "  pair = 1, \"b\"\n"
                     "}\n");
    void* mud = Sec(*doc, "MUD");
    int n = -1;
    kivGetParam(mud, "number_of_fractions", &n, 1, 1);
    kivGetParam(mud, "x", &n, 1, 1);
    EXPECT_EQ(n, -1);
    float f = -1;
    kivGetParam(mud, "y", &f, 1, 1);
    kivGetParam(mud, "y", &f, 1, 2);
    EXPECT_EQ(f, -1);
    bool b = false;
    kivGetParam(mud, "flag", &b, 1, 1);
    EXPECT_FALSE(b);
    std::string s = "kept";
    kivGetParam(mud, "name", &s, 1, 1);
    kivGetParamFilename(mud, "path", &s, 1, 1);
    EXPECT_EQ(s, "kept");
    double d = -1;
    kivGetListParam(mud, "pair", 1, "id", &n, &d);
    EXPECT_EQ(n, 1);
    EXPECT_EQ(d, -1);

    std::vector<std::string> got;
    for (const Diagnostic& w : doc->Warnings())
        got.push_back(w.ToString());
    const std::vector<std::string> want = {
        "mud.par:2:3: 'number_of_fractions' expects an integer, found a string",
        "mud.par:3:3: 'x' value 2000000000000 is out of range for an integer",
        "mud.par:4:3: 'y' value 1e+300 is out of range for a float",
        "mud.par:4:3: 'y' value 16777217 cannot be held exactly by a float",
        "mud.par:5:3: 'flag' expects a boolean, found an integer",
        "mud.par:6:3: 'name' expects a string, found a real number",
        "mud.par:7:5: 'path' expects a file name, found a boolean",
        "mud.par:8:3: 'pair' value 2 expects a number, found a string",
    };
    EXPECT_EQ(got, want);
}

// What a reader took of a keyword decides what is reported: the values past the last one
// read, at the first of them, as content that saving drops.
TEST(Kiv, ValuesPastTheLastOneReadAreReportedAtTheFirstOfThem) {
    struct Case {
        const char* line;              // the keyword's line in section A
        void (*read)(void* a);         // how the section's reader takes it
        const char* report;            // UnreadEntries' one message, or "" for none
    };
    const Case cases[] = {
        {"n = 3, 4", [](void* a) { int v = 0; kivGetParam(a, "n", &v, 1, 1); },
         "mud.par:2:12: 'n' in A holds 2 values where 1 is read: value 2 is not read, dropped "
         "on saving"},
        {"e = 1.0, 2, 3", [](void* a) { double v = 0; kivGetParam(a, "e", &v, 1, 1); },
         "mud.par:2:14: 'e' in A holds 3 values where 1 is read: values 2 to 3 are not read, "
         "dropped on saving"},
        // A byte flipped into a comma splits a coordinate.
        {"x = 497500.0,005", [](void* a) { double v = 0; kivGetParam(a, "x", &v, 1, 1); },
         "mud.par:2:18: 'x' in A holds 2 values"},
        {"s = \"a, b\", 'c'", [](void* a) { std::string v; kivGetParam(a, "s", &v, 1, 1); },
         "mud.par:2:17: 's' in A holds 2 values"},
        {"f = 'a.qrd0', 'b'", [](void* a) { std::string v; kivGetParamFilename(a, "f", &v, 1, 1); },
         "mud.par:2:19: 'f' in A holds 2 values"},
        {"w = 1.0, 2.0, 3.0",
         [](void* a) {
             void* k = kivKeywordByNameNum(a, "w", 1);
             kivGetDouble(kivParamByNum(k, 1));
             kivGetDouble(kivParamByNum(k, 2));
         },
         "mud.par:2:19: 'w' in A holds 3 values where 2 are read: value 3 is not read"},
        {"items = 1, 2, 3, 4, 5",
         [](void* a) { int v[4] = {}; kivGetListParam(a, "items", 1, "iiii", &v[0], &v[1], &v[2], &v[3]); },
         "mud.par:2:25: 'items' in A holds 5 values where 4 are read"},
        // Read whole, by value or by a list longer than the values.
        {"p = 1, 2", [](void* a) { int v = 0; kivGetParam(a, "p", &v, 1, 2); kivGetParam(a, "p", &v, 1, 1); }, ""},
        {"q = 1", [](void* a) { int v[3] = {}; kivGetListParam(a, "q", 1, "iii", &v[0], &v[1], &v[2]); }, ""},
        // Looked at but no value taken: the reader only asked whether it is there.
        {"flag = 1, 2", [](void* a) { kivParamCount(kivKeywordByNameNum(a, "flag", 1)); }, ""},
        {"none =", [](void* a) { int v = 0; kivGetParam(a, "none", &v, 1, 1); }, ""},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.line);
        auto doc = Parse(std::string("A {\n    ") + c.line + "\n}\n");
        void* a = Sec(*doc, "A");
        c.read(a);
        std::vector<std::string> got;
        for (const Diagnostic& d : UnreadEntries(*static_cast<const Section*>(a), "A"))
            got.push_back(d.ToString());
        if (*c.report) {
            ASSERT_EQ(got.size(), 1u);
            EXPECT_EQ(got[0].rfind(c.report, 0), 0u) << got[0];
        } else {
            EXPECT_EQ(got, std::vector<std::string>{});
        }
    }
}

TEST(Kiv, ValuesFarAlongALineAndCopiedValuesKeepTheirPlace) {
    // Past the 16 bits a value's column is kept aside.
    const std::string wide(70000, 'w');
    auto doc = Parse("A {\n    s = \"" + wide + "\", 1, 2\n}\n");
    void* a = Sec(*doc, "A");
    std::string v;
    kivGetParam(a, "s", &v, 1, 1);
    const std::vector<Diagnostic> unread = UnreadEntries(*static_cast<const Section*>(a), "A");
    ASSERT_EQ(unread.size(), 1u);
    EXPECT_EQ(unread[0].pos.line, 2);
    EXPECT_EQ(unread[0].pos.column, 70013);
    // A copy is built, not read: its values stand where the keyword does.
    Document copy;
    Builder(copy).CopySection(*static_cast<const Section*>(a));
    const Keyword& k = copy.Root().SectionAt(0).KeywordAt(0);
    EXPECT_EQ(k.ParamPos(2).column, 0);
    EXPECT_EQ(doc->Root().SectionAt(0).KeywordAt(0).ParamPos(2).column, 70016);
}

// A keyword without values where one is read keeps the target's value, and says so.
TEST(Kiv, AKeywordWithoutAValueIsReportedWithWhatWasKept) {
    auto doc = Parse("A {\n    i =\n    d =\n    b =\n    s =\n    f =\n    l =\n    k =\n}\n");
    void* a = Sec(*doc, "A");
    int i = 7;
    double d = 0.25;
    bool b = true;
    std::string s = "x", f = "a.qrd0";
    kivGetParam(a, "i", &i, 1, 1);
    kivGetParam(a, "d", &d, 1, 2);
    kivGetParam(a, "b", &b, 1, 1);
    kivGetParam(a, "s", &s, 1, 1);
    kivGetParamFilename(a, "f", &f, 1, 1);
    // Lists and counted reads ask for the count first: their readers speak for themselves.
    kivGetListParam(a, "l", 1, "i", &i);
    EXPECT_EQ(kivParamByNum(kivKeywordByNameNum(a, "k", 1), 1), nullptr);
    kivGetParam(a, "absent", &i, 1, 1);
    EXPECT_EQ(i, 7);
    EXPECT_EQ(s, "x");
    std::vector<std::string> got;
    for (const Diagnostic& w : doc->Warnings())
        got.push_back(w.ToString());
    EXPECT_EQ(got, (std::vector<std::string>{
                       "mud.par:2:5: 'i' has no value; kept 7",
                       "mud.par:3:5: 'd' has no value; kept 0.25",
                       "mud.par:4:5: 'b' has no value; kept true",
                       "mud.par:5:5: 's' has no value; kept \"x\"",
                       "mud.par:6:5: 'f' has no value; kept 'a.qrd0'",
                   }));
}

TEST(Kiv, WarnPointsAtKeywordOrSection) {
    auto doc = Parse("\nS {\n  k = 1\n}\n");
    void* s = Sec(*doc, "S");
    kivWarn(s, "k", "check k");
    kivWarn(s, "absent", "check section");
    kivWarn(s, nullptr, "also section");
    kivWarn(nullptr, "k", "dropped");
    kivWarn(Handle(doc->Root().SectionAt(5)), "k", "dropped");
    ASSERT_EQ(doc->Warnings().size(), 3u);
    EXPECT_EQ(doc->Warnings()[0].ToString(), "mud.par:3:3: check k");
    EXPECT_EQ(doc->Warnings()[1].ToString(), "mud.par:2:1: check section");
    EXPECT_EQ(doc->Warnings()[2].pos.line, 2);
}

TEST(Kiv, NullHandlesAreIgnored) {
    kivAddSection(nullptr, "S");
    kivPutParam(nullptr, "k", 1);
    kivPutParam(nullptr, "k", "text");
    kivPutListParam(nullptr, "k", "i", 1);
    kivEndSection(nullptr);
    EXPECT_EQ(kivSectionByNameNum(nullptr, "S", 1), nullptr);
    EXPECT_EQ(kivKeywordByNameNum(nullptr, "k", 1), nullptr);
    EXPECT_EQ(kivParamByNum(nullptr, 1), nullptr);
    EXPECT_EQ(kivGetResultFilename(nullptr), "");
}

} // namespace
