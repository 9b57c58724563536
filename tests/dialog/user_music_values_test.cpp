// What the user music page decides without a window: the row and the control
// an identifier names.
#include "dialog/user_music_values.h"

#include <gtest/gtest.h>
#include <tuple>

using dialog::MusicColumn;

TEST(MusicControl, EachIdentifierNamesItsRowAndControl)
{
    const std::tuple<int, int, MusicColumn> cases[] = {
        {7001, 0, MusicColumn::MusicPath}, {7002, 0, MusicColumn::TensionPath},
        {7003, 0, MusicColumn::Browse},    {7004, 0, MusicColumn::Check},
        {7005, 1, MusicColumn::MusicPath}, {7040, 9, MusicColumn::Check}};
    for (const auto& [id, row, column] : cases)
    {
        const auto control = dialog::MusicControlOf(id);
        ASSERT_TRUE(control.has_value()) << id;
        EXPECT_EQ(std::make_pair(control->row, control->column), std::make_pair(row, column));
    }
    for (const int id : {7000, 7041})
        EXPECT_FALSE(dialog::MusicControlOf(id).has_value()) << id;
}
