// Loading tension files from disk and from pack archives, with the messages
// each way of failing leaves.
#include "base/memory.h"
#include "tests/support/temp_folder.h"
#include "tests/tension/tension_support.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <string>

using tension::CqvxPackFile;
using tension::CqvxPackFileList;
using tension::CTensionFile;
using tension::CTextString;
using tension_testing::Lines;
using tension_testing::Music;
using testing_support::TempFolder;

namespace
{

constexpr const char* kCannotOpen = "ファイルが開けません!!";
constexpr const char* kConversionError = "変換エラー!!";
constexpr const char* kIsCorrectError = "Time Data IsCorrect Error!!";
const std::string kNameMessage = "ファイル名 エラー[ファイル名を 1 ～ 40 文字以内にしてください]";

const std::string kWorkedExample =
    "FILENAME : Test;\nLOW : 30;\nHI : 60;\nLOW : 90;\nCLIMAX : 165;\nFINALE : 170;\n";

void WriteText(const std::string& path, const std::string& text)
{
    testing_support::WriteBytes(path, std::vector<std::uint8_t>(text.begin(), text.end()));
}

// Tension files named relative to a fresh working folder, so that the path
// that stands in for a missing name is short on every platform.
class TensionLoadTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        previous_ = std::filesystem::current_path();
        std::filesystem::current_path(folder_.Path());
    }
    void TearDown() override { std::filesystem::current_path(previous_); }

    struct Result
    {
        bool loaded;
        std::string log;
    };

    Result Load(CTensionFile& file, const std::string& path, double seconds)
    {
        CTextString log;
        const bool loaded = file.LoadFromFile(Music(seconds), path.c_str(), &log);
        return Result{loaded, log.CStr()};
    }

    TempFolder folder_;
    std::filesystem::path previous_;
};

} // namespace

TEST_F(TensionLoadTest, TheWorkedExampleLoadsFromAFile)
{
    WriteText("example.txt", kWorkedExample);
    CTensionFile file;
    const Result result = Load(file, "example.txt", 180.0);
    EXPECT_TRUE(result.loaded);
    EXPECT_EQ(result.log, "");
    EXPECT_STREQ(file.GetName().CStr(), "Test");
    EXPECT_EQ(file.GetSound(), Music(180.0));
    EXPECT_EQ(file.GetTimeline()->GetKeyCount(), 6u);
}

TEST_F(TensionLoadTest, LinesMayEndInCarriageReturnAndLineFeed)
{
    std::string crlf;
    for (const char c : kWorkedExample + "FC: one\ntwo;\n")
        crlf += c == '\n' ? std::string("\r\n") : std::string(1, c);
    WriteText("crlf.txt", crlf);
    CTensionFile file;
    const Result result = Load(file, "crlf.txt", 180.0);
    EXPECT_TRUE(result.loaded) << result.log;
    const std::string comment = file.GetComment().CStr();
    EXPECT_TRUE(comment == "one\ntwo" || comment == "one\r\ntwo") << comment;
}

TEST_F(TensionLoadTest, AFileThatCannotBeOpenedLeavesOneMessageAndNothingElse)
{
    std::filesystem::create_directory("folder");
    for (const char* path : {"missing.txt", "", "folder"})
    {
        CTensionFile file;
        const Result result = Load(file, path, 180.0);
        EXPECT_FALSE(result.loaded) << path;
        EXPECT_EQ(result.log, Lines({kCannotOpen})) << path;
        EXPECT_STREQ(file.GetName().CStr(), "") << path;
        EXPECT_EQ(file.GetSound(), nullptr) << path;
        EXPECT_EQ(file.GetTimeline(), nullptr) << path;
    }
    CTensionFile file;
    CTextString log;
    EXPECT_FALSE(file.LoadFromFile(Music(180.0), nullptr, &log));
    EXPECT_EQ(std::string(log.CStr()), Lines({kCannotOpen}));
}

TEST_F(TensionLoadTest, AFileWithoutEntriesTakesItsPathForTheName)
{
    WriteText("empty.txt", "");
    WriteText("comments.txt", "// nothing but\n/* comments */\n");
    for (const char* path : {"empty.txt", "comments.txt"})
    {
        CTensionFile file;
        const Result result = Load(file, path, 120.0);
        EXPECT_TRUE(result.loaded) << path;
        EXPECT_STREQ(file.GetName().CStr(), path);
        EXPECT_EQ(file.GetTimeline()->GetKeyCount(), 2u) << "one Normal segment";
    }
    const std::string longPath = std::string(37, 'p') + ".txt"; // 41 bytes
    WriteText(longPath, "");
    CTensionFile file;
    const Result result = Load(file, longPath, 120.0);
    EXPECT_FALSE(result.loaded);
    EXPECT_EQ(result.log, Lines({kNameMessage.c_str(), kIsCorrectError, kConversionError}));
}

