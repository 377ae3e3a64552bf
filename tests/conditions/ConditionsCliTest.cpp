// The conditions as the command line shows and validates them.
#include <gtest/gtest.h>

#include <sys/wait.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace fs = std::filesystem;

namespace {

std::string Mudsetup(const std::string& args, int* exitCode) {
    const fs::path out = fs::temp_directory_path() / "mudsetup-conditions-out.txt";
    const std::string cmd = std::string(MUDSETUP_EXE) + " " + args + " >" + out.string() + " 2>&1";
    const int status = std::system(cmd.c_str());
    *exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    std::ifstream in(out);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

// The lines of text from the first that starts with from up to, not including, to.
std::string Between(const std::string& text, const std::string& from, const std::string& to) {
    const size_t a = text.find(from);
    const size_t b = text.find(to, a);
    return a == std::string::npos ? std::string() : text.substr(a, b - a);
}

}  // namespace

TEST(ConditionsCli, NewShowAndValidate) {
    const fs::path file = fs::temp_directory_path() / "mudsetup-conditions.setup";
    int rc = -1;
    Mudsetup("new --fractions 3 --layers 2 -o " + file.string(), &rc);
    ASSERT_EQ(rc, 0);
    EXPECT_EQ(Mudsetup("validate " + file.string(), &rc), "");
    EXPECT_EQ(rc, 0);
    const std::string tree = Mudsetup("show " + file.string(), &rc);
    EXPECT_EQ(rc, 0);
    EXPECT_EQ(Between(tree, "  Sources\n", "  Morphology\n"),
              "  Sources\n"
              "  Initial Conditions\n"
              "    Fraction Concentration\n"
              "      Fraction 1\n      Fraction 2\n      Fraction 3\n"
              "    Layer Thickness\n"
              "      Layer 1\n      Layer 2\n"
              "    Fraction Distribution\n"
              "  Boundary Conditions (not used)\n");

    // A share edited so that the layer no longer adds up to 100.
    std::ifstream in(file);
    std::stringstream s;
    s << in.rdbuf();
    std::string text = s.str();
    const size_t at = text.find("constant_value = 34.0");
    ASSERT_NE(at, std::string::npos);
    text.replace(at, 21, "constant_value = 33.99");
    std::ofstream(file) << text;
    EXPECT_EQ(Mudsetup("validate " + file.string(), &rc),
              "MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Distribution/"
              "BED_DISTRIBUTION_LAYER_1: The sum of fraction distributions in a layer must be "
              "100\n");
    EXPECT_EQ(rc, 1);
    fs::remove(file);
}
