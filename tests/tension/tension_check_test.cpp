// The whole-file checks with every threshold and message, and the queries
// of a player of the music.
#include "tests/tension/tension_support.h"

#include <gtest/gtest.h>
#include <string>

using tension::CTensionFile;
using tension::TensionLevel;
using tension_testing::Lines;
using tension_testing::Outcome;
using tension_testing::Parse;

namespace
{

constexpr const char* kIsCorrectError = "Time Data IsCorrect Error!!";

std::string Named(const std::string& entries)
{
    return "NAME:x;\n" + entries;
}

} // namespace

TEST(TensionCheck, TheMusicMustLastFromSixtyToFourHundredEightySeconds)
{
    struct Case
    {
        double seconds;
        bool accepted;
        std::string log;
    };
    const Case cases[] = {
        {60.0, true, ""},
        {480.0, true, ""},
        {59.5, false,
         Lines(
             {"ファイル時間 エラー[59.500000秒のファイルです : 60秒以上の長さのファイルが必要です]",
              kIsCorrectError})},
        {480.5, false,
         Lines({"ファイル時間 エラー[480.500000秒のファイルです : "
                "480秒以下の長さのファイルが必要です]",
                kIsCorrectError})},
    };
    for (const Case& c : cases)
    {
        // The empty name would fail its own check: it is never reached.
        const std::string text = c.accepted ? "NAME:x;" : "HI:10;";
        const Outcome outcome = Parse(text, c.seconds);
        EXPECT_EQ(outcome.accepted, c.accepted) << c.seconds;
        EXPECT_EQ(outcome.log, c.log) << c.seconds;
    }
}

TEST(TensionCheck, TheNameHasOneToFortyBytes)
{
    const std::string message = "ファイル名 エラー[ファイル名を 1 ～ 40 文字以内にしてください]";
    EXPECT_NE(message.find("\x81\x60"), std::string::npos) << "the wave dash is 81 60";
    struct Case
    {
        std::string name;
        bool accepted;
    };
    const Case cases[] = {
        {"a", true},
        {std::string(40, 'n'), true},
        {std::string(41, 'n'), false},
        {"二十文字の名前二十文字の名前二十文字の名前ああ", false}, // 46 bytes
        {"二十文字の名前二十文字の名前二十文字の名", true},        // 40 bytes
    };
    for (const Case& c : cases)
    {
        const Outcome outcome = Parse("NAME:" + c.name + ";", 200.0);
        EXPECT_EQ(outcome.accepted, c.accepted) << c.name;
        EXPECT_EQ(outcome.log, c.accepted ? "" : Lines({message.c_str(), kIsCorrectError}))
            << c.name;
    }
    const Outcome unnamed = Parse("", 200.0);
    EXPECT_EQ(unnamed.log, Lines({message.c_str(), kIsCorrectError}));
}

TEST(TensionCheck, TheCommentHasAtMostFourLinesOfFortyBytesAndHundredSixtyInAll)
{
    const std::string twentyKanji = "一二三四五六七八九十一二三四五六七八九十";
    const std::string line40(40, 'c');
    struct Case
    {
        const char* what;
        std::string comment;
        const char* message; // null: accepted
    };
    const Case cases[] = {
        {"four lines", "a\nb\nc\nd", nullptr},
        {"five lines", "a\nb\nc\nd\ne", "ファイルコメント エラー[行数を 4 以内にしてください]"},
        {"five lines whose last is empty inside the value", "a\nb\nc\nd\n\n.",
         "ファイルコメント エラー[行数を 4 以内にしてください]"},
        {"a line of 40 bytes", line40, nullptr},
        {"a line of 41 bytes", line40 + "c",
         "ファイルコメント エラー[1行の文字数を 40 以内にしてください]"},
        {"carriage returns do not count", line40 + "\r\n" + line40, nullptr},
        {"20 double-byte characters", twentyKanji, nullptr},
        {"21 double-byte characters", twentyKanji + "一",
         "ファイルコメント エラー[1行の文字数を 40 以内にしてください]"},
        {"160 bytes in four lines",
         line40 + "\n" + line40 + "\n" + line40 + "\n" + std::string(37, 'c'), nullptr},
        {"161 bytes fail before the line checks", std::string(161, 'c'),
         "ファイルコメント エラー[文字数を 160 以内にしてください]"},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, Named("FC:" + c.comment + ";"), 200.0);
        EXPECT_EQ(outcome.accepted, c.message == nullptr) << c.what;
        EXPECT_EQ(outcome.log, c.message == nullptr ? "" : Lines({c.message, kIsCorrectError}))
            << c.what;
    }
}

