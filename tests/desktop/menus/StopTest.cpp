#include "desktop/menus/CommandMenus.h"
#include "tests/desktop/window/WindowFixture.h"

#include <cmath>
#include <fstream>

namespace quarn::desktop::test {
namespace {

/// Writes a wavy plate of so many squares each way, each of two triangles, as a PLY file.
void writePlate(const std::filesystem::path& file, int squares) {
    const int side = squares + 1;
    std::ofstream out(file, std::ios::binary);
    out << "ply\nformat binary_little_endian 1.0\nelement vertex " << side * side
        << "\nproperty float x\nproperty float y\nproperty float z\nelement face "
        << 2 * squares * squares << "\nproperty list uchar int vertex_indices\nend_header\n";
    for (int i = 0; i < side * side; ++i) {
        const auto x = static_cast<float>(i % side);
        const auto y = static_cast<float>(i / side);
        const float point[3] = {x, y, 9 * std::sin(x / 9) * std::cos(y / 9)};
        out.write(reinterpret_cast<const char*>(point), sizeof point);
    }
    const auto triangle = [&out](int a, int b, int c) {
        const std::int32_t corners[3] = {a, b, c};
        out.put(3).write(reinterpret_cast<const char*>(corners), sizeof corners);
    };
    for (int i = 0; i < squares * squares; ++i) {
        const int corner = i / squares * side + i % squares;
        triangle(corner, corner + 1, corner + side);
        triangle(corner + 1, corner + side + 1, corner + side);
    }
}

class StopTest : public WindowTest {
protected:
    /// Has the person choose Stop once so many pictures were shown. Must outlive what is shown.
    void stopAfter(int pictures) {
        FrontEndParts parts;
        parts.view_shown = [this, pictures](CQuarnView&, const ShownPicture&) {
            ++(is_stopped ? shown_after_stop : shown_before_stop);
            if (shown_before_stop == pictures)
                later([this] {
                    window.menus().stopAction().trigger();
                    is_stopped = true;
                });
        };
        front_end.setParts(parts);
    }

    bool is_stopped = false;
    int shown_before_stop = 0;
    int shown_after_stop = 0;
};

TEST_F(StopTest, EndsACommandThatAsksWithAllItsQuestions) {
    int questions = 0;
    QObject::connect(&window.starter(), &CommandStarter::started, &window, [&](const QString&) {
        later([&] {
            ASSERT_TRUE(window.commandPane().isAsking());
            ++questions;
            window.menus().stopAction().trigger();
        });
    });
    run("_Circle");
    EXPECT_EQ(questions, 1);
    EXPECT_FALSE(window.commandPane().isAsking());
    EXPECT_FALSE(window.starter().isRunning());
}

TEST_F(StopTest, WhileAMillionTrianglesPlayNoFurtherFrameIsDrawn) {
    constexpr int squares = 708;
    static_assert(2 * squares * squares >= 1'000'000);
    writePlate(folder / "plate.ply", squares);
    run("_-Open \"" + qtText(folder / "plate.ply") + '"');
    constexpr int frames = 60;
    run(QString("_-SetTurntableAnimation %1 _Clockwise _jpg _Shaded Perspective Turn").arg(frames));
    stopAfter(3);
    run("_-PlayAnimation");
    EXPECT_TRUE(is_stopped);
    EXPECT_EQ(shown_before_stop, 3);
    EXPECT_EQ(shown_after_stop, 0);
    const auto record = session.document().Properties().AnimationProperties();
    EXPECT_EQ(record.FrameCount(), frames);
}

} // namespace
} // namespace quarn::desktop::test
