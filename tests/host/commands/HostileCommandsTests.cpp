#include "host/document/DocumentDrawing.h"
#include "host/session/ViewNavigation.h"
#include "host/session/ViewPicking.h"
#include "tests/engine/display/HostileNumbers.h"
#include "tests/host/app/TestCommand.h"
#include "tests/support/TempFolder.h"

#include <charconv>
#include <fstream>

namespace quarn::test {
namespace {

constexpr unsigned RUNS = 60;
constexpr int COMMANDS = 12;

/// Runs commands with whatever numbers there are, as a script would.
class HostileCommandsTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }

    std::string number() {
        if (numbers.choice(20) == 0)
            return numbers.choice(2) ? "inf" : "nan";
        char digits[32];
        const auto end = std::to_chars(digits, digits + 32, numbers.finite());
        return {digits, end.ptr};
    }
    std::string point() { return number() + "," + number() + "," + number(); }
    std::string points(int count) {
        std::string all;
        for (; count > 0; --count)
            all += " " + point();
        return all;
    }

    std::string drawing() {
        switch (numbers.choice(6)) {
        case 0:
            return "_-Line" + points(2);
        case 1:
            return "_-Polyline" + points(2 + numbers.choice(4));
        case 2:
            return "_-Spline _Degree " + std::to_string(1 + numbers.choice(4)) + points(5);
        case 3:
            return "_-SplineThrough" + points(2 + numbers.choice(4));
        case 4:
            return "_-Circle" + points(1) + " " + number();
        default:
            return "_-Point" + points(1);
        }
    }
    std::string viewing() {
        switch (numbers.choice(7)) {
        case 0:
            return "_-Camera _Location " + point() + " _Enter";
        case 1:
            return "_-Camera _Target " + point() + " _Enter";
        case 2:
            return "_-Camera _Lens " + number() + " _Enter";
        case 3:
            return "_-Camera _Location " + point() + " _Target " + point() +
                   " _Parallel=Yes _Enter";
        case 4:
            return "_-FitView _Turn=Yes _KeepTarget=Yes _Enter";
        case 5:
            return "_-FitView _Distance " + number() + " _Enter";
        default:
            return "_-FitView _Enter";
        }
    }
    std::string changing() {
        switch (numbers.choice(6)) {
        case 0:
            return "_-Sun _Direction " + number() + " " + number();
        case 1:
            return "_-MovePoint Curve " + std::to_string(numbers.choice(3)) + " " + point();
        case 2:
            return "_-EvenSpeed Curve";
        case 3:
            return "_-ImportCurve \"" + curveFile() + "\"";
        case 4:
            return "_-List _Curves";
        default:
            return "_-List";
        }
    }
    std::string curveFile() {
        const std::filesystem::path file = folder.path() / "curve.txt";
        std::ofstream out(file);
        for (int i = 0; i < 4; ++i)
            out << number() << ' ' << number() << ' ' << number() << '\n';
        return file.string();
    }

    void lookAround() {
        ViewState& view = document().activeView();
        orbitView(view.face(), 5.0, 3.0);
        panView(view.face(), 5.0, 3.0);
        zoomView(view.face(), 1.2, 5.0, 5.0);
        (void)objectAt(view.face(), 8.0, 6.0);
        (void)pointAt(view.face(), 8.0, 6.0);
    }

    TempFolder folder;
    HostileNumbers numbers{0};
};

TEST_F(HostileCommandsTest, AnyNumbersInAnyCommandLeaveADocumentThatIsDrawnAndSaved) {
    const std::wstring file = folder.path().wstring() + L"/document.quarn";
    for (unsigned seed = 0; seed < RUNS; ++seed) {
        SCOPED_TRACE(seed);
        numbers = HostileNumbers(seed);
        run(L"New");
        ASSERT_EQ(run(L"_-ViewportSize 16 12"), CQuarnCommand::success);
        ASSERT_EQ(run(L"_-RenderSettings Size 12 8 Samples 1 _Enter"), CQuarnCommand::success);
        for (int i = 0; i < COMMANDS; ++i) {
            const int kind = numbers.choice(3);
            const std::string line = kind == 0 ? viewing() : kind == 1 ? drawing() : changing();
            run(KM_wString::FromUtf8(line).Array());
            if (i % 3 == 0)
                lookAround();
            document().activeView().redraw(0);
        }
        EXPECT_EQ(run(L"_-Render"), CQuarnCommand::success) << printed();
        ASSERT_EQ(run((L"_-SaveAs \"" + file + L"\"").c_str()), CQuarnCommand::success)
            << printed();
        const std::size_t count = document().objects().objects().size();
        ASSERT_EQ(run((L"_-Open \"" + file + L"\"").c_str()), CQuarnCommand::success) << printed();
        EXPECT_EQ(document().objects().objects().size(), count);
        for (const auto& view : document().views())
            view->redraw(0);
        front_end.clearPrinted();
    }
}

} // namespace
} // namespace quarn::test
