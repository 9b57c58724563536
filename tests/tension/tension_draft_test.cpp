// Drafts laid on the music's loudness, and the figure that says how well a
// timeline follows it.
#include "tension/loudness_timeline.h"
#include "tension/tension_draft.h"
#include "tension/tension_file.h"
#include "tests/support/temp_folder.h"

#include <cmath>
#include <cstdlib>
#include <functional>
#include <gtest/gtest.h>

namespace
{

TEST(RankCorrelation, RanksTiesByTheirMeanAndHasNoValueWithoutChange)
{
    const struct
    {
        std::vector<double> a, b;
        bool has;
        double figure;
    } rows[] = {
        {{1, 2, 3, 4}, {10, 20, 30, 40}, true, 1.0},
        {{1, 2, 3, 4}, {4, 3, 2, 1}, true, -1.0},
        // Ranks 1.5 1.5 3 4 against 1 2 3 4.
        {{0, 0, 1, 2}, {1, 2, 3, 4}, true, 4.5 / std::sqrt(4.5 * 5.0)},
        {{1, 1, 1}, {1, 2, 3}, false, 0.0},
        {{1}, {1}, false, 0.0},
        {{1, 2}, {1, 2, 3}, false, 0.0},
    };
    for (const auto& row : rows)
    {
        double figure = 0.0;
        ASSERT_EQ(tension::RankCorrelation(row.a, row.b, &figure), row.has) << row.figure;
        if (row.has)
        {
            EXPECT_DOUBLE_EQ(figure, row.figure);
        }
    }
}

using Shape = std::function<double(double share)>;

double Bump(double share, double at, double width)
{
    return std::exp(-std::pow((share - at) / width, 2.0));
}

// Every length the check accepts and every kind of music: the draft passes
// the check, its finale and its window lie inside a climax stretch on the
// music's loudest second there, and it follows music that changes.
TEST(TensionDraft, EveryLengthAndShapeGivesADraftTheCheckAcceptsThatFollowsTheMusic)
{
    const struct
    {
        const char* name;
        Shape loudness;
    } shapes[] = {
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
        for (const auto& shape : shapes)
        {
            const std::string label = std::string(shape.name) + " " + std::to_string(length);
            std::vector<double> loudness;
            for (int second = 0; second < int(length); ++second)
                loudness.push_back(std::round(shape.loudness(second / length) * 100.0) / 100.0);
            const std::string text = tension::DraftTension("x", length, loudness);
            tension::CTensionFile draft;
            tension::CTextString log;
            ASSERT_TRUE(draft.ParseForLength(length, text.c_str(), ':', ';', &log))
                << label << "\n"
                << log.CStr() << text;
            EXPECT_STREQ(log.CStr(), "") << label;
            const float finale = draft.GetFinaleTime();
            EXPECT_TRUE(draft.IsFinale(finale)) << label;
            EXPECT_EQ(draft.GetTension(finale + draft.GetFinaleWindow()),
                      tension::TensionLevel::Climax)
                << label;
            const std::size_t figure = text.find("following it at ");
            EXPECT_EQ(figure != std::string::npos, shape.name != std::string("flat")) << label;
            if (figure != std::string::npos)
            {
                EXPECT_GT(std::atof(text.c_str() + figure + 16), 0.6) << label;
            }
        }
    }
}

// The peak of one-peak music is the climax, and its finale is on the peak.
TEST(TensionDraft, TheClimaxAndItsFinaleStandOnThePeak)
{
    std::vector<double> loudness(200, -30.0);
    for (int second = 120; second < 135; ++second)
        loudness[std::size_t(second)] = second == 127 ? -8.0 : -12.0;
    const tension::LoudnessTimeline laid = tension::LayTimeline(loudness, 200.0f);
    EXPECT_EQ(laid.finaleSecond, 127);
    tension::TensionLevel at127 = tension::TensionLevel::Normal;
    for (const tension::LevelChange& change : laid.changes)
    {
        if (change.second <= 127)
            at127 = change.level;
    }
    EXPECT_EQ(at127, tension::TensionLevel::Climax);
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
    const std::string so = "\x83\x5C";
    const struct
    {
        std::string music, tension;
        bool opened;
        float length;
        std::size_t limit;
        std::string path;
    } rows[] = {
        {music, "", true, 120.0f, 259, folder.File("m.txt")},
        {music, folder.File("x.txt"), true, 120.0f, 259, folder.File("x.txt")},
        {music, stands, true, 120.0f, 259, ""},
        {folder.File("kept.ogg"), "", true, 120.0f, 259, ""},
        {folder.File("no-extension"), "", true, 60.0f, 259, folder.File("no-extension.txt")},
        {folder.File("a\\b.c") + so, "", true, 480.0f, 259, folder.File("a\\b.txt")},
        {music, "", false, 120.0f, 259, ""},
        {music, "", true, 59.9f, 259, ""},
        {music, "", true, 480.5f, 259, ""},
        {music, "", true, 120.0f, folder.File("m.txt").size() - 1, ""},
    };
    for (const auto& row : rows)
        EXPECT_EQ(tension::DraftPathFor(row.music, row.tension, row.opened, row.length, row.limit),
                  row.path)
            << row.music << " " << row.tension;
}

} // namespace
