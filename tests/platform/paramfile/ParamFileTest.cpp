#include "paramfile/ParamFile.h"

#include <gtest/gtest.h>

#include <cfloat>
#include <climits>
#include <cmath>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <limits>
#include <random>
#include <sstream>

#include <unistd.h>

using namespace paramfile;

namespace {

std::unique_ptr<Document> Parse(const std::string& text) {
    ParseResult r = ParseText(text, "test.par");
    EXPECT_FALSE(r.error) << r.error->ToString();
    return std::move(r.document);
}

// Appends rather than "literal" + std::string, on which g++ 12 -O3 warns falsely.
template <class... Parts> std::string Join(const Parts&... parts) {
    std::string s;
    ((s += parts), ...);
    return s;
}

template <class T> auto Bits(T v) {
    std::conditional_t<sizeof(T) == 8, std::uint64_t, std::uint32_t> b;
    std::memcpy(&b, &v, sizeof v);
    return b;
}

// --- syntax errors -----------------------------------------------------------------------

struct BadInput {
    const char* text;
    int line;
    int column;
    const char* message;
};

TEST(ParamFileReader, SyntaxErrorsReportPlaceAndReturnNoDocument) {
    const BadInput cases[] = {
        {"A {\n  abc 5\n}\n", 2, 7, "expected '=' after keyword 'abc'"},
        {"A {\n  s = \"open\n}\n", 2, 7, "unterminated string"},
        {"A {\n  s = \"open", 2, 7, "unterminated string"},
        {"A {\n  f = 'c:\\dir\n}\n", 2, 7, "unterminated file name"},
        {"A {\n  s = \"a\\qb\"\n}\n", 2, 9, "unknown escape '\\q' in string"},
        {"# head\nX {\n  a = 1\n", 4, 1, "missing '}' for section 'X' opened at line 2"},
        {"A {\n}\n}\n", 3, 1, "unexpected '}'"},
        {"abc = 1\n", 1, 1, "keyword 'abc' outside a section"},
        {"A\n{\n}\n", 1, 2, "expected '{' after section name 'A'"},
        {"A {\n  x = 1,\n}\n", 2, 9, "expected a value after ','"},
        {"A {\n  x = 1 2\n}\n", 2, 9, "expected ',' or end of line after a value"},
        {"A {\n  x = 12ab\n}\n", 2, 7, "invalid number '12ab'"},
        {"A {\n  x = 1.2.3\n}\n", 2, 7, "invalid number '1.2.3'"},
        {"A {\n  x = -\n}\n", 2, 7, "invalid number '-'"},
        {"A {\n  x = 1e\n}\n", 2, 7, "invalid number '1e'"},
        {"A {\n  x = 9223372036854775808\n}\n", 2, 7,
         "integer 9223372036854775808 is out of range"},
        {"A {\n  x = 1e400\n}\n", 2, 7, "number 1e400 is out of range"},
        {"A {\n  x = maybe\n}\n", 2, 7, "unknown value 'maybe' (text needs double quotes)"},
        {"A {\n  x = , 1\n}\n", 2, 7, "expected a value"},
        {"A {\n  x = 1 }\n", 2, 9, "expected ',' or end of line after a value"},
        {"A {\n\t@\n}\n", 2, 2, "unexpected '@'"},
        {"A {\n  x = 1\n}\n\x01", 4, 1, "unexpected byte 0x01"},
        {"A {\r\n  x = \"a\nb\"\r\n}\r\n", 2, 7, "unterminated string"},
    };
    for (const BadInput& c : cases) {
        SCOPED_TRACE(c.text);
        const ParseResult r = ParseText(c.text, "in.par");
        EXPECT_EQ(r.document, nullptr);
        ASSERT_TRUE(r.error);
        EXPECT_EQ(r.error->ToString(), Join("in.par:", std::to_string(c.line), ":",
                                            std::to_string(c.column), ": ", c.message));
    }
}

TEST(ParamFileReader, NestingDepthIsBounded) {
    std::string deep;
    for (int i = 0; i < 1000; ++i)
        deep += "S {\n";
    deep += "x = 1\n";
    for (int i = 0; i < 1000; ++i)
        deep += "}\n";
    EXPECT_FALSE(ParseText(deep, "d").error);

    const ParseResult r = ParseText(Join("S {\n", deep, "}\n"), "d");
    ASSERT_TRUE(r.error);
    EXPECT_EQ(r.error->pos.line, 1001);
    EXPECT_EQ(r.error->message, "sections nested deeper than 1000 levels");

    // Far deeper than any stack would take, from hostile input.
    std::string braces;
    for (int i = 0; i < 200000; ++i)
        braces += "a{";
    EXPECT_TRUE(ParseText(braces, "d").error);
}

// --- structure and values ----------------------------------------------------------------

TEST(ParamFileReader, ReadsStructureCommentsAndLayout) {
    auto doc = Parse("\xEF\xBB\xBF# leading comment\r\n"
                     "Model {   # trailing comment\r\n"
                     "\tname = \"a # not a comment\" # comment\r\n"
                     "  empty =\r\n"
                     "\r\n"
                     "  Layer { depth = 1 \n }\n"
                     "  Layer {\n    depth = 2\n  }\n"
                     "  depth=3 ,4,\t5\n"
                     "} Other {\n}\n");
    const Section& root = doc->Root();
    ASSERT_EQ(root.EntryCount(), 2);
    const Section& model = root.SectionAt(0);
    EXPECT_EQ(model.Name(), "Model");
    EXPECT_EQ(model.Pos().line, 2);
    ASSERT_EQ(model.EntryCount(), 5);
    EXPECT_FALSE(model.EntryIsSection(0));
    EXPECT_TRUE(model.EntryIsSection(2));
    EXPECT_EQ(model.KeywordAt(1).Name(), "empty");
    EXPECT_EQ(model.KeywordAt(1).ParamCount(), 0);

    std::string s;
    ASSERT_TRUE(model.KeywordAt(0).ParamAt(0).AsString(s));
    EXPECT_EQ(s, "a # not a comment");
    EXPECT_EQ(model.KeywordAt(0).Pos().line, 3);
    EXPECT_EQ(model.KeywordAt(0).Pos().column, 2);
    EXPECT_EQ(&model.KeywordAt(0).Owner(), &model);

    // n-th occurrence look-ups
    const Section* layer2 = model.FindSection("Layer", 2);
    ASSERT_NE(layer2, nullptr);
    EXPECT_EQ(layer2->Pos().line, 8);
    EXPECT_EQ(model.FindSection("Layer", 3), nullptr);
    EXPECT_EQ(model.FindSection("Layer", 0), nullptr);
    EXPECT_EQ(model.FindSection("Nothing"), nullptr);
    std::int32_t v = 0;
    ASSERT_TRUE(layer2->FindKeyword("depth")->ParamAt(0).AsInt(v));
    EXPECT_EQ(v, 2);
    const Keyword* depth = model.FindKeyword("depth");
    ASSERT_NE(depth, nullptr);
    ASSERT_EQ(depth->ParamCount(), 3);
    ASSERT_TRUE(depth->ParamAt(2).AsInt(v));
    EXPECT_EQ(v, 5);
    EXPECT_EQ(root.FindSection("Other")->EntryCount(), 0);
}

TEST(ParamFileReader, ReadsEveryValueType) {
    auto doc = Parse("V {\n"
                     "  i = 42, -7, 2147483648, -9223372036854775808, 007\n"
                     "  r = 1.5, -2e3, 1E-2, .5, 3., nan, inf, -inf, -0.0\n"
                     "  b = true, false, 1, 0, 2\n"
                     "  s = \"q\\\"b\\\\n\\n\\t\\r\", \"\xC3\xA9\xE6\xB0\xB4\", \"\"\n"
                     "  f = 'C:\\data\\it''s here.txt', ''\n"
                     "}\n");
    const Section& v = *doc->Root().FindSection("V");
    const Keyword& i = *v.FindKeyword("i");
    std::int32_t n = 0;
    EXPECT_TRUE(i.ParamAt(0).AsInt(n) && n == 42);
    EXPECT_TRUE(i.ParamAt(1).AsInt(n) && n == -7);
    EXPECT_FALSE(i.ParamAt(2).AsInt(n)); // kept as 64 bits, refused as 32
    EXPECT_EQ(i.ParamAt(3).Type(), ParamType::Integer);
    EXPECT_TRUE(i.ParamAt(4).AsInt(n) && n == 7);
    double d = 0;
    EXPECT_TRUE(i.ParamAt(2).AsDouble(d) && d == 2147483648.0);
    EXPECT_TRUE(i.ParamAt(3).AsDouble(d) && d == -0x1p63);

    const Keyword& r = *v.FindKeyword("r");
    const double want[] = {1.5, -2000, 0.01, 0.5, 3};
    for (int k = 0; k < 5; ++k) {
        EXPECT_EQ(r.ParamAt(k).Type(), ParamType::Double);
        EXPECT_TRUE(r.ParamAt(k).AsDouble(d) && d == want[k]) << k;
    }
    EXPECT_TRUE(r.ParamAt(5).AsDouble(d) && std::isnan(d));
    EXPECT_TRUE(r.ParamAt(6).AsDouble(d) && d == INFINITY);
    EXPECT_TRUE(r.ParamAt(7).AsDouble(d) && d == -INFINITY);
    EXPECT_TRUE(r.ParamAt(8).AsDouble(d) && Bits(d) == Bits(-0.0));
    EXPECT_FALSE(r.ParamAt(0).AsInt(n));

    const Keyword& b = *v.FindKeyword("b");
    bool flag = false;
    EXPECT_TRUE(b.ParamAt(0).AsBool(flag) && flag);
    EXPECT_TRUE(b.ParamAt(1).AsBool(flag) && !flag);
    EXPECT_TRUE(b.ParamAt(2).AsBool(flag) && flag);
    EXPECT_TRUE(b.ParamAt(3).AsBool(flag) && !flag);
    EXPECT_FALSE(b.ParamAt(4).AsBool(flag));
    EXPECT_FALSE(b.ParamAt(0).AsInt(n));

    const Keyword& s = *v.FindKeyword("s");
    std::string text;
    EXPECT_TRUE(s.ParamAt(0).AsString(text));
    EXPECT_EQ(text, "q\"b\\n\n\t\r");
    EXPECT_TRUE(s.ParamAt(1).AsString(text));
    EXPECT_EQ(text, "\xC3\xA9\xE6\xB0\xB4");
    EXPECT_TRUE(s.ParamAt(2).AsString(text) && text.empty());
    EXPECT_FALSE(s.ParamAt(0).AsDouble(d));

    const Keyword& f = *v.FindKeyword("f");
    EXPECT_EQ(f.ParamAt(0).Type(), ParamType::FileName);
    EXPECT_TRUE(f.ParamAt(0).AsString(text));
    EXPECT_EQ(text, "C:\\data\\it's here.txt");
    EXPECT_TRUE(f.ParamAt(1).AsString(text) && text.empty());
}

TEST(ParamFileReader, RealReadAsFloatIsTheFloatOfTheText) {
    // The nearest double is the midpoint between 1 and the next float; the text lies just
    // above it, so the float is the upper one although the double would round down.
    auto doc = Parse("A {\n  x = 1.0000000596046448, 1.0000000596046446, 0.1, 1e39, 16777217\n}\n");
    const Keyword& x = *doc->Root().FindSection("A")->FindKeyword("x");
    float f = 0;
    ASSERT_TRUE(x.ParamAt(0).AsFloat(f));
    EXPECT_EQ(Bits(f), Bits(std::nextafter(1.0f, 2.0f)));
    ASSERT_TRUE(x.ParamAt(1).AsFloat(f));
    EXPECT_EQ(f, 1.0f);
    ASSERT_TRUE(x.ParamAt(2).AsFloat(f));
    EXPECT_EQ(Bits(f), Bits(0.1f));
    f = 5;
    EXPECT_FALSE(x.ParamAt(3).AsFloat(f)); // beyond float range
    EXPECT_FALSE(x.ParamAt(4).AsFloat(f)); // no float holds it exactly
    EXPECT_EQ(f, 5);

    // Built in memory, the same double reads as the float of the text it will be written as.
    Document built;
    Builder b(built);
    b.BeginSection("A");
    b.AddKeyword("x");
    b.AddDouble(1 + 0x1p-24);
    ASSERT_TRUE(built.Root().SectionAt(0).KeywordAt(0).ParamAt(0).AsFloat(f));
    EXPECT_EQ(Bits(f), Bits(std::nextafter(1.0f, 2.0f)));
}

TEST(ParamFileReader, WhatNoLookUpFoundIsReportedOnceAtItsPlace) {
    auto doc = Parse("A {\n    k = 1\n    k = 2\n    typo = 3\n    S {\n        x = 1\n        y = 2\n"
                     "    }\n    S {\n    }\n    NEW {\n        z = 1\n    }\n}\n");
    const Section& a = *doc->Root().FindSection("A");
    ASSERT_NE(a.FindKeyword("k"), nullptr);
    const Section* s = a.FindSection("S");
    ASSERT_NE(s, nullptr);
    ASSERT_NE(s->FindKeyword("x"), nullptr);
    EXPECT_TRUE(s->WasFound());
    // Walking the entries is no look-up.
    EXPECT_FALSE(a.SectionAt(a.EntryCount() - 1).WasFound());
    EXPECT_FALSE(a.SectionAt(a.EntryCount() - 1).KeywordAt(0).WasFound());
    std::vector<std::string> got;
    for (const Diagnostic& d : UnreadEntries(a, "A"))
        got.push_back(d.ToString());
    EXPECT_EQ(got, (std::vector<std::string>{
                       "test.par:3:5: keyword 'k' repeated in A: only the first is read, this "
                       "one is dropped on saving",
                       "test.par:4:5: unknown keyword 'typo' in A: not read, dropped on saving",
                       "test.par:7:9: unknown keyword 'y' in A/S: not read, dropped on saving",
                       "test.par:9:5: section 'S' repeated in A: only the first is read, this "
                       "one is dropped on saving",
                       "test.par:11:5: unknown section 'NEW' in A: not read, dropped on saving",
                   }));
}

TEST(ParamFileBuilder, CommentsFollowTheirEntriesIntoCopiesAndRebuiltSections) {
    auto source = Parse("# head\nA { # a\n    # before k\n    k = 1 # on k\n    # end of A\n}\n"
                        "B {\n    # before m\n    m = 2\n}\n# tail\n");
    Document out;
    {
        Builder b(out);
        b.TakeCommentsFrom(*source);
        b.CopySection(*source->Root().FindSection("A"));
        // Rebuilt by name: the comments of the namesakes come along, new entries have none.
        b.BeginSection("B");
        b.AddKeyword("new");
        b.AddInt(3);
        b.AddKeyword("m");
        b.AddInt(4);
        b.EndSection();
    }
    EXPECT_EQ(WriteText(out), "# head\nA { # a\n    # before k\n    k = 1 # on k\n    # end of A\n}\n"
                              "B {\n    new = 3\n    # before m\n    m = 4\n}\n# tail\n");
}

// --- writer ------------------------------------------------------------------------------

TEST(ParamFileWriter, WritesCanonicalFormAndIsIdempotent) {
    const std::string messy = "# comment\nTop{a=1,2 ,3\n  Inner {\n\t\tb =\n"
                              "   c = 1e7,0.001,-.33, 100.0, 123456789012345680.0\n"
                              "d = \"tab\there\" , 'it''s'\n}}\nNext {\n}\n";
    const std::string want = "# comment\n"
                             "Top {\n"
                             "    a = 1, 2, 3\n"
                             "    Inner {\n"
                             "        b =\n"
                             "        c = 1e+07, 0.001, -0.33, 100.0, 123456789012345680.0\n"
                             "        d = \"tab\\there\", 'it''s'\n"
                             "    }\n"
                             "}\n"
                             "Next {\n"
                             "}\n";
    const std::string once = WriteText(*Parse(messy));
    EXPECT_EQ(once, want);
    EXPECT_EQ(WriteText(*Parse(once)), once);
    EXPECT_EQ(WriteText(*Parse("")), "");

    std::string reused = "left over text that is longer than the output";
    WriteText(*Parse(once), reused);
    EXPECT_EQ(reused, once);
}

TEST(ParamFileWriter, EdgeValuesRoundTripExactly) {
    const double doubles[] = {0.0,
                              -0.0,
                              1.0,
                              0.1,
                              1.0 / 3,
                              -2.5e-8,
                              DBL_MAX,
                              -DBL_MAX,
                              DBL_MIN,
                              std::numeric_limits<double>::denorm_min(),
                              0x1.fffffffffffffp-1022,
                              9007199254740993.0,
                              1e22,
                              1e23,
                              5e-324,
                              INFINITY,
                              -INFINITY,
                              NAN};
    const float floats[] = {
        0.1f,        -0.0f, FLT_MAX, FLT_MIN,    std::numeric_limits<float>::denorm_min(),
        16777216.0f, 3.0f,  1e-10f,  1.0000001f, -INFINITY};
    const std::string strings[] = {"",
                                   "plain",
                                   "q\"uote",
                                   "back\\slash",
                                   "line\nbreak",
                                   "\t\r",
                                   "#,=",
                                   "\xE6\xB0\xB4 \xF0\x9F\x8C\x8A",
                                   std::string("nul\0byte", 8),
                                   "\xff\xfe invalid"};
    const std::string files[] = {"C:\\Program Files\\model\\run.setup",
                                 "\\\\server\\share\\it's.qrd0",
                                 "''",
                                 "/tmp/a b/#c,d.txt",
                                 "\xC3\xA9t\xC3\xA9.dat",
                                 ""};

    Document doc;
    Builder b(doc);
    b.BeginSection("Values");
    b.AddKeyword("i");
    for (std::int32_t v : {INT_MIN, INT_MAX, 0, -1})
        b.AddInt(v);
    b.AddKeyword("d");
    for (double v : doubles)
        b.AddDouble(v);
    b.AddKeyword("f");
    for (float v : floats)
        b.AddFloat(v);
    b.AddKeyword("s");
    for (const std::string& v : strings)
        b.AddString(v);
    b.AddKeyword("n");
    for (const std::string& v : files)
        b.AddFileName(v);
    b.EndSection();

    const std::string text = WriteText(doc);
    auto back = Parse(text);
    ASSERT_TRUE(back);
    EXPECT_EQ(WriteText(*back), text);

    const Section& v = *back->Root().FindSection("Values");
    std::int32_t n = 0;
    EXPECT_TRUE(v.FindKeyword("i")->ParamAt(0).AsInt(n) && n == INT_MIN);
    const Keyword& d = *v.FindKeyword("d");
    for (int k = 0; k < d.ParamCount(); ++k) {
        double x = 0;
        ASSERT_TRUE(d.ParamAt(k).AsDouble(x));
        EXPECT_EQ(Bits(x), Bits(doubles[k])) << k << " " << text;
    }
    const Keyword& f = *v.FindKeyword("f");
    for (int k = 0; k < f.ParamCount(); ++k) {
        float x = 0;
        ASSERT_TRUE(f.ParamAt(k).AsFloat(x));
        EXPECT_EQ(Bits(x), Bits(floats[k])) << k;
    }
    const Keyword& s = *v.FindKeyword("s");
    for (int k = 0; k < s.ParamCount(); ++k) {
        std::string x;
        EXPECT_EQ(s.ParamAt(k).Type(), ParamType::String);
        ASSERT_TRUE(s.ParamAt(k).AsString(x));
        EXPECT_EQ(x, strings[k]);
    }
    const Keyword& fn = *v.FindKeyword("n");
    for (int k = 0; k < fn.ParamCount(); ++k) {
        std::string x;
        EXPECT_EQ(fn.ParamAt(k).Type(), ParamType::FileName);
        ASSERT_TRUE(fn.ParamAt(k).AsString(x));
        EXPECT_EQ(x, files[k]);
    }
    // Shortest forms, always recognisable as reals.
    EXPECT_NE(text.find("d = 0.0, -0.0, 1.0, 0.1, 0.3333333333333333, -2.5e-08, "
                        "1.7976931348623157e+308"),
              std::string::npos)
        << text;
    EXPECT_NE(text.find("f = 0.1, -0.0, 3.4028235e+38, 1.1754944e-38, 1e-45, 16777216.0, 3.0"),
              std::string::npos)
        << text;
}

// --- builder -----------------------------------------------------------------------------

TEST(ParamFileBuilder, KeepsDocumentReadableWhileBuilding) {
    Document doc;
    Builder b(doc);
    b.AddKeyword("top"); // the top level holds only sections
    b.AddInt(1);
    b.BeginSection("A");
    b.AddKeyword("x");
    b.AddInt(1);
    b.BeginSection("B");
    b.AddKeyword("y");
    b.EndSection();
    b.AddInt(99); // no keyword is current after a section closes
    for (int i = 0; i < 20; ++i) {
        b.AddKeyword(Join("k", std::to_string(i)));
        b.AddInt(i);
        b.BeginSection("C");
        b.EndSection();
    }
    EXPECT_EQ(b.Depth(), 1);
    const Section& a = doc.Root().SectionAt(0);
    ASSERT_EQ(a.EntryCount(), 42);
    EXPECT_EQ(a.KeywordAt(0).ParamCount(), 1);
    EXPECT_EQ(a.SectionAt(1).Name(), "B");
    EXPECT_EQ(a.KeywordAt(40).Name(), "k19");
    EXPECT_EQ(a.FindSection("C", 20), &a.SectionAt(41));
    b.BeginSection("bad name");
    b.BeginSection("9lives");
    b.EndSection();
    b.EndSection();
    b.EndSection();
    b.EndSection(); // ignored at the root
    EXPECT_EQ(b.Depth(), 0);
    EXPECT_EQ(WriteText(doc).substr(0, 21), "A {\n    x = 1\n    B {");
    EXPECT_NE(WriteText(doc).find("bad_name {\n        _9lives {"), std::string::npos);
}

TEST(ParamFileBuilder, CopiesSectionsFromAnyDocument) {
    auto src = Parse("S {\n  a = 1, \"t\", 'f'\n  T {\n    b = 2.5\n  }\n}\n");
    Document doc;
    {
        Builder b(doc);
        b.BeginSection("Outer");
        b.CopySection(*src->Root().FindSection("S"));
        b.EndSection();
    }
    src.reset(); // the copy owns its text
    Builder b(doc);
    b.CopySection(*doc.Root().FindSection("Outer")); // from itself
    b.CopySection(doc.Root().SectionAt(7));          // out of range: nothing
    const std::string want = "Outer {\n    S {\n        a = 1, \"t\", 'f'\n        T {\n"
                             "            b = 2.5\n        }\n    }\n}\n";
    EXPECT_EQ(WriteText(doc), want + want);
}

TEST(ParamFileBuilder, DropsSectionsBeyondTheDepthLimit) {
    Document doc;
    Builder b(doc);
    for (int i = 0; i < 1100; ++i) {
        b.BeginSection("S");
        b.AddKeyword("k");
        b.AddInt(i);
    }
    EXPECT_EQ(b.Depth(), 1100);
    for (int i = 0; i < 1100; ++i)
        b.EndSection();
    b.BeginSection("After");
    b.EndSection();
    const ParseResult r = ParseText(WriteText(doc), "deep");
    ASSERT_FALSE(r.error) << r.error->ToString();
    EXPECT_NE(r.document->Root().FindSection("After"), nullptr);
}

TEST(ParamFileBuilder, LargeTablesGrowAndReadBack) {
    // Big enough for every table to leave the small-allocation path.
    Document doc;
    Builder b(doc);
    for (int i = 0; i < 150000; ++i) {
        if (i % 1000 == 0) {
            b.EndSection();
            b.BeginSection("Big");
        }
        b.AddKeyword("k");
        b.AddInt(i);
        b.AddDouble(i * 0.5);
        b.AddString("s");
    }
    b.EndSection();
    const std::string text = WriteText(doc);
    auto back = Parse(text);
    ASSERT_TRUE(back);
    EXPECT_EQ(WriteText(*back), text);
    const Section* last = back->Root().FindSection("Big", 150);
    ASSERT_NE(last, nullptr);
    double d = 0;
    EXPECT_TRUE(last->FindKeyword("k", 1000)->ParamAt(1).AsDouble(d));
    EXPECT_EQ(d, 149999 * 0.5);
}

// --- files -------------------------------------------------------------------------------

class ParamFileFiles : public ::testing::Test {
protected:
    void SetUp() override {
        dir_ = std::filesystem::temp_directory_path() /
               Join("paramfile_test_", std::to_string(::getpid()));
        std::filesystem::create_directories(dir_);
    }
    void TearDown() override { std::filesystem::remove_all(dir_); }
    std::string Read(const std::filesystem::path& p) {
        std::ifstream in(p, std::ios::binary);
        std::stringstream s;
        s << in.rdbuf();
        return s.str();
    }
    std::size_t FileCount() {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(dir_),
                                                      std::filesystem::directory_iterator()));
    }
    std::filesystem::path dir_;
};

