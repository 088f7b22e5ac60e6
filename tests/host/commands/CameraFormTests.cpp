#include "host/commands/CameraForm.h"
#include "tests/host/commands/HostFormFixture.h"

namespace quarn::test {
namespace {

class CameraFormTest : public FormTest {
protected:
    /// A camera whose numbers have more digits than the form shows.
    CameraFormTest() {
        session.runCommand(L"-_Camera _Location 12.3456789012,-30,4 _Target 1,2.00000000001,3 "
                           L"_Lens 35.123456789 _Enter");
        m_before = view().viewport();
    }
    double lens_mm() {
        double lens_mm = 0.0;
        EXPECT_TRUE(view().viewport().GetCamera35mmLensLength(&lens_mm));
        return lens_mm;
    }

    KM_Viewport m_before;
};

TEST_F(CameraFormTest, ShowsSevenDigitsAndKeepsAllOfThem) {
    const auto ended = answer(L"_Camera", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.text(CameraForm::location_x_id), L"12.34568");
        EXPECT_EQ(form.text(CameraForm::location_y_id), L"-30");
        EXPECT_EQ(form.text(CameraForm::location_z_id), L"4");
        EXPECT_EQ(form.text(CameraForm::target_x_id), L"1");
        EXPECT_EQ(form.text(CameraForm::target_y_id), L"2");
        EXPECT_EQ(form.text(CameraForm::target_z_id), L"3");
        EXPECT_EQ(form.text(CameraForm::lens_id), L"35.12346");
        EXPECT_EQ(form.entries(CameraForm::projection_id),
                  (std::vector<std::wstring>{L"Perspective", L"Parallel"}));
        EXPECT_EQ(form.pickedEntry(CameraForm::projection_id), CameraForm::perspective);
        form.pressOk();
    });
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_EQ(view().viewport().CameraLocation(), m_before.CameraLocation());
    EXPECT_EQ(view().viewport().TargetPoint(), m_before.TargetPoint());
    EXPECT_EQ(view().viewport().CameraUp(), m_before.CameraUp());
    EXPECT_NEAR(lens_mm(), 35.123456789, 1e-9);
}

TEST_F(CameraFormTest, MovesTheCameraTheTargetAndTheLens) {
    answer(L"_Camera", [](HeadlessDialogWindow& form) {
        form.type(CameraForm::location_z_id, L"7,5");
        form.type(CameraForm::target_x_id, L"-1");
        form.type(CameraForm::lens_id, L"80");
        form.pressOk();
    });
    EXPECT_EQ(view().viewport().CameraLocation(), KM_3dPoint(12.3456789012, -30, 7.5));
    EXPECT_EQ(view().viewport().TargetPoint(), KM_3dPoint(-1, 2.00000000001, 3));
    EXPECT_NEAR(lens_mm(), 80, 1e-9);
}

TEST_F(CameraFormTest, ParallelViewKeepsItsPlaceAndHasNoUseForALens) {
    answer(L"_Camera", [](HeadlessDialogWindow& form) {
        form.pick(CameraForm::projection_id, CameraForm::parallel);
        form.type(CameraForm::lens_id, L"whatever");
        form.pressOk();
    });
    EXPECT_TRUE(view().viewport().IsParallelProjection());
    EXPECT_EQ(view().viewport().CameraLocation(), m_before.CameraLocation());
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(CameraFormTest, PerspectiveViewMadeOfAParallelOneTakesTheLens) {
    session.runCommand(L"-_Camera _Parallel=_Yes _Enter");
    ASSERT_TRUE(view().viewport().IsParallelProjection());
    answer(L"_Camera", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.pickedEntry(CameraForm::projection_id), CameraForm::parallel);
        form.pick(CameraForm::projection_id, CameraForm::perspective);
        form.type(CameraForm::lens_id, L"24");
        form.pressOk();
    });
    EXPECT_TRUE(view().viewport().IsPerspectiveProjection());
    EXPECT_NEAR(lens_mm(), 24, 1e-9);
}

TEST_F(CameraFormTest, RefusesLensesOutOfRangeAndWhatIsNoNumber) {
    for (const wchar_t* text : {L"0.9", L"10000.1", L"-50"})
        EXPECT_EQ(refusal(L"_Camera", CameraForm::lens_id, text),
                  L"Enter a number between 1 and 10000");
    EXPECT_EQ(refusal(L"_Camera", CameraForm::target_z_id, L"up"), L"Enter a number");
    EXPECT_EQ(view().viewport().TargetPoint(), m_before.TargetPoint());
}

TEST_F(CameraFormTest, CameraThatWouldStandAtItsTargetIsRefusedInTheForm) {
    answer(L"_Camera", [&](HeadlessDialogWindow& form) {
        form.type(CameraForm::location_x_id, L"5");
        form.type(CameraForm::location_y_id, L"6");
        form.type(CameraForm::location_z_id, L"7");
        form.type(CameraForm::target_x_id, L"5");
        form.type(CameraForm::target_y_id, L"6");
        form.type(CameraForm::target_z_id, L"7");
        form.pressOk();
        EXPECT_TRUE(form.isOpen());
        EXPECT_EQ(form.focusedControl(), CameraForm::location_x_id);
        form.type(CameraForm::location_x_id, L"8");
        form.pressOk();
    });
    ASSERT_EQ(front_end.messages().size(), 1U);
    EXPECT_EQ(front_end.messages()[0].text,
              L"The camera cannot stand at its target. Give another location or target.");
    EXPECT_EQ(view().viewport().CameraLocation(), KM_3dPoint(8, 6, 7));
}

// Seven digits of numbers of any size; a reader can count them.
TEST(RoundedLength, HasSevenDigits) {
    EXPECT_EQ(roundedLength(1234567.89), 1234568);
    EXPECT_EQ(roundedLength(-0.000123456789), -0.0001234568);
    EXPECT_EQ(roundedLength(1e300), 1e300);
    EXPECT_FALSE(std::signbit(roundedLength(-0.0)));
}

} // namespace
} // namespace quarn::test
