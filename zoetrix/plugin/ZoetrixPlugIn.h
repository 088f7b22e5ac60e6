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

    /// True when there is an animation to keep: the whole document is saved, for a program that
    /// knows animations (version 4 or above), the record has a kind and both point arrays hold
    /// points.
    bool CallWriteDocument(const CQuarnFileWriteOptions& options) override;
    /// Writes the record behind the chunk version 5.0; nothing, with success, when only selected
    /// objects are saved or the file is for a version below 4.
    /// @return false when the archive or the record refuses
    bool WriteDocument(CQuarnDoc& doc, KM_BinaryArchive& archive,
                       const CQuarnFileWriteOptions& options) override;
    /// Replaces the record by the one in the archive. A read into a document that exists already
    /// first empties the record, so that a chunk which cannot be read leaves nothing to be played.
    /// @return false when the archive holds no record
    bool ReadDocument(CQuarnDoc& doc, KM_BinaryArchive& archive,
                      const CQuarnFileReadOptions& options) override;

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
