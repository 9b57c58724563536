#include "base/c_runtime.h"

#include <climits>
#include <cmath>
#include <gtest/gtest.h>
#include <string>

// Each expectation is what the Windows runtime's text mode and atof give.

TEST(CRuntime, TextModeJoinsCrLfKeepsLoneCrAndStopsAtCtrlZ)
{
    const std::pair<std::string, std::string> cases[] = {
        {"a\r\nb\r\n", "a\nb\n"},                  // CR LF pairs
        {"b\r\r\nc", "b\r\nc"},                    // a CR before a CR LF
        {"c\rd\r", "c\rd\r"},                      // a lone CR, also at the end
        {std::string("x\r\x1A\nrest", 7), "x\r"}}; // Ctrl-Z ends the text
    for (auto [bytes, text] : cases)
        EXPECT_EQ(bytes.substr(0, base::TranslateTextMode(bytes.data(), bytes.size())), text);
}

TEST(CRuntime, NumbersReadAsTheWindowsAtofReadsThem)
{
    const std::pair<const char*, double> cases[] = {
        {"0x1E", 0},    {"inf", 0},     {"nan", 0}, {"1d2", 100},      {"1E+2", 100},
        {"2e-2", 0.02}, {"1e", 1},      {"1e+", 1}, {" \f\v+.5", 0.5}, {"-3", -3},
        {"5.", 5},      {".", 0},       {"1,5", 1}, {"0030", 30},      {"1.5e3x", 1500},
        {"--1", 0},     {"1.2.3", 1.2}, {"1q2", 1}, {"1e-400", 0},     {"0.0001e5", 10}};
    for (const auto& [text, value] : cases)
        EXPECT_DOUBLE_EQ(base::ReadDecimal(text), value) << text;
    EXPECT_EQ(base::ReadDecimal("1e400"), HUGE_VAL);
    EXPECT_EQ(base::ReadDecimal(std::string(400, '9').c_str()), HUGE_VAL);
    EXPECT_EQ(base::ReadDecimal("-1e400"), -HUGE_VAL);
}

TEST(CRuntime, IntegersReadAsAtoiAndSaturateWhereGlibcWouldWrap)
{
    const std::pair<const char*, int> cases[] = {{"", 0},
                                                 {"-", 0},
                                                 {" \t+12x", 12},
                                                 {"x12", 0},
                                                 {"-0", 0},
                                                 {"-2147483648", INT_MIN},
                                                 {"2147483647", INT_MAX},
                                                 {"2147483648", INT_MAX},
                                                 {"99999999999999999999999", INT_MAX},
                                                 {"-2147483649", INT_MIN}};
    for (const auto& [text, value] : cases)
        EXPECT_EQ(base::ReadLeadingInteger(text), value) << text;
}
