#include "tests/vexui/WithoutWindows.h"

#include <gtest/gtest.h>

#include <QApplication>

#include <cstdlib>
#include <string_view>

int main(int argc, char** argv) {
    if (argc > 1 && std::string_view(argv[1]) == WITHOUT_WINDOWS)
        return runWithoutWindows();
    testing::InitGoogleTest(&argc, argv);
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    const QApplication application(argc, argv);
    return RUN_ALL_TESTS();
}