TEST_F(ParamFileFiles, WritesAtomicallyAndReadsBack) {
    const std::string path = (dir_ / "setup.par").string();
    std::string error;
    ASSERT_TRUE(fileio::WriteFileAtomic(path, "A {\n    x = 1\n}\n", &error)) << error;
    ASSERT_TRUE(fileio::WriteFileAtomic(path, "B {\n}\n", &error)) << error;
    EXPECT_EQ(Read(path), "B {\n}\n");
    EXPECT_EQ(FileCount(), 1u); // no temporary left behind

    const ParseResult r = ParseFile(path);
    ASSERT_FALSE(r.error);
    EXPECT_EQ(r.document->FileName(), path);
    EXPECT_NE(r.document->Root().FindSection("B"), nullptr);
}

TEST_F(ParamFileFiles, FailedWriteLeavesTargetAndSaysWhy) {
    const std::filesystem::path target = dir_ / "target";
    std::filesystem::create_directory(target);
    std::ofstream(target / "keep") << "kept";
    std::string error;
    EXPECT_FALSE(fileio::WriteFileAtomic(target.string(), "A {\n}\n", &error));
    EXPECT_EQ(error, Join("cannot write '", target.string(), "': is a folder"));
    EXPECT_EQ(Read(target / "keep"), "kept");
    EXPECT_EQ(FileCount(), 1u);

    const std::string missing = (dir_ / "no" / "such.par").string();
    EXPECT_FALSE(fileio::WriteFileAtomic(missing, "x", &error));
    EXPECT_EQ(error, Join("cannot write '", missing, "': No such file or directory"));
    EXPECT_FALSE(fileio::WriteFileAtomic(missing, "x", nullptr));
}

