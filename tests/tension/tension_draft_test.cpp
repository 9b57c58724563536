// Drafts laid on the music's loudness, and the figure that says how well a
// timeline follows it.
#include "tension/loudness_timeline.h"
#include "tension/tension_draft.h"
#include "tension/tension_file.h"
#include "tests/support/temp_folder.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <functional>
#include <gtest/gtest.h>
#include <tuple>

namespace
{

TEST(RankCorrelation, RanksTiesByTheirMeanAndHasNoValueWithoutChange)
{
    const std::tuple<std::vector<double>, std::vector<double>, bool, double> rows[] = {
        {{1, 2, 3, 4}, {10, 20, 30, 40}, true, 1.0},
        {{1, 2, 3, 4}, {4, 3, 2, 1}, true, -1.0},
        // Ranks 1.5 1.5 3 4 against 1 2 3 4.
        {{0, 0, 1, 2}, {1, 2, 3, 4}, true, 4.5 / std::sqrt(4.5 * 5.0)},
        {{1, 1, 1}, {1, 2, 3}, false, 0.0},
        {{1, 2}, {1, 2, 3}, false, 0.0},
    };
    for (const auto& [a, b, has, expected] : rows)
    {
        double figure = 0.0;
        ASSERT_EQ(tension::RankCorrelation(a, b, &figure), has) << expected;
        EXPECT_DOUBLE_EQ(has ? figure : 0.0, expected);
    }
}

double Bump(double share, double at, double width)
{
    return std::exp(-std::pow((share - at) / width, 2.0));
}

// Every length the check accepts and every kind of music: the draft passes
// the check, its finale and its window lie inside a climax stretch on the
// music's loudest second there, and it follows music that changes.
TEST(TensionDraft, EveryLengthAndShapeGivesADraftTheCheckAcceptsThatFollowsTheMusic)
{
    const std::pair<std::string, std::function<double(double share)>> shapes[] = {
        {"flat", [](double) { return -20.0; }},
        {"one peak", [](double s) { return -40.0 + 25.0 * Bump(s, 0.6, 0.1); }},
        {"two peaks",
         [](double s) { return -40.0 + 25.0 * std::max(Bump(s, 0.3, 0.06), Bump(s, 0.8, 0.08)); }},
        {"quiet ending",
         [](double s) { return s < 0.85 ? -18.0 + 4.0 * std::sin(40.0 * s) : -60.0; }},
        {"loud start",
         [](double s) { return s < 0.12 ? -10.0 : -30.0 + 8.0 * std::sin(25.0 * s); }},
    };
    for (const float length : {60.0f, 99.9f, 300.5f, 480.0f})
    {
        for (const auto& [name, shape] : shapes)
        {
            const std::string label = name + " " + std::to_string(length);
            std::vector<double> loudness;
            for (int second = 0; second < int(length); ++second)
                loudness.push_back(std::round(shape(second / length) * 100.0) / 100.0);
            const std::string text = tension::DraftTension("x", length, loudness);
            tension::CTensionFile draft;
            tension::CTextString log;
            ASSERT_TRUE(draft.ParseForLength(length, text.c_str(), ':', ';', &log))
                << label << "\n"
                << log.CStr() << text;
            EXPECT_STREQ(log.CStr(), "") << label;
            const float finale = draft.GetFinaleTime();
            const double loudest = *std::max_element(loudness.begin(), loudness.end());
            EXPECT_TRUE(name != "one peak" || loudness[std::size_t(finale)] == loudest) << label;
            EXPECT_TRUE(draft.IsFinale(finale)) << label;
            EXPECT_EQ(draft.GetTension(finale + draft.GetFinaleWindow()),
                      tension::TensionLevel::Climax)
                << label;
            const std::size_t figure = text.find("following it at ");
            EXPECT_EQ(figure != std::string::npos, name != "flat") << label;
            if (figure != std::string::npos)
            {
                EXPECT_GT(std::atof(text.c_str() + figure + 16), 0.6) << label;
            }
        }
    }
}

// The draft's file-name entry: the music's name within forty bytes, never
// cut inside a character ("あ" is 82 A0), one line that never ends the
// entry early.
TEST(DraftName, IsTheFileNameWithinFortyBytesOnOneLineThatNeverEndsTheEntryEarly)
{
    std::string a20;
    for (int i = 0; i < 20; ++i)
        a20 += "\x82\xA0";
    const std::pair<std::string, std::string> rows[] = {
        {"C:\\music\\battle.ogg", "battle"},
        {"/home/u/a;b.tar.wav", "a_b.tar"},
        {"folder/" + a20 + "\x82\xA0.wav", a20},
        {"a" + a20 + ".ogg", "a" + a20.substr(2)},
        {"  .wav", "BGM"},
        {" \ta\rb\nc\vd\x01\x7F .ogg", "_a_b_c_d__"},
        {"x\x82;.wav", "x__"},
        {"x\x82", "x_"},
    };
    for (const auto& [path, name] : rows)
        EXPECT_EQ(tension::DraftName(path), name) << path;
}

// The BGM page offers a draft for a missing tension file only, and writes
// it where the field says or beside the music, never over anything.
TEST(DraftPathFor, IsTheMissingTensionFileOrTheMusicsTextFileNeverOneThatStands)
{
    const testing_support::TempFolder folder;
    const std::string music = folder.File("m.wav"), stands = folder.File("stands.txt");
    testing_support::WriteBytes(stands, {1});
    testing_support::WriteBytes(folder.File("kept.txt"), {1});
    const std::string m = folder.File("m.txt"), so = "\x83\x5C";
    const auto path = [&](const std::string& musicPath, const std::string& tension = "",
                          float length = 120.0f, bool opened = true, std::size_t limit = 259)
    { return tension::DraftPathFor(musicPath, tension, opened, length, limit); };
    EXPECT_EQ(path(music), m);
    EXPECT_EQ(path(music, folder.File("x.txt")), folder.File("x.txt"));
    EXPECT_EQ(path(music, stands), "");
    EXPECT_EQ(path(folder.File("kept.ogg")), "");
    EXPECT_EQ(path(folder.File("no-extension"), "", 60.0f), folder.File("no-extension.txt"));
    EXPECT_EQ(path(folder.File("a\\b.c") + so, "", 480.0f), folder.File("a\\b.txt"));
    EXPECT_EQ(path(music, "", 120.0f, false), "");
    EXPECT_EQ(path(music, "", 59.9f), "");
    EXPECT_EQ(path(music, "", 480.5f), "");
    EXPECT_EQ(path(music, "", 120.0f, true, m.size() - 1), "");
}

} // namespace
