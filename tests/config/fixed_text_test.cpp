// The text fields of the record, one row per kind of field. "ぁ" is 82 9F:
// its trail byte lies in the lead-byte range. "表" is 95 5C: its trail byte
// is a backslash.
#include "config/fixed_text.h"

#include <gtest/gtest.h>
#include <string>
#include <tuple>

TEST(FixedText, EachFieldKeepsWhatItsLimitAllowsAndReadsWithoutItsLastByte)
{
    std::string kana = "a";
    for (int i = 0; i < 18; ++i)
        kana += "ぁ";
    using namespace config;
    // The capacity, the limit, the text given and the text kept.
    const std::tuple<std::size_t, std::size_t, std::string, std::string> cases[] = {
        {kPathCapacity, kPathTextLimit, std::string(258, 'p') + "表", std::string(258, 'p')},
        {kIdCapacity, kIdTextLimit, std::string(29, 'i') + "表表", std::string(29, 'i') + "表"},
        {kRadioChatTextCapacity, kRadioChatTextLimit, kana + "ぁ", kana},
        {4, kOctetTextLimit, "1234", "123"}};
    for (const auto& [capacity, limit, given, kept] : cases)
    {
        std::string field(capacity, 'z');
        StoreFieldText(field.data(), capacity, limit, given);
        EXPECT_EQ(field, kept + std::string(capacity - kept.size(), '\0')) << capacity;
        EXPECT_EQ(FieldText(field.data(), capacity), kept) << capacity;
        const std::string unterminated(capacity, 'x');
        EXPECT_EQ(FieldText(unterminated.data(), capacity), std::string(capacity - 1, 'x'))
            << capacity;
    }
}
