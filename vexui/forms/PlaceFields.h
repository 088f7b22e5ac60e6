#pragma once

#include "kelmar/KM_AnimationProperties.h"

#include <QString>

class QLabel;

namespace vexui {

class NumberField;

/// The fields of a sun study's place.
struct PlaceFields {
    NumberField* latitude = nullptr;
    NumberField* longitude = nullptr;
    NumberField* north_angle = nullptr;
    QLabel* zone = nullptr;

    /// Shows a record's place. Its longitude may be counted from 0 to 360: it is shown from -180 to
    /// 180, and so it is taken.
    void show(const KM_3dmAnimationProperties& record) const;
    /// Lets the person choose the place in a table or on a map.
    void choose() const;
    /// Tells whose clock the times are of.
    void tellZone() const;
    void takeInto(KM_3dmAnimationProperties& record) const;

    QString latitudeFault() const;
    QString longitudeFault() const;
    QString northAngleFault() const;
};

} // namespace vexui