TEST_F(ParamFileFiles, UnreadableFileGivesErrorAtLineZero) {
    const std::string path = (dir_ / "absent.par").string();
    const ParseResult r = ParseFile(path);
    EXPECT_EQ(r.document, nullptr);
    ASSERT_TRUE(r.error);
    EXPECT_EQ(r.error->ToString(),
              Join(path, ":0:0: cannot read '", path, "': No such file or directory"));
    const ParseResult d = ParseFile(dir_.string());
    ASSERT_TRUE(d.error);
    EXPECT_NE(d.error->message.find("is a folder"), std::string::npos);
}

// --- random documents --------------------------------------------------------------------

class RandomDocument {
public:
    explicit RandomDocument(std::uint32_t seed) : rng_(seed) {}

    void Build(Builder& b) {
        const int sections = Pick(1, 4);
        for (int i = 0; i < sections; ++i)
            BuildSection(b, 1);
    }

private:
    int Pick(int lo, int hi) { return std::uniform_int_distribution<int>(lo, hi)(rng_); }

    std::string Name() {
        static const char* common[] = {"Fraction", "settling_velocity", "x", "_", "A1"};
        if (Pick(0, 2) == 0)
            return common[Pick(0, 4)];
        static const char first[] = "abcXYZ_";
        static const char rest[] = "abcXYZ_019";
        std::string s(1, first[Pick(0, 6)]);
        for (int n = Pick(0, 12); n > 0; --n)
            s += rest[Pick(0, 9)];
        return s;
    }

