#include "vexui/forms/RecordingFields.h"

#include "vexui/texts/LocalText.h"

#include <QComboBox>
#include <QLineEdit>

namespace vexui {

void RecordingFields::takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const {
    record.SetHtmlFilename(fromQt(nameText()));
    if (file_types->count() > 0)
        lists.SetFileListSelection(file_types->currentIndex());
    if (capture_methods->count() > 0)
        lists.SetCaptureListSelection(capture_methods->currentIndex());
    if (viewports->count() > 0)
        lists.SetViewportListSelection(viewports->currentIndex());
}

QString RecordingFields::nameText() const {
    return name->text();
}

} // namespace vexui
