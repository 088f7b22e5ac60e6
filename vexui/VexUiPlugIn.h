#pragma once

#include "sdk/qncore/QnPlugIn.h"

/// The plug-in that shows the forms of the animation commands.
class CVexUiPlugIn final : public CQuarnUtilitySystemPlugIn {
public:
    const wchar_t* PlugInName() const override;
    const wchar_t* LocalPlugInName() const override;
    const wchar_t* PlugInVersion() const override;
    KM_UUID PlugInID() const override;
    plugin_load_time PlugInLoadTime() const override;
    /// Refuses, after a message, in a program that has no windows.
    bool OnLoadPlugIn() override;
};