    std::string Text(bool fileName) {
        static const std::string pieces[] = {"a",
                                             " ",
                                             "\"",
                                             "\\",
                                             "'",
                                             "''",
                                             "#",
                                             ",",
                                             "=",
                                             "{",
                                             "}",
                                             "\t",
                                             "\r",
                                             "\xC3\xA9",
                                             "\xE6\xB0\xB4",
                                             std::string(1, '\0'),
                                             "C:\\x",
                                             "\n"};
        std::string s;
        for (int n = Pick(0, 8); n > 0; --n) {
            const std::string& p = pieces[Pick(0, fileName ? 15 : 17)];
            s += p;
        }
        return s;
    }

    double Double() {
        static const double edge[] = {0.0,       -0.0, DBL_MAX, DBL_MIN, 5e-324,  INFINITY,
                                      -INFINITY, NAN,  0.1,     1e7,     -1e-300, 123456789.0};
        switch (Pick(0, 3)) {
        case 0:
            return edge[Pick(0, 11)];
        case 1: {
            double d;
            std::uint64_t bits = rng_() << 32 | rng_();
            std::memcpy(&d, &bits, sizeof d);
            return std::isnan(d) ? 1.5 : d;
        }
        case 2:
            return std::uniform_real_distribution<double>(-1e6, 1e6)(rng_);
        default:
            return Pick(-100000, 100000) / 1000.0;
        }
    }

