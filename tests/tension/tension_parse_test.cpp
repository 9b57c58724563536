// Parsing tension files: entries, keys, values, comments, and the end of
// the text wherever it comes.
#include "tests/tension/tension_support.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

using tension::CTensionFile;
using tension::TensionLevel;
using tension_testing::Lines;
using tension_testing::Outcome;
using tension_testing::Parse;

namespace
{

constexpr const char* kNotTension = "Time Data Not Tension!!";
constexpr const char* kOutsideRange = "Time Data Outside Range!!";
constexpr const char* kKeyAddError = "Time Data KeyAdd Error!!";
constexpr const char* kIsCorrectError = "Time Data IsCorrect Error!!";

struct Key
{
    float time;
    TensionLevel level;
    bool operator==(const Key& other) const { return time == other.time && level == other.level; }
};

std::ostream& operator<<(std::ostream& out, const Key& key)
{
    return out << "(" << key.time << ", " << static_cast<int>(key.level) << ")";
}

std::vector<Key> Keys(const CTensionFile& file)
{
    std::vector<Key> keys;
    const tension::CKeyFrameList* timeline = file.GetTimeline();
    for (std::uint32_t i = 0; timeline != nullptr && i < timeline->GetKeyCount(); ++i)
    {
        const tension::KeyFrame* key = timeline->GetKey(i);
        keys.push_back({key->time, static_cast<TensionLevel>(key->value)});
        EXPECT_EQ(key->ease, 0.0f);
    }
    return keys;
}

constexpr TensionLevel L = TensionLevel::Low;
constexpr TensionLevel N = TensionLevel::Normal;
constexpr TensionLevel H = TensionLevel::Hi;
constexpr TensionLevel C = TensionLevel::Climax;

const std::string kWorkedExample = "FILENAME : Test;\n"
                                   "LOW : 30;\n"
                                   "HI : 60;\n"
                                   "LOW : 90;\n"
                                   "CLIMAX : 165;\n"
                                   "FINALE : 170;\n";

} // namespace

TEST(TensionParse, TheWorkedExampleIsAccepted)
{
    CTensionFile file;
    const Outcome outcome = Parse(file, kWorkedExample, 180.0);
    EXPECT_TRUE(outcome.accepted);
    EXPECT_EQ(outcome.log, "");
    EXPECT_EQ(Keys(file),
              (std::vector<Key>{{0, N}, {30, L}, {60, H}, {90, L}, {165, C}, {180, N}}));
    EXPECT_STREQ(file.GetName().CStr(), "Test");
    EXPECT_EQ(file.GetFinaleTime(), 170.0f);
    EXPECT_EQ(file.GetFinaleWindow(), static_cast<float>(180.0 * double(0.1f) * double(0.2f)));
    EXPECT_NEAR(file.GetFinaleWindow(), 3.6f, 1e-6);
    EXPECT_STREQ(file.GetTimeline()->GetName(), "Tension");
}

TEST(TensionParse, TheWorkedExampleWithClimaxAt150FailsOnTheClimaxTime)
{
    std::string text = kWorkedExample;
    text.replace(text.find("165"), 3, "150");
    const Outcome outcome = Parse(text, 180.0);
    EXPECT_FALSE(outcome.accepted);
    EXPECT_EQ(outcome.log,
              Lines({"ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]",
                     kIsCorrectError}));
}

