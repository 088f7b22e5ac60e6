#pragma once

#include <QString>

#include <filesystem>

class QLineEdit;
class QPushButton;
class QWidget;

namespace quarn::desktop {

/// A field for where files go to, with a button that lets the person choose it.
struct OutputRow {
    QLineEdit* path;
    QPushButton* choose;
};

/// They are called `folder` and `chooseFolder`.
OutputRow makeFolderRow(const std::filesystem::path& offered, QWidget* form);
/// Why files cannot be put into a folder, in a sentence; empty where they can.
QString folderFlaw(const QString& folder);

/// A diagram's file; they are called `file` and `chooseFile`.
OutputRow makeDiagramRow(const std::filesystem::path& offered, QWidget* form);

} // namespace quarn::desktop
