#include "zoetrix/sun/VyrSun.h"

#include <gtest/gtest.h>

/// The class as derived classes that were built before know it, written down a second time: nothing
/// here follows when the header changes. Calls find their operation by its place alone. It stands
/// in no unnamed namespace, so that the compiler must expect objects of classes that it cannot see.
class BuiltSunView {
public:
    virtual ~BuiltSunView() = default; ///< slots 1 and 2
    virtual void slot3() = 0;
};

namespace {

/// The checker of types would see that the object is of no class of the view.
#define UNRELATED_CLASSES __attribute__((noinline, no_sanitize("vptr")))

class CountingSun final : public CVyrSun {
public:
    explicit CountingSun(int& destroyed) : m_destroyed(destroyed) {}
    ~CountingSun() override { ++m_destroyed; }
    void Changed() override { ++changes; }

    int changes = 0;

private:
    int& m_destroyed;
};

BuiltSunView* seenBefore(CVyrSun* sun) {
    CVyrSun* volatile hidden = sun;
    return reinterpret_cast<BuiltSunView*>(hidden);
}

UNRELATED_CLASSES void callSlot3(BuiltSunView* view) {
    view->slot3();
}

UNRELATED_CLASSES void destroy(BuiltSunView* view) {
    delete view;
}

} // namespace

TEST(VyrSunSlots, StandWhereBuiltClassesLookForThem) {
    int destroyed = 0;
    auto* const sun = new CountingSun(destroyed);
    callSlot3(seenBefore(sun));
    EXPECT_EQ(1, sun->changes);
    EXPECT_EQ(0, destroyed);
    destroy(seenBefore(sun));
    EXPECT_EQ(1, destroyed);
}
