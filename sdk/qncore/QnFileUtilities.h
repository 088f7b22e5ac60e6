#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

/// Questions about files and folders. Paths are absolute or relative to the working folder.
class QNCORE_API CQuarnFileUtilities {
public:
    CQuarnFileUtilities() = delete;

    /// The folder for the user's documents, without a separator at its end.
    /// @return false, with `folder` untouched, when no such folder is known
    static bool GetMyDocumentsFolder(KM_wString& folder);
    /// Whether a folder of this name exists. False for null and for a file.
    static bool DirExists(const wchar_t* path);
    /// Makes the folder, and those above it, where it does not exist.
    /// @return true when it exists now; false, and the host tells why, when it cannot be made;
    ///         false without a word when there is no path
    static bool CreateDir(const wchar_t* path);
};
