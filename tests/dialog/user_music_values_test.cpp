// What the user music page decides without a window.
#include "dialog/user_music_values.h"

#include <gtest/gtest.h>

using dialog::MusicColumn;
using dialog::MusicControlOf;

TEST(MusicControl, EachIdentifierNamesItsRowAndControl)
{
    const struct
    {
        int id;
        int row;
        MusicColumn column;
    } cases[] = {
        {7001, 0, MusicColumn::MusicPath}, {7002, 0, MusicColumn::TensionPath},
        {7003, 0, MusicColumn::Browse},    {7004, 0, MusicColumn::Check},
        {7005, 1, MusicColumn::MusicPath}, {7038, 9, MusicColumn::TensionPath},
        {7040, 9, MusicColumn::Check},
    };
    for (const auto& c : cases)
    {
        const auto control = MusicControlOf(c.id);
        ASSERT_TRUE(control.has_value()) << c.id;
        EXPECT_EQ(control->row, c.row) << c.id;
        EXPECT_EQ(control->column, c.column) << c.id;
    }
    for (const int id : {0, 7000, 7041, 1})
        EXPECT_FALSE(MusicControlOf(id).has_value()) << id;
}