TEST(TensionParse, EveryKeyOfTheTableNamesItsEntry)
{
    const char* const levelKeys[4][5] = {
        {"ローテンション", "ロー", "LOW", "LOWTENSION", "LT"},
        {"ノーマルテンション", "ノーマル", "NORMAL", "NORMALTENSION", "NT"},
        {"ハイテンション", "ハイ", "HI", "HITENSION", "HT"},
        {"クライマックステンション", "クライマックス", "CLIMAX", "CLIMAXTENSION", "CT"},
    };
    for (int level = 0; level < 4; ++level)
    {
        for (const char* key : levelKeys[level])
        {
            CTensionFile file;
            const Outcome outcome = Parse(file, std::string("NAME:x;\n") + key + ":100;\n", 200.0);
            EXPECT_EQ(outcome.log.find(kNotTension), std::string::npos) << key;
            ASSERT_EQ(Keys(file).size(), 3u) << key;
            EXPECT_EQ(Keys(file)[1], (Key{100, static_cast<TensionLevel>(level)})) << key;
            EXPECT_EQ(file.GetTensionIndex(key), level);
        }
    }
    for (const char* key : {"ファイル名", "名前", "NAME", "FILENAME", "FN"})
    {
        CTensionFile file;
        Parse(file, std::string(key) + ":曲名;\n", 200.0);
        EXPECT_STREQ(file.GetName().CStr(), "曲名") << key;
        EXPECT_TRUE(file.IsFileNameKey(key));
    }
    for (const char* key : {"ファイルコメント", "コメント", "COMMENT", "FILECOMMENT", "FC"})
    {
        CTensionFile file;
        Parse(file, std::string(key) + ":説明;\n", 200.0);
        EXPECT_STREQ(file.GetComment().CStr(), "説明") << key;
        EXPECT_TRUE(file.IsCommentKey(key));
    }
    for (const char* key :
         {"クライマックスフィナーレ", "フィナーレ", "FINALE", "CLIMAXFINALE", "CF"})
    {
        CTensionFile file;
        Parse(file, std::string(key) + ":123.5;\n", 200.0);
        EXPECT_EQ(file.GetFinaleTime(), 123.5f) << key;
        EXPECT_TRUE(file.IsFinaleKey(key));
    }
    CTensionFile file;
    EXPECT_EQ(file.GetTensionIndex("NAME"), 4);
    EXPECT_FALSE(file.IsFinaleKey("LOW"));
}

TEST(TensionParse, KeysIgnoreTheCaseOfAsciiLettersOnly)
{
    struct Case
    {
        const char* key;
        bool names;
    };
    const Case cases[] = {
        {"low", true},          {"Low", true},           {"lOw", true},
        {"LOW TENSION", false}, {"LOW\tTENSION", false}, {"ＬＯＷ", false},
        {"ろー", false},        {"LOWT", false},         {"", false},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, std::string("NAME:x;\n") + c.key + ":100;\n", 200.0);
        EXPECT_EQ(Keys(file).size(), c.names ? 3u : 2u) << c.key;
        EXPECT_EQ(outcome.log, c.names ? "" : Lines({kNotTension})) << c.key;
        EXPECT_TRUE(outcome.accepted) << c.key;
    }
}

TEST(TensionParse, BlanksAroundKeysAndValuesAreIgnored)
{
    CTensionFile file;
    const Outcome outcome =
        Parse(file, " \t\r\n\v NAME \t : \r\n  My Song \t\n;\n\n   LOW\t:\t 30 \n ;", 200.0);
    EXPECT_TRUE(outcome.accepted) << outcome.log;
    EXPECT_STREQ(file.GetName().CStr(), "My Song");
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {30, L}, {200, N}}));
}

TEST(TensionParse, InsideAValueLineBreaksSeparatorsAndCommentMarksAreText)
{
    CTensionFile file;
    const Outcome outcome =
        Parse(file, "NAME:x;\nCOMMENT: line one\r\nline: 2 // no /* no */;\n", 200.0);
    EXPECT_TRUE(outcome.accepted) << outcome.log;
    EXPECT_STREQ(file.GetComment().CStr(), "line one\r\nline: 2 // no /* no */");
}

TEST(TensionParse, CommentsAreSkippedWhereKeysAreRead)
{
    CTensionFile file;
    const Outcome outcome = Parse(file,
                                  "// a tension file\n"
                                  "NAME:x; // the name\n"
                                  "/* several\n lines; LOW: 50; */\n"
                                  "LO/* joined */W: 30;\n"
                                  "HI // split\n"
                                  ": 40;\n"
                                  "LOW: 45;\n",
                                  200.0);
    EXPECT_TRUE(outcome.accepted) << outcome.log;
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {30, L}, {40, H}, {45, L}, {200, N}}));
}

TEST(TensionParse, AnUnterminatedBlockCommentFailsAtOnceWithoutAMessage)
{
    for (const char* text :
         {"NAME:x;\n/* never closed", "NAME:x;\n/* ends in a lead byte \x81", "/*", "/*/"})
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, text, 200.0);
        EXPECT_FALSE(outcome.accepted) << text;
        EXPECT_EQ(outcome.log, "") << text;
    }
}

TEST(TensionParse, TimesOutsideTheMusicAreDroppedWithAWarning)
{
    for (const char* value : {"0", "200", "250", "-5", "abc", "", "1e9", "nan"})
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, std::string("NAME:x;\nLOW:") + value + ";\n", 200.0);
        EXPECT_TRUE(outcome.accepted) << value;
        EXPECT_EQ(outcome.log, Lines({kOutsideRange})) << value;
        EXPECT_EQ(Keys(file).size(), 2u) << value;
    }
    CTensionFile file;
    Parse(file, "NAME:x;\nLOW: 12.5 seconds;\nHI: 7abc;\n", 200.0);
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {7, H}, {12.5f, L}, {200, N}}))
        << "a leading number is read as atof reads it";
}