    float Float() {
        if (Pick(0, 1) == 0) {
            float f;
            std::uint32_t bits = rng_();
            std::memcpy(&f, &bits, sizeof f);
            return std::isnan(f) ? 0.25f : f;
        }
        static const float edge[] = {FLT_MAX, -FLT_MIN, 1e-45f, -0.0f, 0.1f, NAN, INFINITY};
        return edge[Pick(0, 6)];
    }

    void BuildSection(Builder& b, int depth) {
        b.BeginSection(Name());
        for (int n = Pick(0, 6); n > 0; --n) {
            if (depth < 6 && Pick(0, 3) == 0) {
                BuildSection(b, depth + 1);
                continue;
            }
            b.AddKeyword(Name());
            for (int p = Pick(0, 5); p > 0; --p) {
                switch (Pick(0, 5)) {
                case 0:
                    b.AddInt(Pick(0, 2) ? Pick(-1000, 1000) : (Pick(0, 1) ? INT_MIN : INT_MAX));
                    break;
                case 1:
                    b.AddDouble(Double());
                    break;
                case 2:
                    b.AddFloat(Float());
                    break;
                case 3:
                    b.AddBool(Pick(0, 1));
                    break;
                case 4:
                    b.AddString(Text(false));
                    break;
                default:
                    b.AddFileName(Text(true));
                }
            }
        }
        b.EndSection();
    }

