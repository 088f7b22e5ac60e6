#include "desktop/dialogs/LocationDialog.h"
#include "desktop/dialogs/FieldMark.h"
#include "desktop/dialogs/WorldMap.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QTest>

namespace quarn::desktop {
namespace {

using test::onceShown;
using test::part;

const Place MUNICH = {48.14, 11.58};

class LocationDialogTest : public testing::Test {
protected:
    /// Asks for a place while a person does something in the window.
    std::optional<Place> ask(const Place& start, std::function<void(QWidget&)> act) {
        onceShown("location", std::move(act));
        return askPlace(nullptr, L"Set Animation Location", start);
    }

    static void type(QWidget& window, const char* field, const char* text) {
        auto& edit = part<QLineEdit>(window, field);
        edit.setFocus();
        edit.selectAll();
        QTest::keyClick(&edit, Qt::Key_Delete);
        QTest::keyClicks(&edit, text);
    }
    static void press(QWidget& window, const char* button) {
        QTest::mouseClick(&part(window, button), Qt::LeftButton);
    }
    static QString textOf(QWidget& window, const char* field) {
        return part<QLineEdit>(window, field).text();
    }
    static QModelIndex rowOf(QWidget& window, const QString& city) {
        const QAbstractItemModel& cities = *part<QTableView>(window, "cities").model();
        const auto found =
            cities.match(cities.index(0, 0), Qt::DisplayRole, city, 1, Qt::MatchExactly);
        return found.isEmpty() ? QModelIndex() : found.first();
    }
};

TEST_F(LocationDialogTest, ShowsTheStartPlaceEverywhereAndGivesItBackUntouched) {
    const auto place = ask({12.3456789, -65.4321987}, [](QWidget& window) {
        EXPECT_EQ(window.windowTitle(), "Set Animation Location");
        EXPECT_EQ(textOf(window, "latitude"), "12.3457");
        EXPECT_EQ(textOf(window, "longitude"), "-65.4322");
        EXPECT_DOUBLE_EQ(part<WorldMap>(window, "map").place()->latitude_deg, 12.3456789);
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->latitude_deg, 12.3456789);
    EXPECT_DOUBLE_EQ(place->longitude_deg, -65.4321987);
}

TEST_F(LocationDialogTest, TypedAnglesAreTheAnswerAndMoveTheMark) {
    const auto place = ask(MUNICH, [](QWidget& window) {
        type(window, "latitude", "33.87 S");
        type(window, "longitude", "151,21");
        const auto mark = part<WorldMap>(window, "map").place();
        ASSERT_TRUE(mark);
        EXPECT_DOUBLE_EQ(mark->latitude_deg, -33.87);
        EXPECT_DOUBLE_EQ(mark->longitude_deg, 151.21);
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->latitude_deg, -33.87);
    EXPECT_DOUBLE_EQ(place->longitude_deg, 151.21);
}

TEST_F(LocationDialogTest, RefusesALatitudeOf90AndAHalfWithASentence) {
    const auto place = ask(MUNICH, [](QWidget& window) {
        type(window, "latitude", "90.5");
        EXPECT_EQ(part<QLabel>(window, "flaw").text(),
                  "Latitude: enter a number between -90 and 90");
        EXPECT_TRUE(isMarked(part<QLineEdit>(window, "latitude")));
        EXPECT_FALSE(part<QPushButton>(window, "ok").isEnabled());
        EXPECT_FALSE(part<WorldMap>(window, "map").place());
        QTest::keyClick(&part(window, "latitude"), Qt::Key_Return);
        EXPECT_TRUE(window.isVisible());
        type(window, "latitude", "90");
        EXPECT_EQ(part<QLabel>(window, "flaw").text(), "");
        EXPECT_FALSE(isMarked(part<QLineEdit>(window, "latitude")));
        QTest::keyClick(&part(window, "latitude"), Qt::Key_Return);
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->latitude_deg, 90);
}

TEST_F(LocationDialogTest, RefusesALongitudeBeyond180AndATextThatIsNoNumber) {
    EXPECT_FALSE(ask(MUNICH, [](QWidget& window) {
        type(window, "longitude", "-180.01");
        EXPECT_EQ(part<QLabel>(window, "flaw").text(),
                  "Longitude: enter a number between -180 and 180");
        type(window, "longitude", "east");
        EXPECT_EQ(part<QLabel>(window, "flaw").text(), "Longitude: enter a number");
        press(window, "ok");
        EXPECT_TRUE(window.isVisible());
        press(window, "cancel");
    }));
}

TEST_F(LocationDialogTest, CancelEscapeAndTheWindowsOwnButtonGiveNoPlace) {
    EXPECT_FALSE(ask(MUNICH, [](QWidget& window) { press(window, "cancel"); }));
    EXPECT_FALSE(ask(MUNICH, [](QWidget& window) {
        QTest::keyClick(&part(window, "latitude"), Qt::Key_Escape);
    }));
    EXPECT_FALSE(ask(MUNICH, [](QWidget& window) { window.close(); }));
}

TEST_F(LocationDialogTest, SelectingACityFillsTheFields) {
    const auto place = ask({0, 0}, [](QWidget& window) {
        auto& table = part<QTableView>(window, "cities");
        const QModelIndex munich = rowOf(window, "Munich");
        ASSERT_TRUE(munich.isValid());
        table.scrollTo(munich);
        QTest::mouseClick(table.viewport(), Qt::LeftButton, {}, table.visualRect(munich).center());
        EXPECT_EQ(textOf(window, "latitude"), "48.14");
        EXPECT_EQ(textOf(window, "longitude"), "11.58");
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->latitude_deg, 48.14);
}

TEST_F(LocationDialogTest, SearchNarrowsTheTableAndEnterTakesTheFirstCityBeforeItConfirms) {
    const auto place = ask({0, 0}, [](QWidget& window) {
        const QAbstractItemModel& cities = *part<QTableView>(window, "cities").model();
        const int all = cities.rowCount();
        type(window, "search", "Syd");
        EXPECT_LT(cities.rowCount(), all);
        EXPECT_EQ(cities.index(0, 0).data().toString(), "Sydney");
        EXPECT_EQ(textOf(window, "latitude"), "0");
        QTest::keyClick(&part(window, "search"), Qt::Key_Return);
        EXPECT_TRUE(window.isVisible());
        EXPECT_EQ(textOf(window, "latitude"), "-33.87");
        QTest::keyClick(&part(window, "search"), Qt::Key_Return);
        EXPECT_FALSE(window.isVisible());
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->longitude_deg, 151.21);
}

TEST_F(LocationDialogTest, DownGoesFromTheSearchIntoTheTable) {
    const auto place = ask({0, 0}, [](QWidget& window) {
        type(window, "search", "London, Uni");
        QTest::keyClick(&part(window, "search"), Qt::Key_Down);
        EXPECT_EQ(window.focusWidget()->objectName(), "cities");
        EXPECT_EQ(textOf(window, "latitude"), "51.51");
        QTest::keyClick(window.focusWidget(), Qt::Key_Return);
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->latitude_deg, 51.51);
}

TEST_F(LocationDialogTest, TableOpensAtTheCityOfTheStartOrTheNearest) {
    const auto isShown = [](QWidget& window, const char* city) {
        auto& table = part<QTableView>(window, "cities");
        return table.viewport()->rect().intersects(table.visualRect(rowOf(window, city)));
    };
    ask({48.14, 11.58}, [&](QWidget& window) {
        const auto& table = part<QTableView>(window, "cities");
        EXPECT_EQ(table.currentIndex().siblingAtColumn(0).data().toString(), "Munich");
        EXPECT_TRUE(isShown(window, "Munich"));
        EXPECT_TRUE(isShown(window, "Montreal")); // some rows above and below
        EXPECT_TRUE(isShown(window, "Nairobi"));
        press(window, "ok");
    });
    ask({-33.5, 150.9}, [&](QWidget& window) {
        EXPECT_FALSE(part<QTableView>(window, "cities").currentIndex().isValid());
        EXPECT_TRUE(isShown(window, "Sydney"));
        EXPECT_FALSE(isShown(window, "Munich"));
        press(window, "ok");
    });
}

TEST_F(LocationDialogTest, TableGoesBackToTheNearestCityWhenTheSearchIsCleared) {
    ask({-33.5, 150.9}, [&](QWidget& window) {
        type(window, "search", "zag");
        part<QLineEdit>(window, "search").clear();
        auto& table = part<QTableView>(window, "cities");
        EXPECT_TRUE(table.viewport()->rect().intersects(table.visualRect(rowOf(window, "Sydney"))));
        press(window, "ok");
    });
}

TEST_F(LocationDialogTest, ClickOnTheMapChoosesThePlaceBelow) {
    const auto place = ask({0, 0}, [](QWidget& window) {
        auto& map = part<WorldMap>(window, "map");
        QTest::mouseClick(&map, Qt::LeftButton, {},
                          map.positionOf({-45.0, -120.0}).toPoint()); // the empty Pacific
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_NEAR(place->latitude_deg, -45.0, 0.6); // a pixel is about half a degree
    EXPECT_NEAR(place->longitude_deg, -120.0, 0.6);
}

TEST_F(LocationDialogTest, ClickOnACitysDotChoosesTheCityItself) {
    const auto place = ask({0, 0}, [](QWidget& window) {
        auto& map = part<WorldMap>(window, "map");
        QTest::mouseClick(&map, Qt::LeftButton, {},
                          map.positionOf({-33.87, 151.21}).toPoint() + QPoint(1, 1));
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->latitude_deg, -33.87);
    EXPECT_DOUBLE_EQ(place->longitude_deg, 151.21);
}

TEST_F(LocationDialogTest, DraggingMovesTheMarkAndTheFields) {
    const auto place = ask({0, 0}, [](QWidget& window) {
        auto& map = part<WorldMap>(window, "map");
        QTest::mousePress(&map, Qt::LeftButton, {}, map.positionOf({0, -30}).toPoint());
        QTest::mouseMove(&map, map.positionOf({-10, -25}).toPoint());
        QTest::mouseMove(&map, map.positionOf({-40, -20}).toPoint());
        QTest::mouseRelease(&map, Qt::LeftButton, {}, map.positionOf({-40, -20}).toPoint());
        EXPECT_NEAR(textOf(window, "latitude").toDouble(), -40, 0.6);
        QTest::mouseMove(&map, map.positionOf({50, 50}).toPoint());
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_NEAR(place->latitude_deg, -40.0, 0.6);
    EXPECT_NEAR(place->longitude_deg, -20.0, 0.6);
}

TEST_F(LocationDialogTest, ArrowKeysMoveTheMarkOverThe180thMeridianToo) {
    const auto place = ask({10, 179.5}, [](QWidget& window) {
        auto& map = part(window, "map");
        map.setFocus();
        QTest::keyClick(&map, Qt::Key_Right);
        QTest::keyClick(&map, Qt::Key_Up, Qt::ShiftModifier);
        press(window, "ok");
    });
    ASSERT_TRUE(place);
    EXPECT_DOUBLE_EQ(place->longitude_deg, -179.5);
    EXPECT_DOUBLE_EQ(place->latitude_deg, 20);
}

TEST_F(LocationDialogTest, TellsTheCoordinatesUnderTheMouse) {
    ask({0, 0}, [](QWidget& window) {
        auto& map = part<WorldMap>(window, "map");
        QTest::mouseMove(&map, map.positionOf({-45.0, -120.0}).toPoint());
        const QString told = part<QLabel>(window, "hover").text();
        EXPECT_TRUE(told.contains("S")) << told.toStdString();
        EXPECT_TRUE(told.contains("W")) << told.toStdString();
        EXPECT_TRUE(told.startsWith("45") || told.startsWith("44")) << told.toStdString();
        press(window, "ok");
    });
}

TEST(WorldMapWidget, WheelZoomsAboutThePlaceUnderTheMouse) {
    WorldMap map;
    map.resize(720, 360);
    const Place sydney = {-33.87, 151.21};
    const QPointF before = map.positionOf(sydney);
    QWheelEvent wheel(before, map.mapToGlobal(before), {}, QPoint(0, 600), Qt::NoButton,
                      Qt::NoModifier, Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(&map, &wheel);
    EXPECT_NEAR(map.zoom(), 3.0518, 1e-4); // 1.25 to the power of 5
    EXPECT_NEAR(map.positionOf(sydney).x(), before.x(), 1e-6);
    EXPECT_NEAR(map.positionOf(sydney).y(), before.y(), 1e-6);
    QTest::keyClick(&map, Qt::Key_0);
    EXPECT_DOUBLE_EQ(map.zoom(), 1.0);
    EXPECT_NEAR(map.positionOf(sydney).x(), before.x(), 1e-6);
}

TEST(WorldMapWidget, PaintsSeaLandAndTheMarkWithoutStreaks) {
    WorldMap map;
    map.resize(720, 360);
    const QImage bare = map.grab().toImage();
    const auto colourAt = [&](const QImage& picture, const Place& place) {
        return picture.pixelColor(map.positionOf(place).toPoint());
    };
    const QColor sea = colourAt(bare, {-45, -135});
    const QColor land = colourAt(bare, {20, 15});
    EXPECT_GT(sea.blue(), sea.red() + 15);
    EXPECT_GE(land.red(), land.blue());
    // No line runs from Chukotka to the other edge of the map.
    for (const double latitude : {68.5, 67.5})
        EXPECT_EQ(colourAt(bare, {latitude, -12.0}), colourAt(bare, {latitude, -3.0}));
    map.setPlace(Place{20, 15});
    EXPECT_NE(colourAt(map.grab().toImage(), {20, 15}), land);
}

} // namespace
} // namespace quarn::desktop
