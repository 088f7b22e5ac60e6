#include "desktop/dialogs/LocationDialog.h"

#include "desktop/dialogs/CityTableModel.h"
#include "desktop/dialogs/DialogOwner.h"
#include "desktop/dialogs/FieldMark.h"
#include "desktop/dialogs/PlaceText.h"
#include "desktop/dialogs/WorldMap.h"
#include "desktop/texts/Texts.h"

#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QScopedValueRollback>
#include <QScreen>
#include <QTableView>
#include <QVBoxLayout>

namespace quarn::desktop {
namespace {

using Flaw = LocationChoice::Flaw;

QString latitudeFlaw(Flaw flaw) {
    switch (flaw) {
    case Flaw::no_number:
        return localized(L"Latitude: enter a number", 45304);
    case Flaw::out_of_range:
        return localized(L"Latitude: enter a number between -90 and 90", 45306);
    case Flaw::none:
        break;
    }
    return {};
}

QString longitudeFlaw(Flaw flaw) {
    switch (flaw) {
    case Flaw::no_number:
        return localized(L"Longitude: enter a number", 45305);
    case Flaw::out_of_range:
        return localized(L"Longitude: enter a number between -180 and 180", 45307);
    case Flaw::none:
        break;
    }
    return {};
}

QLabel* makeLabel(const QString& text, QWidget* buddy, QWidget* parent) {
    auto* const label = new QLabel(text, parent);
    label->setBuddy(buddy);
    return label;
}

QPushButton* makeButton(const char* name, const QString& text, QWidget* parent) {
    auto* const button = new QPushButton(text, parent);
    button->setObjectName(name);
    button->setMinimumWidth(button->fontMetrics().averageCharWidth() * 14);
    return button;
}

} // namespace

LocationDialog::LocationDialog(QWidget* owner, std::wstring_view title, const Place& start)
    : QDialog(owner), m_choice(start) {
    setObjectName("location");
    setWindowTitle(qtText(title));
    setWindowModality(Qt::ApplicationModal);
    layOut();
    connectParts();
    search({});
    showChoice();
    m_search->setFocus();
}

void LocationDialog::layOut() {
    auto* const sides = new QHBoxLayout;
    sides->setSpacing(16);
    sides->addLayout(citiesSide(), 2);
    sides->addLayout(mapSide(), 5);
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(18, 18, 18, 14);
    column->setSpacing(14);
    column->addLayout(sides, 1);
    column->addLayout(buttonsRow());
    const QList<QWidget*> order = {m_search, m_table, m_map, m_latitude, m_longitude, m_ok};
    for (qsizetype index = 1; index < order.size(); ++index)
        setTabOrder(order[index - 1], order[index]);
    constexpr QSize roomy(1180, 500);
    resize(roomy.boundedTo(screen()->availableSize()));
}

QLayout* LocationDialog::citiesSide() {
    m_search = new QLineEdit(this);
    m_search->setObjectName("search");
    m_search->setPlaceholderText(localized(L"Search for a city or a country", 45309));
    m_search->setAccessibleName(m_search->placeholderText());
    m_search->setClearButtonEnabled(true);
    m_search->installEventFilter(this);
    m_cities = new CityTableModel(this);
    m_table = new QTableView(this);
    m_table->setObjectName("cities");
    m_table->setAccessibleName(localized(L"Cities", 45312));
    m_table->setModel(m_cities);
    m_table->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_table->setSelectionMode(QAbstractItemView::SingleSelection);
    m_table->setTabKeyNavigation(false);
    m_table->setShowGrid(false);
    m_table->setAlternatingRowColors(true);
    m_table->setWordWrap(false);
    m_table->verticalHeader()->hide();
    m_table->verticalHeader()->setDefaultSectionSize(m_table->fontMetrics().height() + 7);
    m_table->horizontalHeader()->setHighlightSections(false);
    m_table->horizontalHeader()->setStretchLastSection(true);
    m_table->setMinimumWidth(m_table->fontMetrics().averageCharWidth() * 66);
    auto* const side = new QVBoxLayout;
    side->addWidget(m_search);
    side->addWidget(m_table, 1);
    return side;
}

QLayout* LocationDialog::mapSide() {
    m_map = new WorldMap(this);
    m_map->setObjectName("map");
    m_hover = new QLabel(this);
    m_hover->setObjectName("hover");
    m_hover->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    showHovered({});
    m_flaw = new QLabel(this);
    m_flaw->setObjectName("flaw");
    QPalette warning = m_flaw->palette();
    warning.setColor(QPalette::WindowText, warningColour(warning));
    m_flaw->setPalette(warning);
    auto* const told = new QHBoxLayout;
    told->addWidget(m_flaw, 1);
    told->addWidget(m_hover);
    auto* const side = new QVBoxLayout;
    side->addWidget(m_map, 1);
    side->addLayout(told);
    side->addLayout(fieldsRow());
    return side;
}

QLayout* LocationDialog::fieldsRow() {
    m_latitude = makeAngleField(
        "latitude",
        localized(L"Degrees from -90 to 90, north positive, as 48.14 or 33.87 S", 45320));
    m_longitude = makeAngleField(
        "longitude",
        localized(L"Degrees from -180 to 180, east positive, as 11.58 or 70.67 W", 45321));
    auto* const row = new QHBoxLayout;
    row->setSpacing(10);
    row->addWidget(makeLabel(localized(L"&Latitude", 45345), m_latitude, this));
    row->addWidget(m_latitude);
    row->addSpacing(10);
    row->addWidget(makeLabel(localized(L"L&ongitude", 45346), m_longitude, this));
    row->addWidget(m_longitude);
    row->addStretch(1);
    return row;
}

QLineEdit* LocationDialog::makeAngleField(const char* name, const QString& hint) {
    auto* const field = new QLineEdit(this);
    field->setObjectName(name);
    field->setToolTip(hint);
    field->setFixedWidth(field->fontMetrics().averageCharWidth() * 17);
    return field;
}

QLayout* LocationDialog::buttonsRow() {
    auto* const hint =
        new QLabel(localized(L"Click on the map or drag the mark; the wheel zooms.", 45314), this);
    hint->setForegroundRole(QPalette::PlaceholderText);
    m_ok = makeButton("ok", localized(L"OK", 45300), this);
    m_ok->setDefault(true);
    QPushButton* const cancel = makeButton("cancel", localized(L"Cancel", 45301), this);
    connect(m_ok, &QPushButton::clicked, this, &QDialog::accept);
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
    auto* const row = new QHBoxLayout;
    row->addWidget(hint, 1);
    row->addWidget(m_ok);
    row->addWidget(cancel);
    return row;
}

void LocationDialog::connectParts() {
    connect(m_search, &QLineEdit::textChanged, this, &LocationDialog::search);
    connect(m_latitude, &QLineEdit::textEdited, this, [this](const QString& text) {
        m_choice.typeLatitude(text.toStdWString());
        showChoice();
    });
    connect(m_longitude, &QLineEdit::textEdited, this, [this](const QString& text) {
        m_choice.typeLongitude(text.toStdWString());
        showChoice();
    });
    connect(m_map, &WorldMap::placeChosen, this, [this](const Place& place) {
        m_choice.choose(place);
        showChoice();
    });
    connect(m_map, &WorldMap::hovered, this, &LocationDialog::showHovered);
    connect(m_table->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this](const QModelIndex& row) {
                const City* const city = m_cities->cityAt(row.row());
                if (m_is_showing || !city)
                    return;
                m_choice.choose(*city);
                showChoice();
            });
    connect(m_table, &QTableView::doubleClicked, this, &QDialog::accept);
}