TEST(TensionParse, KeysCloserThanSixMillisecondsAreRefused)
{
    struct Case
    {
        const char* text;
        std::size_t keys;
        std::string log;
    };
    const Case cases[] = {
        {"LOW:50;\nLOW:50.005;\n", 3, Lines({kKeyAddError})},
        {"LOW:50;\nLOW:50.007;\n", 4, ""},
        {"HI:199.995;\n", 2, Lines({kKeyAddError})},
        {"HI:0.005;\n", 2, Lines({kKeyAddError})},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, std::string("NAME:x;\n") + c.text, 200.0);
        EXPECT_EQ(Keys(file).size(), c.keys) << c.text;
        EXPECT_EQ(outcome.log, c.log) << c.text;
    }
}

TEST(TensionParse, EntriesNeedNotBeInTimeOrder)
{
    CTensionFile file;
    const Outcome outcome = Parse(file, "NAME:x;\nLOW:90;\nHI:60;\nLOW:30;\n", 180.0);
    EXPECT_TRUE(outcome.accepted) << outcome.log;
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {30, L}, {60, H}, {90, L}, {180, N}}));
}

TEST(TensionParse, OnlySomeEntriesPassOverTheCharacterAfterTheirTerminator)
{
    struct Case
    {
        const char* what;
        const char* text;
        std::vector<Key> keys;
        std::string log;
    };
    const Case cases[] = {
        {"a file name followed directly by a level entry",
         "NAME:x;LOW:30;\n",
         {{0, N}, {200, N}},
         Lines({kNotTension})},
        {"a comment followed directly by a level entry",
         "NAME:x;\nFC:c;LOW:30;\n",
         {{0, N}, {200, N}},
         Lines({kNotTension})},
        {"a finale followed directly by a level entry",
         "NAME:x;\nCF:150;LOW:30;\n",
         {{0, N}, {200, N}},
         Lines({kNotTension})},
        {"the lost character may be a blank", "NAME:x; LOW:30;\n", {{0, N}, {30, L}, {200, N}}, ""},
        {"an accepted level entry leaves the next one whole",
         "NAME:x;\nLOW:30;HI:20;\n",
         {{0, N}, {20, H}, {30, L}, {200, N}},
         ""},
        {"a dropped level entry passes over one character too",
         "NAME:x;\nLOW:0;HI:20;\n",
         {{0, N}, {200, N}},
         Lines({kOutsideRange, kNotTension})},
        {"an unrecognised entry leaves the next one whole",
         "NAME:x;\nFOO:1;HI:20;\nLOW:25;\n",
         {{0, N}, {20, H}, {25, L}, {200, N}},
         Lines({kNotTension})},
        {"a double-byte character after the terminator is passed over whole",
         "NAME:x;ロLOW:30;\n",
         {{0, N}, {30, L}, {200, N}},
         ""},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, c.text, 200.0);
        EXPECT_EQ(Keys(file), c.keys) << c.what;
        EXPECT_EQ(outcome.log, c.log) << c.what;
    }
}

TEST(TensionParse, TextWithoutASeparatorIsIgnored)
{
    CTensionFile file;
    const Outcome outcome = Parse(file, "NAME:x;\nthis line has no separator\nLOW", 200.0);
    EXPECT_TRUE(outcome.accepted);
    EXPECT_EQ(outcome.log, "");
}

TEST(TensionParse, AnUnrecognisedKeyWithoutTerminatorEndsTheScan)
{
    CTensionFile file;
    const Outcome outcome = Parse(file, "NAME:x;\nLOW:30;\nFOO: 1\nHI:40;\n", 200.0);
    EXPECT_TRUE(outcome.accepted);
    EXPECT_EQ(outcome.log, Lines({kNotTension}));
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {30, L}, {200, N}}))
        << "the skip runs to the next terminator, swallowing the HI entry";

    CTensionFile open;
    const Outcome end = Parse(open, "NAME:x;\nFOO: 1", 200.0);
    EXPECT_TRUE(end.accepted);
    EXPECT_EQ(end.log, Lines({kNotTension}));
}

