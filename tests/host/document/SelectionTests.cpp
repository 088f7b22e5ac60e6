#include "tests/host/document/DocumentFixtures.h"

namespace quarn::test {
namespace {

/// Three points "A", "B" and "C", of which "C" is hidden.
class SelectionTest : public DocumentTest {
protected:
    SelectionTest() {
        for (const wchar_t* name : {L"A", L"B", L"C"})
            objects.addPoint(name, {0, 0, 0});
        objects.setVisible(idOf(L"C"), false);
    }

    KM_UUID idOf(const wchar_t* name) const { return objects.findByName(name)->id; }
    bool isSelected(const wchar_t* name) const { return objects.findByName(name)->selected; }

    ObjectTable& objects = document.objects();
};

TEST_F(SelectionTest, IsEmptyAtFirst) {
    EXPECT_EQ(objects.selectedCount(), 0);
    EXPECT_FALSE(isSelected(L"A"));
}

TEST_F(SelectionTest, TakesObjectsInAndOutOneByOne) {
    EXPECT_TRUE(objects.select(idOf(L"A")));
    EXPECT_TRUE(objects.select(idOf(L"C")));
    EXPECT_TRUE(objects.select(idOf(L"C")));
    EXPECT_EQ(objects.selectedCount(), 2);
    EXPECT_TRUE(objects.select(idOf(L"A"), false));
    EXPECT_FALSE(isSelected(L"A"));
    EXPECT_TRUE(isSelected(L"C"));
    EXPECT_FALSE(objects.select(KM_CreateUuid()));
    EXPECT_EQ(objects.selectedCount(), 1);
}

TEST_F(SelectionTest, OfAllAddsWhatIsVisibleAndKeepsWhatIsHidden) {
    objects.selectAll();
    EXPECT_TRUE(isSelected(L"A"));
    EXPECT_FALSE(isSelected(L"C"));
    objects.select(idOf(L"C"));
    objects.selectAll();
    EXPECT_EQ(objects.selectedCount(), 3);
    objects.selectNone();
    EXPECT_EQ(objects.selectedCount(), 0);
}

TEST_F(SelectionTest, LosesRemovedObjectsAndDoesNotChangeTheScene) {
    const auto revision = objects.revision();
    objects.select(idOf(L"A"));
    objects.select(idOf(L"B"));
    EXPECT_EQ(objects.revision(), revision);
    objects.remove(idOf(L"A"));
    EXPECT_EQ(objects.selectedCount(), 1);
    EXPECT_GT(objects.revision(), revision);
}

TEST_F(SelectionTest, SeveralObjectsAreRemovedAtOnce) {
    const KM_UUID ids[] = {idOf(L"C"), KM_CreateUuid(), idOf(L"A"), idOf(L"A")};
    EXPECT_EQ(objects.remove(ids), 2U);
    ASSERT_EQ(objects.objects().size(), 1U);
    EXPECT_EQ(objects.objects()[0]->name, KM_wString(L"B"));
    EXPECT_EQ(objects.findByName(L"A"), nullptr);
    EXPECT_EQ(objects.find(ids[0]), nullptr);
    const auto revision = objects.revision();
    EXPECT_EQ(objects.remove(ids), 0U);
    EXPECT_EQ(objects.revision(), revision);
}

TEST_F(SelectionTest, ARenamedObjectIsFoundByItsNewNameOnly) {
    const KM_UUID id = idOf(L"A");
    EXPECT_TRUE(objects.rename(id, L"Gate"));
    EXPECT_EQ(objects.findByName(L"A"), nullptr);
    EXPECT_EQ(objects.findByName(L"gate"), objects.find(id));
    EXPECT_TRUE(objects.rename(id, L"GATE")) << "its own name in other letters";
    EXPECT_STREQ(objects.find(id)->name, L"GATE");
    EXPECT_FALSE(objects.rename(id, L"b")) << "another object's name";
    EXPECT_STREQ(objects.find(id)->name, L"GATE");
    EXPECT_FALSE(objects.rename(KM_CreateUuid(), L"New"));
    EXPECT_TRUE(objects.rename(id, L""));
    EXPECT_EQ(objects.findByName(L"GATE"), nullptr);
    EXPECT_EQ(objects.findByName(L""), nullptr);
}

} // namespace
} // namespace quarn::test
