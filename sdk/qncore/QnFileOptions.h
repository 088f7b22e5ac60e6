#pragma once

#include "sdk/qncore/QnExport.h"

namespace quarn {
struct FileOptionsAccess;
}

/// How a document is being saved. Made by the host; valid during the call that it is handed to.
class QNCORE_API CQuarnFileWriteOptions {
public:
    /// Whether only the selected objects are saved, and not the document around them.
    bool SelectedObjectFilter() const { return m_selected_only; }
    /// The version of the file that is written. Below the current one when a document is saved for
    /// an older program.
    int Quarn3dmVersion() const { return m_version; }
    /// The number of the document that is saved, for CQuarnDoc::FromRuntimeSerialNumber.
    unsigned int DocumentSerialNumber() const { return m_document_serial_number; }

private:
    friend struct quarn::FileOptionsAccess;
    CQuarnFileWriteOptions() = default;
    bool m_selected_only = false;
    int m_version = 0;
    unsigned int m_document_serial_number = 0;
};

/// Why a document file is being read. Made by the host; valid during the call that it is handed to.
class QNCORE_API CQuarnFileReadOptions {
public:
    /// Ways of reading. The first two read into a document that exists already.
    enum ModeFlag : unsigned int {
        import_mode = 1, ///< a person adds the file to the document
        insert_mode = 2, ///< a program adds the file to the document
        open_mode = 4,   ///< the file becomes a document of its own
    };

    /// Whether the file is read in this way.
    bool Mode(ModeFlag flag) const { return (m_modes & flag) != 0; }

private:
    friend struct quarn::FileOptionsAccess;
    CQuarnFileReadOptions() = default;
    unsigned int m_modes = 0;
};
