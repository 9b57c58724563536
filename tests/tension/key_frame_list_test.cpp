// The key-frame list: keys in time order, the 0.006-second refusal, and
// step evaluation.
#include "tension/key_frame_list.h"

#include <gtest/gtest.h>
#include <memory>

using tension::CKeyFrameList;

TEST(KeyFrameList, KeepsKeysInAscendingTimeWhateverTheOrderOfAdding)
{
    CKeyFrameList list("Tension");
    EXPECT_STREQ(list.GetName(), "Tension");
    ASSERT_TRUE(list.KeyAdd(1, 0.0f, 0.0f));
    ASSERT_TRUE(list.KeyAdd(1, 180.0f, 0.0f));
    ASSERT_TRUE(list.KeyAdd(2, 90.0f, 0.0f));
    ASSERT_TRUE(list.KeyAdd(0, 30.0f, 0.5f));
    ASSERT_EQ(list.GetKeyCount(), 4u);
    const float times[] = {0.0f, 30.0f, 90.0f, 180.0f};
    const int values[] = {1, 0, 2, 1};
    for (std::uint32_t i = 0; i < 4; ++i)
    {
        EXPECT_EQ(list.GetKey(i)->time, times[i]);
        EXPECT_EQ(list.GetKey(i)->value, values[i]);
    }
    EXPECT_EQ(list.GetKey(1)->ease, 0.5f);
    EXPECT_EQ(list.GetKey(4), nullptr);
}

TEST(KeyFrameList, RefusesATimeWithinSixMillisecondsOfAKey)
{
    struct Case
    {
        float time;
        bool added;
    };
    const Case cases[] = {
        {30.0f, false},  {30.005f, false}, {29.995f, false}, {30.006f, false},
        {30.007f, true}, {29.993f, true},  {31.0f, true},
    };
    for (const Case& c : cases)
    {
        CKeyFrameList list;
        ASSERT_TRUE(list.KeyAdd(1, 30.0f, 0.0f));
        EXPECT_EQ(list.KeyAdd(2, c.time, 0.0f), c.added) << c.time;
        EXPECT_EQ(list.GetKeyCount(), c.added ? 2u : 1u);
    }
    CKeyFrameList list;
    EXPECT_FALSE(list.KeyAdd(1, std::numeric_limits<float>::quiet_NaN(), 0.0f));
}

TEST(KeyFrameList, EvaluatesAsAStepFunction)
{
    CKeyFrameList list;
    std::int32_t value = -1;
    EXPECT_FALSE(list.Evaluate(5.0f, &value)) << "an empty list has no value";
    list.KeyAdd(1, 10.0f, 0.0f);
    list.KeyAdd(3, 20.0f, 0.0f);
    EXPECT_FALSE(list.Evaluate(9.99f, &value)) << "before the first key";
    ASSERT_TRUE(list.Evaluate(10.0f, &value));
    EXPECT_EQ(value, 1);
    ASSERT_TRUE(list.Evaluate(19.99f, &value));
    EXPECT_EQ(value, 1);
    ASSERT_TRUE(list.Evaluate(20.0f, &value));
    EXPECT_EQ(value, 3);
    ASSERT_TRUE(list.Evaluate(1000.0f, &value));
    EXPECT_EQ(value, 3);
}

TEST(KeyFrameList, ClonesAreDeep)
{
    CKeyFrameList list("Tension");
    list.KeyAdd(2, 5.0f, 0.0f);
    std::unique_ptr<CKeyFrameList> clone(list.Clone());
    list.KeyAdd(3, 50.0f, 0.0f);
    ASSERT_EQ(clone->GetKeyCount(), 1u);
    EXPECT_EQ(clone->GetKey(0)->value, 2);
    EXPECT_STREQ(clone->GetName(), "Tension");
    EXPECT_STREQ(clone->GetClassName(), "CKeyFrameList");
    EXPECT_EQ(clone->GetClassSize(), sizeof(CKeyFrameList));
    std::unique_ptr<CKeyFrameList> created(list.Create());
    EXPECT_EQ(created->GetKeyCount(), 0u);
    EXPECT_TRUE(list.Release());
    EXPECT_EQ(list.GetKeyCount(), 0u);
    EXPECT_TRUE(list.Release());
}
