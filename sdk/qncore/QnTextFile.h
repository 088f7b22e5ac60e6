#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

#include <memory>

/// Writes a text file. The file appears when it is closed, whole or not at all.
class QNCORE_API CQnTextFile {
public:
    enum class filetype : int {
        ansi = 0,     ///< Latin-1; other characters become '?'
        utf8 = 1,     ///< UTF-8
        utf8_bom = 2, ///< UTF-8 with a byte-order mark, so that a browser reads every script right
    };
    enum class open_mode : int { write = 1 };

    CQnTextFile();
    /// Closes the file. Call Close to know whether it could be written.
    ~CQnTextFile();
    CQnTextFile(const CQnTextFile&) = delete;
    CQnTextFile& operator=(const CQnTextFile&) = delete;

    /// @return false when the folder does not exist or cannot be written, when the path is a
    ///         folder, or when a file is open already
    bool Open(const wchar_t* path, open_mode mode, filetype type);
    /// Adds text. @return false when no file is open
    bool WriteString(const wchar_t* text);
    /// Writes the file and puts it in its place.
    /// @return false when no file was open, or when it cannot be written: the host tells why, and
    ///         what was at the path before is untouched
    bool Close();

private:
    struct State;
    std::unique_ptr<State> m_state;
};
