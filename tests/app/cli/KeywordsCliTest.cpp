// mudsetup keywords: the reference as text, JSON and the generated docs/keywords.md.
#include "app/cli/Json.h"

#include <gtest/gtest.h>

#include <sys/wait.h>

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

namespace {

struct Output {
    int exitCode;
    std::string out;
};

Output Keywords(const std::string& args) {
    Output r{-1, ""};
    FILE* p = popen((std::string(MUDSETUP_EXE) + " keywords " + args + " 2>/dev/null").c_str(), "r");
    if (!p)
        return r;
    char buf[4096];
    for (size_t n; (n = std::fread(buf, 1, sizeof buf, p)) > 0;)
        r.out.append(buf, n);
    const int status = pclose(p);
    r.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return r;
}

size_t Count(const std::string& text, const std::string& what) {
    size_t n = 0;
    for (size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + 1))
        ++n;
    return n;
}

}  // namespace

TEST(KeywordsCli, TheCommittedReferenceIsCurrent) {
    const Output r = Keywords("--markdown");
    ASSERT_EQ(r.exitCode, 0);
    std::ifstream in(MUD_SOURCE_DIR "/docs/keywords.md", std::ios::binary);
    std::stringstream committed;
    committed << in.rdbuf();
    EXPECT_TRUE(committed.str() == r.out)
        << "docs/keywords.md is not current: regenerate it with "
           "`cmake --build build/default --target keywords-doc` and commit it";
}

TEST(KeywordsCli, TextAndJsonHoldTheSameKeywordsWithTypeDefaultUnitAndText) {
    const Output text = Keywords("");
    const Output json = Keywords("--json");
    ASSERT_EQ(text.exitCode, 0);
    ASSERT_EQ(json.exitCode, 0);
    EXPECT_NE(text.out.find("MUD_TRANSPORT_MODULE/WATER_COLUMN/SAND_FRACTIONS/FRACTION_%d/"
                            "mean_settling_velocity  float  default 0.001  m/s (Settling velocity)"
                            "  Mean settling velocity of the sand fraction\n"),
              std::string::npos);
    EXPECT_NE(text.out.find("MUD_TRANSPORT_MODULE/MODEL_DEFINITION/number_of_fractions  int  "
                            "default 1  1 .. 8  "),
              std::string::npos);
    EXPECT_EQ(Count(json.out, "{\"path\": "), Count(text.out, "\n"));
    EXPECT_NE(json.out.find("{\"path\": \"MUD_TRANSPORT_MODULE/WATER_COLUMN/SAND_FRACTIONS/"
                            "FRACTION_%d\", \"keyword\": \"mean_settling_velocity\", \"type\": "
                            "\"float\", \"default\": \"0.001\", \"unit_type\": 100128, \"unit\": "
                            "\"m/s\", \"quantity\": \"Settling velocity\""),
              std::string::npos);
    // String defaults keep their quotes, escaped.
    EXPECT_NE(json.out.find("\"default\": \"\\\"OUTPUTXXX\\\"\""), std::string::npos);
}

TEST(KeywordsCli, JsonAndMarkdownTogetherAreAUsageError) {
    EXPECT_EQ(Keywords("--json --markdown").exitCode, 2);
}

TEST(KeywordsCli, JsonStringsEscapeWhatJsonForbids) {
    const std::pair<std::string, std::string> cases[] = {
        {"plain", "\"plain\""},
        {"a \"b\" \\c", "\"a \\\"b\\\" \\\\c\""},
        {"l1\nl2\tx\r", "\"l1\\nl2\\tx\\r\""},
        {std::string("\x01\x1f", 2), "\"\\u0001\\u001f\""},
        {"Brunsbüttel", "\"Brunsbüttel\""},
    };
    for (const auto& [in, out] : cases)
        EXPECT_EQ(cli::JsonString(in), out);
}
