#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "sdk/vexui/VexUi.h"

#include <QString>

class QComboBox;
class QLineEdit;

namespace vexui {

/// The fields that every form ends with: how frames are drawn and recorded, and the name.
struct RecordingFields {
    QComboBox* file_types = nullptr;
    QComboBox* capture_methods = nullptr;
    QComboBox* viewports = nullptr;
    QLineEdit* name = nullptr;

    /// What is selected goes into the lists, the name into the record. A list without entries keeps
    /// the selection it came with.
    void takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const;

    QString nameText() const;
};

} // namespace vexui
