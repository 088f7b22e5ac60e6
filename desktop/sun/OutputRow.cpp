#include "desktop/sun/OutputRow.h"

#include "desktop/dialogs/Choosers.h"
#include "desktop/texts/Texts.h"

#include <QFileInfo>
#include <QLineEdit>
#include <QPushButton>

namespace quarn::desktop {

namespace {

OutputRow makeRow(const char* name, const char* button, const std::filesystem::path& offered,
                  QWidget* form) {
    const OutputRow row{new QLineEdit(qtText(offered), form),
                        new QPushButton(localized(L"Choose…", 45541), form)};
    row.path->setObjectName(name);
    row.choose->setObjectName(button);
    row.choose->setAutoDefault(false);
    return row;
}

std::filesystem::path typed(const QLineEdit& field) {
    return nativePath(field.text().trimmed());
}

} // namespace

OutputRow makeFolderRow(const std::filesystem::path& offered, QWidget* form) {
    const OutputRow row = makeRow("folder", "chooseFolder", offered, form);
    QObject::connect(row.choose, &QPushButton::clicked, form, [row, form] {
        const auto chosen = askFolder(
            form, localized(L"Folder for the files", 45542).toStdWString(), L"", typed(*row.path));
        if (chosen)
            row.path->setText(qtText(*chosen));
    });
    return row;
}

QString folderFlaw(const QString& folder) {
    const QFileInfo there(folder.trimmed());
    if (folder.trimmed().isEmpty() || !there.isDir())
        return localized(L"There is no folder \"%1\". Choose one that is there.", 45543)
            .arg(folder.trimmed());
    if (!there.isWritable())
        return localized(L"Nothing can be written to the folder \"%1\". Choose another one.", 45544)
            .arg(folder.trimmed());
    return {};
}

OutputRow makeDiagramRow(const std::filesystem::path& offered, QWidget* form) {
    const OutputRow row = makeRow("file", "chooseFile", offered, form);
    QObject::connect(row.choose, &QPushButton::clicked, form, [row, form] {
        FileQuestion question;
        question.kind = FileQuestion::Kind::save;
        question.title = wideText(localized(L"Save the diagram", 45545));
        question.file_kinds = {{wideText(localized(L"SVG drawings", 45546)), {"svg"}},
                               {wideText(localized(L"PNG pictures", 45547)), {"png"}}};
        question.start = typed(*row.path);
        const FileChoice chosen = askFile(form, question);
        if (chosen.kind == FileChoice::Kind::chosen)
            row.path->setText(qtText(chosen.file));
    });
    return row;
}

} // namespace quarn::desktop
