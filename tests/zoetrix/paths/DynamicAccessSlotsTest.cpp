#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "tests/zoetrix/fixtures/PlugInFixture.h"

/// The interface as hosts that were built before know it, written down a second time: nothing here
/// follows when the header changes. Calls find their operation by its place alone. It stands in no
/// unnamed namespace, so that the compiler must expect objects of classes that it cannot see.
class BuiltHostsView {
public:
    virtual ~BuiltHostsView() = default; ///< slots 1 and 2
    virtual const KM_3dmAnimationProperties& slot3(const CQuarnDoc& doc) const = 0;
    virtual void slot4(const CQuarnDoc& doc, const KM_3dmAnimationProperties& rec) = 0;
    virtual bool slot5(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec, int frame,
                       KM_Viewport& out) = 0;
    virtual bool slot6(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec, int frame,
                       KM_Light& light) = 0;
};

namespace {

/// The checker of types would see that the object is of no class of the view.
#define UNRELATED_CLASSES __attribute__((noinline, no_sanitize("vptr")))

class DynamicAccessSlots : public PlugInFixture {
protected:
    UNRELATED_CLASSES void expectRecordBehindItsSlots();
    UNRELATED_CLASSES void expectFramesBehindTheirSlots();

    /// The object as a host sees it. Nothing of its own class is known behind it.
    static BuiltHostsView& access() {
        IQnZoetrixDynamicAccess* volatile hidden = Zoetrix_QuarnDynamicAccess();
        return *reinterpret_cast<BuiltHostsView*>(hidden);
    }
};

void DynamicAccessSlots::expectRecordBehindItsSlots() {
    EXPECT_EQ(&record(), &access().slot3(doc()));
    KM_3dmAnimationProperties changed = record();
    changed.SetFrameCount(37);
    access().slot4(doc(), changed);
    EXPECT_EQ(37, record().FrameCount());
}

void DynamicAccessSlots::expectFramesBehindTheirSlots() {
    KM_Viewport camera;
    KM_Light light;
    setUpCameraFrames(2);
    EXPECT_TRUE(access().slot5(doc(), record(), 2, camera));
    EXPECT_TRUE(near(camera.CameraLocation(), cameraOfFrame(1), 0.0));
    EXPECT_FALSE(access().slot6(doc(), record(), 2, light));
    setUpSunFrames(2);
    EXPECT_TRUE(access().slot6(doc(), record(), 2, light));
    EXPECT_TRUE(near(light.Location(), sunOfFrame(1), 0.0));
    EXPECT_FALSE(access().slot5(doc(), record(), 2, camera));
}

} // namespace

TEST_F(DynamicAccessSlots, StandWhereBuiltHostsLookForThem) {
    expectRecordBehindItsSlots();
    expectFramesBehindTheirSlots();
}