TEST(TensionParse, DoubleByteCharactersAreNeverSplitNorUpperCased)
{
    CTensionFile file;
    // "\x81" takes the ";" after it as its trail byte: the value runs on.
    Parse(file, "NAME:a\x81;b;\nハイ:20;\nLOW:25;\n", 200.0);
    EXPECT_STREQ(file.GetName().CStr(), "a\x81;b");
    // The trail bytes of "ハイ" (0x6E, 0x43) include a lower-case letter.
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {20, H}, {25, L}, {200, N}}));

    CTensionFile separator;
    Parse(separator, "NAME:x;\nLOW\x81:30;\n", 200.0);
    EXPECT_EQ(Keys(separator).size(), 2u) << "a lead byte swallows the separator";
}

// The Part's scan would take a lead byte at the end of the text together
// with the terminating zero and read on past it; here the end of the text
// ends the scan wherever it comes. Each text lies in a block of exactly its
// size, so that AddressSanitizer reports any read beyond it.
TEST(TensionParse, ALeadByteBeforeTheEndOfTheTextEndsTheScan)
{
    struct Case
    {
        const char* where;
        const char* text;
        bool accepted;
        std::string log;
    };
    const Case cases[] = {
        {"in a key", "NAME:x;\nLOW\x81", true, ""},
        {"in a key right after the name", "NAME:x;\n\x81", true, ""},
        {"as the character passed over", "NAME:x;\x81", true, ""},
        {"in a file-name value", "NAME:x;\nNAME:y\x81", true, ""},
        {"in a comment value", "NAME:x;\nFC:c\x81", true, ""},
        {"in a time value", "NAME:x;\nLOW: 30\x81", true, Lines({kOutsideRange})},
        {"in a finale value", "NAME:x;\nCF: 30\x81", true, ""},
        {"in the skip after an unrecognised key", "NAME:x;\nFOO: 1\x81", true,
         Lines({kNotTension})},
        {"in a line comment", "NAME:x;\n// note \x81", true, ""},
        {"after a line comment mark", "NAME:x;\n//\x81", true, ""},
        {"in a block comment", "NAME:x;\n/* \x81", false, ""},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, c.text, 200.0);
        EXPECT_EQ(outcome.accepted, c.accepted) << c.where;
        EXPECT_EQ(outcome.log, c.log) << c.where;
        EXPECT_STREQ(file.GetName().CStr(), "x") << c.where;
    }
}

TEST(TensionParse, AValueWithoutItsTerminatorEndsTheScanAndKeepsTheOldField)
{
    CTensionFile file;
    const Outcome outcome = Parse(file, "NAME:first;\nCOMMENT:kept;\nNAME: second", 200.0);
    EXPECT_TRUE(outcome.accepted);
    EXPECT_STREQ(file.GetName().CStr(), "first");
    CTensionFile comment;
    Parse(comment, "NAME:x;\nCOMMENT:kept;\nCOMMENT: lost", 200.0);
    EXPECT_STREQ(comment.GetComment().CStr(), "kept");
    CTensionFile finale;
    const Outcome finaleOutcome = Parse(finale, "NAME:x;\nCF: 100", 200.0);
    EXPECT_TRUE(finaleOutcome.accepted);
    EXPECT_EQ(finale.GetFinaleTime(), -1.0f) << "the finale takes the failed read's -1";
}

TEST(TensionParse, ALastSemicolonOfANameCommentOrFinaleEntryEndsTheScan)
{
    for (const char* text : {"NAME:x;", "NAME:x;\nFC:c;", "NAME:x;\nCF:100;"})
    {
        const Outcome outcome = Parse(text, 200.0);
        EXPECT_TRUE(outcome.accepted) << text;
        EXPECT_EQ(outcome.log, "") << text;
    }
}

TEST(TensionParse, KeysAndValuesOfAnyLengthNeverOverrunABuffer)
{
    const std::string longKey(300, 'A');
    const std::string blanks(400, ' ');
    struct Case
    {
        const char* what;
        std::string text;
        std::size_t keys;
        std::string log;
    };
    const Case cases[] = {
        {"a key of 300 letters names nothing", "NAME:x;\n" + longKey + ":30;\n", 2,
         Lines({kNotTension})},
        {"400 blanks before a key", "NAME:x;\n" + blanks + "LOW:30;\n", 3, ""},
        {"400 blanks after a key", "NAME:x;\nLOW" + blanks + ":30;\n", 3, ""},
        {"400 blanks inside a key", "NAME:x;\nLOW" + blanks + "T:30;\n", 2, Lines({kNotTension})},
        {"a time of 300 digits is a failed read", "NAME:x;\nLOW:" + std::string(298, '0') + "30;\n",
         2, Lines({kOutsideRange})},
        {"a time of 300 characters with blanks around",
         "NAME:x;\nLOW:" + blanks + "30" + blanks + ";\n", 3, ""},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        const Outcome outcome = Parse(file, c.text, 200.0);
        EXPECT_EQ(Keys(file).size(), c.keys) << c.what;
        EXPECT_EQ(outcome.log, c.log) << c.what;
    }

    CTensionFile name;
    Parse(name, "NAME:" + std::string(300, 'n') + ";\n", 200.0);
    EXPECT_EQ(name.GetName().Length(), CTensionFile::kValueCapacity - 1);
    CTensionFile doubleByte;
    std::string names;
    for (int i = 0; i < 150; ++i)
        names += "名";
    Parse(doubleByte, "NAME:" + names + ";\n", 200.0);
    EXPECT_EQ(doubleByte.GetName().Length(), CTensionFile::kValueCapacity - 2)
        << "cut before a character that does not fit whole";
}

