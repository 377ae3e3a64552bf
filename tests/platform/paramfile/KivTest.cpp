#include "paramfile/Kiv.h"
#include "paramfile/ParamFile.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>

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
    auto doc = Parse("S {\n  k = 1\n  e =\n}\n");
    void* s = Sec(*doc, "S");
    int v = 77;
    kivGetParam(nullptr, "k", &v, 1, 1);
    kivGetParam(s, "absent", &v, 1, 1);
    kivGetParam(s, "k", &v, 2, 1);
    kivGetParam(s, "k", &v, 1, 2);
    kivGetParam(s, "k", &v, 1, 0);
    kivGetParam(s, "e", &v, 1, 1);
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