    std::mt19937 rng_;
};

void ExpectSameParam(const Param& built, const Param& read) {
    switch (built.Type()) {
    case ParamType::Float: {
        float a = 0, b = 0;
        ASSERT_EQ(read.Type(), ParamType::Double);
        ASSERT_TRUE(built.AsFloat(a));
        ASSERT_TRUE(read.AsFloat(b));
        EXPECT_TRUE(std::isnan(a) ? std::isnan(b) : Bits(a) == Bits(b));
        return;
    }
    case ParamType::Double: {
        double a = 0, b = 0;
        ASSERT_EQ(read.Type(), ParamType::Double);
        built.AsDouble(a);
        read.AsDouble(b);
        EXPECT_TRUE(std::isnan(a) ? std::isnan(b) : Bits(a) == Bits(b));
        float fa = 0, fb = 0;
        EXPECT_EQ(built.AsFloat(fa), read.AsFloat(fb));
        EXPECT_TRUE(std::isnan(fa) ? std::isnan(fb) : Bits(fa) == Bits(fb));
        return;
    }
    case ParamType::String:
    case ParamType::FileName: {
        std::string a, b;
        EXPECT_EQ(read.Type(), built.Type());
        built.AsString(a);
        read.AsString(b);
        EXPECT_EQ(a, b);
        return;
    }
    case ParamType::Integer: {
        std::int32_t a = 0, b = 1;
        EXPECT_EQ(read.Type(), built.Type());
        built.AsInt(a);
        read.AsInt(b);
        EXPECT_EQ(a, b);
        return;
    }
    case ParamType::Boolean: {
        bool a = false, b = true;
        EXPECT_EQ(read.Type(), built.Type());
        built.AsBool(a);
        read.AsBool(b);
        EXPECT_EQ(a, b);
        return;
    }
    }
}