void LocationDialog::search(const QString& text) {
    const QScopedValueRollback showing(m_is_showing, true);
    m_choice.search(text.toStdWString());
    m_cities->show(m_choice.listedCities());
    m_table->doItemsLayout(); // so that there is something to scroll
    showCityRow();
}

/// Enter in the search field takes the best city first, and confirms once it is the chosen one.
bool LocationDialog::wantsFirstCity() const {
    const City* const first = m_cities->cityAt(0);
    return !m_search->text().trimmed().isEmpty() && first && m_choice.cityHere() != first &&
           m_cities->rowOf(m_choice.cityHere()) < 0;
}

void LocationDialog::chooseFirstCity() {
    m_choice.choose(*m_cities->cityAt(0));
    showChoice();
}

bool LocationDialog::eventFilter(QObject* watched, QEvent* event) {
    if (watched != m_search || event->type() != QEvent::KeyPress)
        return QDialog::eventFilter(watched, event);
    const int key = static_cast<QKeyEvent*>(event)->key();
    if ((key == Qt::Key_Return || key == Qt::Key_Enter) && wantsFirstCity()) {
        chooseFirstCity();
        return true;
    }
    if (key == Qt::Key_Down && m_cities->rowCount() > 0) {
        m_table->setFocus();
        if (!m_table->currentIndex().isValid())
            m_table->setCurrentIndex(m_cities->index(0, 0));
        return true;
    }
    return QDialog::eventFilter(watched, event);
}

