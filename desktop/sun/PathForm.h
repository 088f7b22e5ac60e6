#pragma once

#include "desktop/sun/SunDialog.h"
#include "desktop/sun/SunOffer.h"
#include "host/session/SunPath.h"

class QComboBox;
class QLineEdit;
class QSpinBox;

namespace quarn::desktop {

class PlaceRows;

/// Asks for a diagram of the sun's paths, and where its file goes.
///
/// Its fields are called as those of PlaceRows, and `year`, `projection`, `point`, `file` and
/// `chooseFile`.
class PathForm final : public SunDialog {
public:
    PathForm(const SunOffer& offer, QWidget* owner);

    /// What is asked for, once the form was taken.
    SunPathRequest request() const;
    StudiedSite site() const;

private:
    void addDiagram();
    void addChecks();
    QString fileFlaw() const;

    SunOffer m_offer;
    PlaceRows* m_place;
    QSpinBox* m_year = nullptr;
    QComboBox* m_projection = nullptr;
    QLineEdit* m_point = nullptr;
    QLineEdit* m_file = nullptr;
};

} // namespace quarn::desktop
