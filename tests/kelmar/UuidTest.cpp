#include "kelmar/KM_Uuid.h"

#include <gtest/gtest.h>

#include <set>
#include <string>

namespace {

constexpr KM_UUID example = {
    0x6F1C9A3E, 0x0B52, 0x4D7E, {0x9C, 0x1A, 0x2E, 0x5F, 0x80, 0xB7, 0xD4, 0x13}};

} // namespace

TEST(Uuid, TextNamesTheFieldsInOrder) {
    EXPECT_TRUE(KM_UuidToString(example) == L"6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413");
    EXPECT_TRUE(KM_UuidToString(KM_nil_uuid) == L"00000000-0000-0000-0000-000000000000");
}

TEST(Uuid, TextIsReadInEitherCaseAndWithBraces) {
    EXPECT_EQ(KM_UuidFromString("6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413"), example);
    EXPECT_EQ(KM_UuidFromString("6f1c9a3e-0b52-4d7e-9c1a-2e5f80b7d413"), example);
    EXPECT_EQ(KM_UuidFromString("{6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413}"), example);
}

TEST(Uuid, MalformedTextGivesNil) {
    for (const char* text :
         {"", "{}", "6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D41", "6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D4130",
          "6F1C9A3E00B52-4D7E-9C1A-2E5F80B7D413", "6F1C9A3-E0B52-4D7E-9C1A-2E5F80B7D413",
          "6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D41G", "{6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413",
          "6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413}", " 6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D41",
          "-F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413"})
        EXPECT_TRUE(KM_UuidIsNil(KM_UuidFromString(text))) << text;
}

TEST(Uuid, OrderIsThatOfTheTexts) {
    KM_UUID later = example;
    later.Data4[7] = 0x14;
    EXPECT_TRUE(example < later);
    EXPECT_FALSE(later < example);
    EXPECT_TRUE(KM_nil_uuid < example);
    EXPECT_NE(example, later);
}

TEST(Uuid, NewOnesAreRandomOnesOfTheirVersion) {
    std::set<KM_UUID> seen;
    for (int i = 0; i < 1000; ++i) {
        const KM_UUID id = KM_CreateUuid();
        EXPECT_EQ(id.Data3 >> 12, 4);
        EXPECT_EQ(id.Data4[0] >> 6, 2);
        EXPECT_EQ(KM_UuidFromString(KM_UuidToString(id).ToUtf8()), id);
        seen.insert(id);
    }
    EXPECT_EQ(seen.size(), 1000U);
}
