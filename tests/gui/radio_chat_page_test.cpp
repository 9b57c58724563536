// The Radio-chat page: twelve messages with their 全体 boxes, which store the
// inverse of the record's field, and messages longer than the record keeps.
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>

using gui::RunningTool;

namespace
{
int TextEdit(int row)
{
    return IDC_RADIO_CHAT_TEXT_FIRST + IDC_RADIO_CHAT_ROW_STEP * row;
}

int ToAllBox(int row)
{
    return IDC_RADIO_CHAT_TO_ALL_FIRST + IDC_RADIO_CHAT_ROW_STEP * row;
}

std::string TextOf(RunningTool& tool, int row)
{
    const char* text = tool.Record().RadioChat()->entries[row].text;
    return {text, strnlen(text, config::kRadioChatTextCapacity)};
}

void Store(config::RadioChatEntry& entry, const std::string& text)
{
    std::memcpy(entry.text, text.data(), text.size());
}

// "ぁ" is 82 9F in code page 932.
std::string SmallA(int count)
{
    std::string text;
    for (int i = 0; i < count; ++i)
        text += "\x82\x9F";
    return text;
}
} // namespace

TEST(RadioChatPage, ShowsTheRecordsValues)
{
    RunningTool tool(gui::SettingsWith(
        [](config::CSaveConfig& record)
        {
            Store(record.RadioChat()->entries[0], "了解！");
            Store(record.RadioChat()->entries[11], "援護を頼む");
            record.RadioChat()->entries[11].notToAll = 1;
        }));
    const HWND page = tool.Page(kRadioChatPageIndex);
    EXPECT_EQ(gui::WindowText(tool.Control(page, TextEdit(0))), "了解！");
    EXPECT_EQ(gui::WindowText(tool.Control(page, TextEdit(11))), "援護を頼む");
    EXPECT_EQ(gui::WindowText(tool.Control(page, TextEdit(5))), "");
    for (int row = 0; row < config::kRadioChatCount; ++row)
        EXPECT_EQ(gui::IsChecked(page, ToAllBox(row)), row != 11) << row;
}

TEST(RadioChatPage, EveryRowReachesItsOwnEntry)
{
    RunningTool tool;
    const HWND page = tool.Page(kRadioChatPageIndex);
    for (int row = 0; row < config::kRadioChatCount; ++row)
    {
        tool.Type(page, TextEdit(row), "メッセージF" + std::to_string(row + 1));
        tool.SetCheck(page, ToAllBox(row), row % 2 == 0);
    }
    for (int row = 0; row < config::kRadioChatCount; ++row)
    {
        EXPECT_EQ(TextOf(tool, row), "メッセージF" + std::to_string(row + 1));
        EXPECT_EQ(tool.Record().RadioChat()->entries[row].notToAll, row % 2 == 0 ? 0 : 1) << row;
    }
    tool.SetCheck(page, ToAllBox(3), true);
    EXPECT_EQ(tool.Record().RadioChat()->entries[3].notToAll, 0);
}

TEST(RadioChatPage, TextsLongerThan37BytesAreCutAsSoonAsThePageIsFilled)
{
    const struct
    {
        int row;
        std::string stored;
        std::string kept;
    } cases[] = {
        // Filling all 40 bytes leaves no terminator in the field.
        {0, std::string(40, 'A'), std::string(37, 'A')},
        {11, std::string(39, 'B'), std::string(37, 'B')},
        {4, std::string(37, 'C'), std::string(37, 'C')},
        // The 37th byte would be half of a character: the character goes.
        {5, "ab" + SmallA(18), "ab" + SmallA(17)},
        {6, "a" + SmallA(19), "a" + SmallA(18)},
    };
    RunningTool tool(gui::SettingsWith(
        [&cases](config::CSaveConfig& record)
        {
            for (const auto& c : cases)
                Store(record.RadioChat()->entries[c.row], c.stored);
            record.RadioChat()->entries[1].notToAll = 1;
        }));
    const HWND page = tool.Page(kRadioChatPageIndex);
    for (const auto& c : cases)
    {
        // The field's last byte is the terminator's: it is never read.
        EXPECT_EQ(gui::WindowText(tool.Control(page, TextEdit(c.row))),
                  c.stored.substr(0, config::kRadioChatTextCapacity - 1))
            << c.row;
        EXPECT_EQ(TextOf(tool, c.row), c.kept) << c.row;
    }

    tool.Save();
    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    for (const auto& c : cases)
    {
        const char* text =
            reinterpret_cast<const char*>(file.data() + gui::kRadioChatInFile + 41 * c.row + 1);
        EXPECT_EQ(std::string(text, c.kept.size() + 1), c.kept + '\0') << c.row;
    }
}

TEST(RadioChatPage, ALongerTextCanBeTypedButOnly37BytesAreKept)
{
    RunningTool tool;
    const HWND page = tool.Page(kRadioChatPageIndex);
    const std::string typed(60, 'x');
    tool.Type(page, TextEdit(2), typed);
    EXPECT_EQ(gui::WindowText(tool.Control(page, TextEdit(2))), typed);
    EXPECT_EQ(TextOf(tool, 2), std::string(37, 'x'));
}

TEST(RadioChatPage, SavingWritesWhatTheRowsSet)
{
    RunningTool tool;
    const HWND page = tool.Page(kRadioChatPageIndex);
    tool.Type(page, TextEdit(2), "退避");
    tool.SetCheck(page, ToAllBox(2), false);
    tool.Save();

    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    EXPECT_EQ(gui::LittleEndianAt(file, gui::kRadioChatInFile - 4), 492) << "the section's length";
    const std::uint8_t* entry = file.data() + gui::kRadioChatInFile + 41 * 2;
    const std::vector<std::uint8_t> expected = {1, 0x91, 0xDE, 0x94, 0xF0, 0};
    EXPECT_EQ(std::vector<std::uint8_t>(entry, entry + expected.size()), expected);
}