void ExpectSameSection(const Section& a, const Section& b) {
    ASSERT_EQ(a.Name(), b.Name());
    ASSERT_EQ(a.EntryCount(), b.EntryCount()) << a.Name();
    for (int i = 0; i < a.EntryCount(); ++i) {
        ASSERT_EQ(a.EntryIsSection(i), b.EntryIsSection(i));
        if (a.EntryIsSection(i)) {
            ExpectSameSection(a.SectionAt(i), b.SectionAt(i));
            continue;
        }
        const Keyword& ka = a.KeywordAt(i);
        const Keyword& kb = b.KeywordAt(i);
        ASSERT_EQ(ka.Name(), kb.Name());
        ASSERT_EQ(ka.ParamCount(), kb.ParamCount());
        for (int p = 0; p < ka.ParamCount(); ++p)
            ExpectSameParam(ka.ParamAt(p), kb.ParamAt(p));
    }
}

TEST(ParamFileProperty, RandomDocumentsRoundTrip) {
    for (std::uint32_t seed = 1; seed <= 300; ++seed) {
        SCOPED_TRACE(Join("seed ", std::to_string(seed)));
        Document doc;
        Builder b(doc);
        RandomDocument(seed).Build(b);
        const std::string text = WriteText(doc);
        const ParseResult r = ParseText(text, "random");
        ASSERT_FALSE(r.error) << r.error->ToString() << "\n" << text;
        ExpectSameSection(doc.Root(), r.document->Root());
        ASSERT_EQ(WriteText(*r.document), text);
        if (HasFatalFailure())
            return;
    }
}

} // namespace