// A long text picked by mistake (a program's source, a style sheet) logs a
// warning for each of its pieces; the check must still end at once.
TEST(TensionParse, AMessageForEachOfFortyThousandPiecesIsLoggedInLinearTime)
{
    constexpr std::size_t kPieces = 40000;
    std::string text;
    for (std::size_t i = 0; i < kPieces; ++i)
        text += "a: b;";
    const Outcome outcome = Parse("NAME:x;\n" + text, 200.0);
    EXPECT_TRUE(outcome.accepted);
    const std::string warning = std::string(kNotTension) + "\n";
    ASSERT_EQ(outcome.log.size(), kPieces * warning.size());
    EXPECT_EQ(outcome.log.substr(outcome.log.size() - warning.size()), warning);
}

TEST(TensionParse, TwoFinalesFailAfterTheChecksHaveSpoken)
{
    const Outcome outcome = Parse("CF:150;\nCLIMAX:190;\nCF:160;\n", 200.0);
    EXPECT_FALSE(outcome.accepted);
    EXPECT_EQ(
        outcome.log,
        Lines({"ファイル名 エラー[ファイル名を 1 ～ 40 文字以内にしてください]",
               "クライマックスフィナーレ エラー[クライマックスフィナーレが複数指定されています]",
               kIsCorrectError}));
}

TEST(TensionParse, EveryParseRebuildsTheTimelineAndKeepsNameAndComment)
{
    CTensionFile file;
    ASSERT_TRUE(Parse(file, "NAME:x;\nFC:c;\nCF:170;\nCLIMAX:165;\n", 180.0).accepted);
    ASSERT_TRUE(Parse(file, "LOW:30;\nCF:100;\n", 200.0).accepted)
        << "a single finale in the second parse: the count starts again";
    EXPECT_STREQ(file.GetName().CStr(), "x");
    EXPECT_STREQ(file.GetComment().CStr(), "c");
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {30, L}, {200, N}}));
    EXPECT_EQ(file.GetFinaleTime(), 100.0f);
    ASSERT_TRUE(Parse(file, "", 200.0).accepted);
    EXPECT_EQ(file.GetFinaleTime(), 0.0f);
    EXPECT_EQ(file.GetFinaleWindow(), 4.0f);
}

TEST(TensionParse, SeparatorAndTerminatorAreParameters)
{
    CTensionFile file;
    tension::CTextString log;
    ASSERT_TRUE(
        file.Parse(tension_testing::Music(200.0), "NAME=x,\nLOW=30,\nHI:40;\n", '=', ',', &log));
    EXPECT_EQ(Keys(file), (std::vector<Key>{{0, N}, {30, L}, {200, N}}));
    EXPECT_FALSE(file.Parse(tension_testing::Music(200.0), nullptr, ':', ';', &log));
}

TEST(TensionParse, ANullLogRecordsNothing)
{
    CTensionFile file;
    EXPECT_FALSE(
        file.Parse(tension_testing::Music(10.0), "FOO:1;\nLOW:0;\nCF:1;CF:2;", ':', ';', nullptr));
}

TEST(TensionParse, ParseForLengthNeedsNoMusic)
{
    CTensionFile file;
    tension::CTextString log;
    EXPECT_TRUE(file.ParseForLength(180.0f, kWorkedExample.c_str(), ':', ';', &log));
    EXPECT_EQ(Keys(file).back(), (Key{180, N}));
    std::string variant = kWorkedExample;
    variant.replace(variant.find("165"), 3, "150");
    EXPECT_FALSE(file.ParseForLength(180.0f, variant.c_str(), ':', ';', &log));
    EXPECT_EQ(std::string(log.CStr()),
              Lines({"ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]",
                     kIsCorrectError}));
}
