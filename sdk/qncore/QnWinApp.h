#pragma once

#include "sdk/qncore/QnExport.h"

/// A plug-in file's application object. A plug-in file has exactly one, a global object; the host
/// calls InitInstance after the file's version is checked and ExitInstance before the file is
/// unloaded.
class QNCORE_API CWinApp {
public:
    CWinApp();
    virtual ~CWinApp();
    CWinApp(const CWinApp&) = delete;
    CWinApp& operator=(const CWinApp&) = delete;

    /// Called once, before the plug-in's OnLoadPlugIn.
    /// @return true to go on; false refuses the load. The base returns true.
    virtual bool InitInstance();

    /// Called once, after the plug-in's OnUnloadPlugIn. The result is not used; the base returns 0.
    virtual int ExitInstance();
};
