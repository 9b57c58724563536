// The text fields of the record, one row per kind of field. "ぁ" is 82 9F:
// its trail byte lies in the lead-byte range. "表" is 95 5C: its trail byte
// is a backslash.
#include "config/fixed_text.h"

#include <gtest/gtest.h>
#include <string>

TEST(FixedText, EachFieldKeepsWhatItsLimitAllowsAndReadsWithoutItsLastByte)
{
    std::string kana = "a";
    for (int i = 0; i < 18; ++i)
        kana += "ぁ";
    const struct
    {
        const char* kind;
        std::size_t capacity;
        std::size_t limit;
        std::string given;
        std::string kept;
    } cases[] = {{"path", config::kPathCapacity, config::kPathTextLimit,
                  std::string(258, 'p') + "表", std::string(258, 'p')},
                 {"id", config::kIdCapacity, config::kIdTextLimit, std::string(29, 'i') + "表表",
                  std::string(29, 'i') + "表"},
                 {"radio chat", config::kRadioChatTextCapacity, config::kRadioChatTextLimit,
                  kana + "ぁ", kana},
                 {"octet", 4, config::kOctetTextLimit, "1234", "123"}};
    for (const auto& c : cases)
    {
        std::string field(c.capacity, 'z');
        config::StoreFieldText(field.data(), c.capacity, c.limit, c.given);
        EXPECT_EQ(field, c.kept + std::string(c.capacity - c.kept.size(), '\0')) << c.kind;
        EXPECT_EQ(config::FieldText(field.data(), c.capacity), c.kept) << c.kind;
        const std::string unterminated(c.capacity, 'x');
        EXPECT_EQ(config::FieldText(unterminated.data(), c.capacity),
                  std::string(c.capacity - 1, 'x'))
            << c.kind;
    }
}