TEST(TensionCheck, HiAndClimaxTimesAreLimitedByTheMusicLength)
{
    struct Case
    {
        const char* what;
        double seconds;
        std::string entries;
        std::string log;
    };
    const Case cases[] = {
        {"Hi 20 s of 100 s", 100.0, "LOW:10;\nHI:50;\nLOW:70;\n", ""},
        {"Hi 20.5 s of 100 s", 100.0, "LOW:10;\nHI:50;\nLOW:70.5;\n",
         Lines({"HiTension 時間オーバー[現在 20.500000 秒です 20 秒以内にしてください]",
                kIsCorrectError})},
        {"Climax 10 s of 100 s", 100.0, "LOW:10;\nCLIMAX:90;\n", ""},
        {"Climax 10.5 s of 100 s", 100.0, "LOW:10;\nCLIMAX:89.5;\n",
         Lines({"ClimaxTension 時間オーバー[現在 10.500000 秒です 10 秒以内にしてください]",
                kIsCorrectError})},
        {"Hi 19.5 s of 99.9 s: the limit is 19", 99.9, "LOW:10;\nHI:50;\nLOW:69.5;\n",
         Lines({"HiTension 時間オーバー[現在 19.500000 秒です 19 秒以内にしてください]",
                kIsCorrectError})},
        {"Low and Normal have no time limit", 480.0, "LOW:1;\n", ""},
    };
    for (const Case& c : cases)
    {
        const Outcome outcome = Parse(Named(c.entries), c.seconds);
        EXPECT_EQ(outcome.accepted, c.log.empty()) << c.what;
        EXPECT_EQ(outcome.log, c.log) << c.what;
    }
}

TEST(TensionCheck, EachLevelHasAMaximumNumberOfSegments)
{
    // `count` entries of a level one second apart from second 10 on, then
    // one entry of the closing level: `count` segments of the level.
    const auto repeat = [](const char* level, int count, const char* closing)
    {
        std::string entries;
        for (int i = 0; i < count; ++i)
            entries += std::string(level) + ":" + std::to_string(10 + i) + ";\n";
        return entries + closing + ":" + std::to_string(10 + count) + ";\n";
    };
    struct Case
    {
        const char* what;
        std::string entries;
        std::string log;
    };
    const Case cases[] = {
        {"ten Normal segments, the first from 0 among them", repeat("NORMAL", 9, "LOW"), ""},
        {"eleven Normal segments", repeat("NORMAL", 10, "LOW"),
         Lines({"NormalTension 回数オーバー[現在 11 回です 10 回以内にしてください]",
                kIsCorrectError})},
        {"four Hi segments", repeat("HI", 4, "LOW"), ""},
        {"five Hi segments", repeat("HI", 5, "LOW"),
         Lines({"HiTension 回数オーバー[現在 5 回です 4 回以内にしてください]", kIsCorrectError})},
        {"two Climax segments", repeat("CLIMAX", 2, "LOW"), ""},
        {"three Climax segments", repeat("CLIMAX", 3, "LOW"),
         Lines({"ClimaxTension 回数オーバー[現在 3 回です 2 回以内にしてください]",
                kIsCorrectError})},
        {"four Low segments", repeat("LOW", 4, "NT"), ""},
        {"five Low segments", repeat("LOW", 5, "NT"),
         Lines({"LowTension 回数オーバー[現在 5 回です 4 回以内にしてください]", kIsCorrectError})},
    };
    for (const Case& c : cases)
    {
        const Outcome outcome = Parse(Named(c.entries), 200.0);
        EXPECT_EQ(outcome.accepted, c.log.empty()) << c.what;
        EXPECT_EQ(outcome.log, c.log) << c.what;
    }
}

TEST(TensionCheck, LowMustLastAtLeastAsLongAsHi)
{
    const Outcome noLow = Parse(Named("HI:10;\nNT:20;\n"), 200.0);
    EXPECT_FALSE(noLow.accepted);
    EXPECT_EQ(
        noLow.log,
        Lines(
            {"LowTension 時間不足[現在 0.000000 秒です HiTension 時間の 10.000000 秒以上必要です]",
             kIsCorrectError}));
    const Outcome equal = Parse(Named("HI:10;\nNT:20;\nLOW:30;\nNT:40;\n"), 200.0);
    EXPECT_TRUE(equal.accepted) << equal.log;
}

