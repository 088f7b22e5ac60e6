#pragma once

#include "sdk/qncore/QnWinApp.h"

/// The application object of the plug-in file. It adds nothing to the host's.
class CZoetrixApp : public CWinApp {
public:
    /// @return true: the plug-in file can always be used
    bool InitInstance() override;
};