TEST_F(TensionLoadTest, FailuresOfTheParseEndWithTheConversionMessage)
{
    WriteText("twice.txt", "NAME:x;\nCF:100;\nCF:110;\n");
    CTensionFile file;
    const Result twice = Load(file, "twice.txt", 180.0);
    EXPECT_FALSE(twice.loaded);
    EXPECT_EQ(
        twice.log,
        Lines({"クライマックスフィナーレ エラー[クライマックスフィナーレが複数指定されています]",
               kIsCorrectError, kConversionError}));

    WriteText("open.txt", "NAME:x;\n/* never closed\n");
    const Result open = Load(file, "open.txt", 180.0);
    EXPECT_FALSE(open.loaded);
    EXPECT_EQ(open.log, Lines({kConversionError}));

    WriteText("short.txt", "NAME:x;\n");
    const Result shortMusic = Load(file, "short.txt", 59.0);
    EXPECT_EQ(
        shortMusic.log,
        Lines(
            {"ファイル時間 エラー[59.000000秒のファイルです : 60秒以上の長さのファイルが必要です]",
             kIsCorrectError, kConversionError}));
}

TEST_F(TensionLoadTest, AnUnrecognisedKeyAloneIsOnlyAWarning)
{
    WriteText("odd.txt", "SPEED: 3;\n");
    CTensionFile file;
    const Result result = Load(file, "odd.txt", 120.0);
    EXPECT_TRUE(result.loaded);
    EXPECT_EQ(result.log, Lines({"Time Data Not Tension!!"}));
}

// A file cut anywhere loads as the text it still holds; a zero byte ends the
// text wherever it comes, whatever follows it.
TEST_F(TensionLoadTest, AFileCutAnywhereOrHoldingAZeroLoadsAsTheTextBeforeIt)
{
    const std::string text = "ファイル名:曲;\nLOW:30;\nHI:60;\nLOW:90;\nCLIMAX:165;\nFINALE:170;\n";
    for (std::size_t cut = 0; cut <= text.size(); ++cut)
    {
        const std::string before = text.substr(0, cut);
        WriteText("cut.txt", before);
        WriteText("zero.txt", before + std::string(1, '\0') + "NAME:" + text.substr(cut));
        CTensionFile cutFile;
        const Result cutResult = Load(cutFile, "cut.txt", 180.0);
        CTensionFile zeroFile;
        const Result zeroResult = Load(zeroFile, "zero.txt", 180.0);
        EXPECT_EQ(zeroResult.loaded, cutResult.loaded) << "cut at " << cut;
        EXPECT_EQ(zeroResult.log, cutResult.log) << "cut at " << cut;
        EXPECT_EQ(zeroFile.GetTimeline()->GetKeyCount(), cutFile.GetTimeline()->GetKeyCount())
            << "cut at " << cut;
    }
    CTensionFile whole;
    EXPECT_TRUE(Load(whole, "cut.txt", 180.0).loaded);
    EXPECT_STREQ(whole.GetName().CStr(), "曲");
}

// Windows refuses paths of MAX_PATH (260) bytes and more to a program that
// does not opt in to long paths, the test's own writes included; POSIX and
// Wine take them. Whatever the test could write loads as itself, and a path
// that stands in for a missing name is too long for one.
TEST_F(TensionLoadTest, PathsOf259260And300BytesLoadTheFileTheyName)
{
    for (const std::size_t length : {259u, 260u, 300u})
    {
        for (const bool named : {true, false})
        {
            const std::string path = testing_support::PathOfLength(folder_, length, ".txt");
            if (!path.empty())
                WriteText(path, named ? "NAME:long;\nLOW:30;\n" : "LOW:30;\n");
            CTensionFile file;
            const Result result = Load(file, path, 180.0);
            const bool written = !path.empty() && std::filesystem::exists(path);
            ASSERT_TRUE(written || length > 259) << "every platform takes 259 bytes";
            if (!written)
            {
                EXPECT_EQ(result.log, Lines({kCannotOpen})) << length;
                continue;
            }
            EXPECT_EQ(result.loaded, named) << length;
            EXPECT_STREQ(file.GetName().CStr(), named ? "long" : path.c_str()) << length;
            EXPECT_EQ(file.GetTimeline()->GetKeyCount(), 3u) << length;
        }
    }
}

