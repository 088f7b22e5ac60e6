#pragma once

#include "sdk/qncore/QnFileOptions.h"

namespace quarn {

/// Makes the options that plug-ins are called with; only the host can.
struct FileOptionsAccess {
    static CQuarnFileWriteOptions forWriting(bool selected_only, int version,
                                             unsigned int document_serial_number) {
        CQuarnFileWriteOptions options;
        options.m_selected_only = selected_only;
        options.m_version = version;
        options.m_document_serial_number = document_serial_number;
        return options;
    }

    /// @param modes  CQuarnFileReadOptions::ModeFlag values, joined by |
    static CQuarnFileReadOptions forReading(unsigned int modes) {
        CQuarnFileReadOptions options;
        options.m_modes = modes;
        return options;
    }
};

} // namespace quarn