// Sections with many entries answer look-ups from an index; the answers must not change.
TEST(LargeSectionLookup, IndexedLookupsMatchTheOrderOfTheFile) {
    std::string text = "TOP {\n";
    for (int i = 1; i <= 300; ++i) {
        text += "    ITEM_" + std::to_string(i % 100) + " {\n        v = " + std::to_string(i) + "\n    }\n";
        text += "    k" + std::to_string(i % 7) + " = " + std::to_string(i) + "\n";
    }
    text += "}\n";
    paramfile::ParseResult r = paramfile::ParseText(text, "big");
    ASSERT_FALSE(r.error);
    const paramfile::Section* top = r.document->Root().FindSection("TOP");
    ASSERT_TRUE(top);
    for (int n = 1; n <= 3; ++n) {
        const paramfile::Section* s = top->FindSection("ITEM_5", n);
        ASSERT_TRUE(s) << n;
        std::int32_t v = 0;
        ASSERT_TRUE(s->FindKeyword("v")->ParamAt(0).AsInt(v));
        EXPECT_EQ(v, 5 + 100 * (n - 1));
    }
    EXPECT_EQ(top->FindSection("ITEM_5", 4), nullptr);
    EXPECT_EQ(top->FindSection("ITEM_5", 0), nullptr);
    EXPECT_EQ(top->FindSection("k3"), nullptr);   // a keyword, not a section
    EXPECT_EQ(top->FindKeyword("ITEM_3"), nullptr);
    std::int32_t v = 0;
    ASSERT_TRUE(top->FindKeyword("k3", 2)->ParamAt(0).AsInt(v));
    EXPECT_EQ(v, 10);
    EXPECT_EQ(top->FindKeyword("k3", 44), nullptr);
    EXPECT_NE(top->FindKeyword("k3", 43), nullptr);
}
