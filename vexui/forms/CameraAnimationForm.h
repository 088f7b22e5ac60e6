#pragma once

#include "vexui/forms/Form.h"

namespace vexui {

class CountField;

/// The form of animations whose camera moves: a turntable, or along curves, where the curves tell
/// the direction.
class CameraAnimationForm final : public Form {
public:
    enum class Kind { turntable, path };

    /// @param lists   shown, with their selections
    /// @param record  its frame count and name are shown; a count below 1 as 1
    /// @param owner   null for none
    CameraAnimationForm(Kind kind, const IZoetrixDataUI& lists,
                        const KM_3dmAnimationProperties& record, QWidget* owner);

    /// Writes the selections, the frame count and the name.
    void takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const override;

private:
    void addMotion(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record);
    QString frameFault() const;
    Outcome outcome() const;
    QString framesText(int count) const;

    Kind m_kind;
    CountField* m_frames = nullptr;
    QComboBox* m_directions = nullptr;
    RecordingFields m_recording;
};

} // namespace vexui
