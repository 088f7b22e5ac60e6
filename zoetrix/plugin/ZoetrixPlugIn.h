#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnPlugIn.h"

#include <memory>

class CQuarnDoc;
class CZoetrixDynamicAccess;

/// The plug-in object. It keeps the one animation record there is: every document is served by the
/// same record, so the document argument of the record operations is not looked at.
class CZoetrixPlugIn : public CQuarnUtilitySystemPlugIn {
public:
    /// A plug-in that is not loaded: the record holds a record's own defaults and the host knows of
    /// no dynamic access.
    CZoetrixPlugIn();
    /// Takes the dynamic access away from the host before anything of it goes.
    ~CZoetrixPlugIn() override;

    const wchar_t* PlugInName() const override;
    const wchar_t* LocalPlugInName() const override;
    /// Date and time at which the plug-in object's source was compiled: "Oct  1 2019  01:23:00",
    /// with two blanks between and the day padded with a blank.
    const wchar_t* PlugInVersion() const override;
    KM_UUID PlugInID() const override;
    plugin_load_time PlugInLoadTime() const override; ///< load_when_needed

    /// Registers the dynamic access with the host and gives the record its starting values.
    bool OnLoadPlugIn() override;
    /// Takes the dynamic access away from the host. The record keeps its last value.
    void OnUnloadPlugIn() override;

    /// The record. Commands copy it, change the copy, and hand the copy back through the document's
    /// properties. Valid as long as the plug-in.
    const KM_3dmAnimationProperties& AnimationProperties(const CQuarnDoc& doc) const;
    /// The record, for change in place. Valid as long as the plug-in.
    KM_3dmAnimationProperties& AnimationPropertiesForWrite(const CQuarnDoc& doc);
    /// Replaces the whole record by a copy of this one.
    void SetAnimationProperties(const CQuarnDoc& doc, const KM_3dmAnimationProperties& props);

private:
    void RemoveDynamicAccess();

    KM_wString m_version;
    std::unique_ptr<CZoetrixDynamicAccess> m_dynamic_access; ///< null while not loaded
    KM_3dmAnimationProperties m_animation;
};

/// The one plug-in object. Lives as long as the plug-in file is loaded.
CZoetrixPlugIn& ZoetrixPlugIn();