// The message itself needs memory: when nothing more can be had, the load
// fails without it.
TEST_F(TensionLoadTest, AFailedTextBufferFailsTheLoad)
{
    WriteText("example.txt", kWorkedExample);
    Music(180.0);
    CTensionFile file;
    CTextString log;
    bool loaded;
    {
        base::ScopedAllocationFailure failure(1); // the name's copy succeeds
        loaded = file.LoadFromFile(Music(180.0), "example.txt", &log);
    }
    EXPECT_FALSE(loaded);
    EXPECT_STREQ(file.GetName().CStr(), "example.txt");
    EXPECT_EQ(file.GetTimeline(), nullptr);
}

namespace
{

// An archive that holds the entry but cannot deliver its bytes.
class UnreadableArchive : public CqvxPackFile
{
public:
    bool GetEntryBytes(std::int32_t, const std::uint8_t**, std::uint32_t*) const override
    {
        return false;
    }
};

} // namespace

TEST(TensionArchive, LoadsAnEntryByItsExactName)
{
    CqvxPackFile archive;
    ASSERT_TRUE(archive.AddEntry("bgm/one.txt", kWorkedExample.data(),
                                 static_cast<std::uint32_t>(kWorkedExample.size())));
    CTensionFile file;
    CTextString log;
    ASSERT_TRUE(file.LoadFromArchive(Music(180.0), "bgm/one.txt", &archive, &log));
    EXPECT_STREQ(file.GetName().CStr(), "Test") << "the entry's own name entry wins";
    EXPECT_EQ(file.GetSound(), Music(180.0));

    CTensionFile unnamed;
    ASSERT_TRUE(archive.AddEntry("two", "LOW:30;", 7));
    ASSERT_TRUE(unnamed.LoadFromArchive(Music(180.0), "two", &archive, &log));
    EXPECT_STREQ(unnamed.GetName().CStr(), "two");
}

TEST(TensionArchive, EachFailureLeavesItsMessage)
{
    CqvxPackFile archive;
    archive.AddEntry("bad", "CF:1;\nCF:2;\n", 12);
    UnreadableArchive unreadable;
    unreadable.AddEntry("x", "", 0);
    struct Case
    {
        const char* what;
        const char* entry;
        const CqvxPackFile* archive;
        std::string log;
    };
    const Case cases[] = {
        {"no entry of that name", "BAD", &archive, Lines({kCannotOpen})},
        {"bytes the archive cannot deliver", "x", &unreadable, Lines({kCannotOpen})},
        {"no archive", "bad", nullptr, Lines({kCannotOpen})},
        {"a failed parse", "bad", &archive,
         Lines({"クライマックスフィナーレ エラー[クライマックスフィナーレが複数指定されています]",
                kIsCorrectError, "File Buffer Conversion Error!!"})},
    };
    for (const Case& c : cases)
    {
        CTensionFile file;
        CTextString log;
        EXPECT_FALSE(file.LoadFromArchive(Music(180.0), c.entry, c.archive, &log)) << c.what;
        EXPECT_EQ(std::string(log.CStr()), c.log) << c.what;
    }
}

TEST(TensionArchive, TheListIsTriedInOrderUntilOneSucceeds)
{
    CqvxPackFile without;
    without.AddEntry("other", "NAME:o;", 7);
    CqvxPackFile failing;
    failing.AddEntry("song", "NAME:f;\nCF:1;\nCF:2;\n", 20);
    CqvxPackFile good;
    good.AddEntry("song", "NAME:good;", 10);
    CqvxPackFile later;
    later.AddEntry("song", "NAME:later;", 11);

    const CqvxPackFile* archives[] = {&without, nullptr, &failing, &good, &later};
    CTensionFile file;
    CTextString log;
    ASSERT_TRUE(
        file.LoadFromArchiveList(Music(180.0), "song", CqvxPackFileList{archives, 5}, &log));
    EXPECT_STREQ(file.GetName().CStr(), "good");
    EXPECT_NE(std::string(log.CStr()).find("File Buffer Conversion Error!!"), std::string::npos)
        << "the failing archive was tried first";

    EXPECT_FALSE(
        file.LoadFromArchiveList(Music(180.0), nullptr, CqvxPackFileList{archives, 5}, &log));
    EXPECT_FALSE(without.AddEntry(nullptr, "", 0));

    const CqvxPackFile* none[] = {&without};
    CTensionFile missing;
    CTextString quiet;
    EXPECT_FALSE(
        missing.LoadFromArchiveList(Music(180.0), "song", CqvxPackFileList{none, 1}, &quiet));
    EXPECT_EQ(std::string(quiet.CStr()), "") << "archives without the entry are not asked";
}
