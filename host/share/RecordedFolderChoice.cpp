#include "host/share/RecordedFolderChoice.h"

#include "ground/PathText.h"
#include "host/commands/FileAsking.h"
#include "host/commands/WordsLeft.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnDirDialog.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

KM_wString firstFolder(CQuarnDoc& document) {
    const KM_wString recorded = document.Properties().AnimationProperties().FolderName();
    return recorded.IsEmpty() ? textFromPath(firstChooserFolder()) : recorded;
}

} // namespace

std::optional<std::filesystem::path> chooseRecordedFolder(const CQuarnCommandContext& context,
                                                          const wchar_t* title) {
    if (!context.IsInteractive() || hasWordsLeft())
        return std::nullopt;
    const KM_wString first = firstFolder(context.Document());
    CQuarnUiDirDialog dialog(title, QnLocalizeString(L"Folder with recorded frames", 42740),
                             first.Array(), nullptr);
    if (dialog.DoModal() != QnDialogConfirmed)
        return std::nullopt;
    return pathFromText(dialog.GetPathName().View());
}

} // namespace quarn
