#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "sdk/zel/QnSunStudyPlace.h"

#include <QString>

#include <optional>

class QLabel;
class QLineEdit;

namespace vexui {

class NumberField;

/// The fields of a sun study's place.
struct PlaceFields {
    NumberField* latitude = nullptr;
    NumberField* longitude = nullptr;
    NumberField* north_angle = nullptr;
    QLabel* zone = nullptr;
    QLabel* city = nullptr;
    QLineEdit* clocks = nullptr; ///< of the walls there
    bool has_own_clocks = false; ///< that the person named; else they follow the place

    /// Shows a record's place. Its longitude may be counted from 0 to 360: it is shown from -180 to
    /// 180, and so it is taken.
    void show(const KM_3dmAnimationProperties& record) const;
    /// The place that stands in the fields; nothing while one cannot be taken.
    std::optional<QnSunStudyPlace> place() const;
    /// Shows city and clocks of the place that stands in the fields now.
    void followPlace() const;
    /// Lets the person choose the place in a table or on a map.
    void choose() const;
    /// Tells whose clock the times are of.
    void tellZone() const;
    void takeInto(KM_3dmAnimationProperties& record) const;

    QString latitudeFault() const;
    QString longitudeFault() const;
    QString northAngleFault() const;
    QString clocksFault() const;
};

} // namespace vexui