TEST(TensionCheck, EveryFailingCheckRecordsItsOwnMessageInOrder)
{
    std::string entries = "FC:" + std::string(170, 'c') + ";\n";
    for (int i = 0; i < 6; ++i)
        entries +=
            "HI:" + std::to_string(10 + 20 * i) + ";\nNT:" + std::to_string(20 + 20 * i) + ";\n";
    entries += "CLIMAX:140;\nNT:170;\n";
    const Outcome outcome = Parse(entries, 200.0);
    EXPECT_FALSE(outcome.accepted);
    EXPECT_EQ(
        outcome.log,
        Lines(
            {"ファイル名 エラー[ファイル名を 1 ～ 40 文字以内にしてください]",
             "ファイルコメント エラー[文字数を 160 以内にしてください]",
             "HiTension 時間オーバー[現在 60.000000 秒です 40 秒以内にしてください]",
             "HiTension 回数オーバー[現在 6 回です 4 回以内にしてください]",
             "ClimaxTension 時間オーバー[現在 30.000000 秒です 20 秒以内にしてください]",
             "LowTension 時間不足[現在 0.000000 秒です HiTension 時間の 60.000000 秒以上必要です]",
             kIsCorrectError}));
}

TEST(TensionQuery, TheTensionIsTheLevelOfTheLastKeyAtOrBeforeTheTime)
{
    CTensionFile file;
    EXPECT_EQ(file.GetTension(10.0f), TensionLevel::Normal) << "before any parse";
    ASSERT_TRUE(
        Parse(file, Named("LOW:30;\nHI:60;\nLOW:90;\nCLIMAX:165;\nCF:170;\n"), 180.0).accepted);
    struct Case
    {
        float time;
        TensionLevel level;
    };
    const Case cases[] = {
        {0.0f, TensionLevel::Normal},       {29.9f, TensionLevel::Normal},
        {30.0f, TensionLevel::Low},         {60.0f, TensionLevel::Hi},
        {89.0f, TensionLevel::Hi},          {90.0f, TensionLevel::Low},
        {165.0f, TensionLevel::Climax},     {179.9f, TensionLevel::Climax},
        {180.0f, TensionLevel::Normal},     {-1.0f, TensionLevel::Normal},
        {180.0f + 61.0f, TensionLevel::Hi}, // folded from the loop start 0: 61 s
    };
    for (const Case& c : cases)
        EXPECT_EQ(file.GetTension(c.time), c.level) << c.time;

    file.SetLoopStart(60.0f);
    EXPECT_EQ(file.GetTension(180.0f + 35.0f), TensionLevel::Low) << "folded to 60 + 35 = 95 s";
    EXPECT_EQ(file.GetTension(180.0f + 125.0f), TensionLevel::Hi) << "folded to 60 + 5 = 65 s";
}

TEST(TensionQuery, TheFinalePlaysForAFiftiethOfTheMusicInsideClimax)
{
    CTensionFile file;
    ASSERT_TRUE(
        Parse(file, Named("LOW:30;\nHI:60;\nLOW:90;\nCLIMAX:165;\nCF:170;\n"), 180.0).accepted);
    EXPECT_FALSE(file.IsFinale(169.9f));
    EXPECT_TRUE(file.IsFinale(170.0f));
    EXPECT_TRUE(file.IsFinale(173.5f));
    EXPECT_FALSE(file.IsFinale(173.7f));
    EXPECT_TRUE(file.IsFinale(180.0f + 171.0f)) << "folded into the loop";

    CTensionFile outsideClimax;
    ASSERT_TRUE(Parse(outsideClimax, Named("LOW:30;\nCF:40;\n"), 180.0).accepted);
    EXPECT_FALSE(outsideClimax.IsFinale(41.0f));
}

TEST(TensionFileObject, CopiesAreDeepAndReleasingTheTimelineMayRunTwice)
{
    CTensionFile file;
    ASSERT_TRUE(Parse(file, Named("FC:c;\nLOW:30;\nCF:20;\n"), 180.0).accepted);
    CTensionFile copy(file);
    EXPECT_NE(copy.GetTimeline(), file.GetTimeline());
    ASSERT_EQ(copy.GetTimeline()->GetKeyCount(), 3u);
    EXPECT_STREQ(copy.GetName().CStr(), "x");
    EXPECT_STREQ(copy.GetComment().CStr(), "c");
    EXPECT_EQ(copy.GetFinaleTime(), 20.0f);
    EXPECT_EQ(copy.GetFinaleWindow(), file.GetFinaleWindow());
    EXPECT_TRUE(file.ReleaseTimeline());
    EXPECT_TRUE(file.ReleaseTimeline());
    EXPECT_EQ(file.GetTimeline(), nullptr);
    EXPECT_EQ(copy.GetTimeline()->GetKeyCount(), 3u);
    EXPECT_EQ(file.GetTension(40.0f), TensionLevel::Normal);
}
