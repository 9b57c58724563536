// The description of the record's fields: every value the controls allow
// can be given by what it means.
#include "config/field_table.h"

#include <gtest/gtest.h>
#include <string>

namespace
{

TEST(FieldTable, EveryAllowedValueIsReadBackFromItsNumberAndFromWhatItMeans)
{
    for (const config::FieldDescription& field : config::Fields())
    {
        if (!config::IsNumberKind(field.kind))
            continue;
        const config::FieldAt at{&field, {field.counts[0] - 1 > 0 ? 1 : 0, 0}};
        // A sample of the longer ranges: each value's meaning is weighed
        // against every other's.
        const bool volume = field.kind == config::FieldKind::Volume;
        const std::int64_t step = volume ? 250 : field.options.empty() ? 7 : 1;
        for (std::int64_t value = volume ? -10000 : 0; value <= 256; value += step)
        {
            if (!config::IsAllowed(field, value))
                continue;
            // A number is the stored number unless it is what another value
            // means (the key response "2", the key 2).
            std::int64_t read = -1;
            EXPECT_TRUE(config::ParseValue(at, std::to_string(value), &read)) << field.name;
            if (read != value)
            {
                const std::string meaning = config::ValueMeaning(at, read);
                EXPECT_TRUE(meaning.ends_with(": " + std::to_string(value)) ||
                            meaning == std::to_string(value))
                    << field.name << " " << value;
            }
            const std::string meaning = config::ValueMeaning(at, value);
            if (meaning.empty() || meaning.find("(no name)") != std::string::npos)
                continue;
            read = -1;
            EXPECT_TRUE(config::ParseValue(at, meaning, &read)) << meaning;
            EXPECT_EQ(read, value) << meaning;
        }
    }
}

} // namespace
