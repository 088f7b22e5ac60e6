#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

TEST(Array, AtGivesNullOutside) {
    KM_SimpleArray<int> numbers = {10, 20, 30};
    EXPECT_EQ(numbers.At(-1), nullptr);
    EXPECT_EQ(numbers.At(3), nullptr);
    ASSERT_NE(numbers.At(2), nullptr);
    EXPECT_EQ(*numbers.At(2), 30);
    EXPECT_EQ(*numbers.First(), 10);
    EXPECT_EQ(*numbers.Last(), 30);
    numbers.Empty();
    EXPECT_EQ(numbers.First(), nullptr);
    EXPECT_EQ(numbers.Last(), nullptr);
}

TEST(Array, EmptyKeepsTheStorageAndDestroyFreesIt) {
    KM_SimpleArray<int> numbers;
    numbers.Reserve(100);
    numbers.Append(1);
    numbers.Empty();
    EXPECT_EQ(numbers.Count(), 0);
    EXPECT_GE(numbers.Capacity(), 100);
    numbers.Destroy();
    EXPECT_EQ(numbers.Capacity(), 0);
}

TEST(Array, GrowingByCountMakesZeros) {
    KM_SimpleArray<int> numbers = {7};
    numbers.SetCount(3);
    EXPECT_EQ(numbers, (KM_SimpleArray<int>{7, 0, 0}));
    numbers.SetCount(-4);
    EXPECT_EQ(numbers.Count(), 0);
}

TEST(Array, OwnElementsMayBeAppended) {
    KM_SimpleArray<int> numbers = {1, 2};
    for (int i = 0; i < 20; ++i)
        numbers.Append(numbers[0]);
    EXPECT_EQ(*numbers.Last(), 1);
    numbers = {1, 2, 3};
    numbers.Append(numbers.Count(), numbers.Array());
    EXPECT_EQ(numbers, (KM_SimpleArray<int>{1, 2, 3, 1, 2, 3}));
    numbers.Append(2, nullptr);
    numbers.Append(-1, numbers.Array());
    EXPECT_EQ(numbers.Count(), 6);
}

TEST(Array, InsertRemoveSearchAndReverse) {
    KM_SimpleArray<int> numbers = {1, 3};
    numbers.Insert(1, 2);
    numbers.Insert(-5, 0);
    numbers.Insert(99, 4);
    EXPECT_EQ(numbers, (KM_SimpleArray<int>{0, 1, 2, 3, 4}));
    numbers.Remove(0);
    numbers.Remove(99);
    numbers.Remove(-1);
    EXPECT_EQ(numbers, (KM_SimpleArray<int>{1, 2, 3, 4}));
    EXPECT_EQ(numbers.Search(3), 2);
    EXPECT_EQ(numbers.Search(5), -1);
    numbers.Reverse();
    EXPECT_EQ(numbers, (KM_SimpleArray<int>{4, 3, 2, 1}));
}

TEST(Array, CopiesAreDeepAndAnArrayMayBeAssignedToItself) {
    KM_ClassArray<KM_wString> names;
    names.AppendNew() = L"one";
    names.Append(L"two");
    KM_ClassArray<KM_wString> copy = names;
    copy[0] = L"changed";
    EXPECT_TRUE(names[0] == L"one");
    const auto& self = names;
    names = self;
    EXPECT_EQ(names.Count(), 2);
    EXPECT_TRUE(names[1] == L"two");
}

TEST(Array, NewElementOfAPlainArrayIsZero) {
    KM_SimpleArray<double> numbers;
    EXPECT_EQ(numbers.AppendNew(), 0.0);
    KM_3dPointArray points;
    EXPECT_EQ(points.AppendNew(), KM_3dPoint::Origin);
    EXPECT_EQ(points.Count(), 1);
}