/// The rows can be scrolled to once the table has its size.
void LocationDialog::showEvent(QShowEvent* event) {
    const QScopedValueRollback showing(m_is_showing, true);
    QDialog::showEvent(event);
    m_table->resizeColumnToContents(2);
    const int for_names = m_table->viewport()->width() - m_table->columnWidth(2);
    m_table->setColumnWidth(0, for_names * 54 / 100);
    m_table->setColumnWidth(1, for_names * 46 / 100);
    m_table->setCurrentIndex({}); // so that its row is scrolled to
    showCityRow();
}

void LocationDialog::showChoice() {
    const QScopedValueRollback showing(m_is_showing, true);
    const auto show = [](QLineEdit* field, const std::wstring& text) {
        if (field->text().toStdWString() != text)
            field->setText(QString::fromStdWString(text));
    };
    show(m_latitude, m_choice.latitudeText());
    show(m_longitude, m_choice.longitudeText());
    m_map->setPlace(m_choice.place());
    showFlaws();
    showCityRow();
}

void LocationDialog::showFlaws() {
    const QString latitude = latitudeFlaw(m_choice.latitudeFlaw());
    const QString longitude = longitudeFlaw(m_choice.longitudeFlaw());
    markField(*m_latitude, latitude);
    markField(*m_longitude, longitude);
    m_flaw->setText(latitude.isEmpty() ? longitude : latitude);
    m_ok->setEnabled(m_choice.isValid());
}

/// Selects the city that is chosen; else shows where the nearest one stands.
void LocationDialog::showCityRow() {
    const QScopedValueRollback showing(m_is_showing, true);
    const int here = m_cities->rowOf(m_choice.cityHere());
    if (here >= 0 && m_table->currentIndex().row() == here)
        return;
    if (here >= 0)
        m_table->selectRow(here);
    else
        m_table->setCurrentIndex({});
    const int shown = here >= 0 ? here : m_cities->rowOf(m_choice.nearestCity());
    if (shown >= 0)
        m_table->scrollTo(m_cities->index(shown, 0), QAbstractItemView::PositionAtCenter);
}

/// The label keeps its height when it is empty.
void LocationDialog::showHovered(const std::optional<Place>& place) {
    m_hover->setText(place ? placeText(*place) : QString(" "));
}

std::optional<Place> askPlace(QWidget* owner, std::wstring_view title, const Place& start) {
    const QPointer<LocationDialog> dialog = new LocationDialog(topmostOwner(owner), title, start);
    const bool is_confirmed = dialog->exec() == QDialog::Accepted;
    const std::optional<Place> place =
        dialog && is_confirmed ? dialog->place() : std::optional<Place>();
    delete dialog.data();
    return place;
}

} // namespace quarn::desktop
