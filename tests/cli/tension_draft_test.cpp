// The file-name entry a draft takes from its music's file name.
#include "cli/tension_draft.h"

#include <gtest/gtest.h>

namespace
{

// "あ" is 82 A0 in code page 932.
std::string Hiragana(int count)
{
    std::string text;
    for (int i = 0; i < count; ++i)
        text += "\x82\xA0";
    return text;
}

TEST(DraftName, IsTheFileNameWithinFortyBytesAndNeverEndsTheEntryEarly)
{
    const std::pair<std::string, std::string> cases[] = {
        {"C:\\music\\battle.ogg", "battle"},
        {"/home/u/a;b.tar.wav", "a_b.tar"},
        {"folder/" + Hiragana(21) + ".wav", Hiragana(20)},
        {"a" + Hiragana(20) + ".ogg", "a" + Hiragana(19)},
        {"  .wav", "BGM"},
    };
    for (const auto& [path, name] : cases)
        EXPECT_EQ(cli::DraftName(path), name) << path;
}

} // namespace
