#pragma once

#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnFileOptions.h"

class CQuarnDoc;
class KM_BinaryArchive;

/// The base of every plug-in. A plug-in file has exactly one such object, a global one. Its
/// constructor only announces it: the host looks at it after the file's version exports were
/// checked, and forgets it when they are wrong. No constructor of a global object of the file may
/// throw: the linker ends the program then.
///
/// A plug-in file exports `unsigned int QuarnPlugInSdkVersion()`,
/// `unsigned int QuarnPlugInSdkServiceRelease()`, and the wide-string functions
/// `QuarnPlugInUpdateURL()` and `QuarnPlugInDeveloperOrganization()`, `...Address()`,
/// `...Country()`, `...Phone()`, `...Fax()`, `...Email()`, `...Website()`.
class QNCORE_API CQuarnPlugIn {
public:
    /// When the host loads the plug-in by itself.
    enum plugin_load_time : int {
        load_disabled = 0,    ///< never
        load_at_start = 1,    ///< at every start, before the command line opens
        load_when_needed = 2, ///< when one of its commands or its id is asked for
        load_on_request = 3,  ///< only by the LoadPlugIn command
    };

    CQuarnPlugIn();
    virtual ~CQuarnPlugIn();
    CQuarnPlugIn(const CQuarnPlugIn&) = delete;
    CQuarnPlugIn& operator=(const CQuarnPlugIn&) = delete;

    /// The plug-in's English name: unique, never translated.
    virtual const wchar_t* PlugInName() const = 0;
    /// The plug-in's name in the user's language. The base returns PlugInName().
    virtual const wchar_t* LocalPlugInName() const;
    /// The plug-in's version text.
    virtual const wchar_t* PlugInVersion() const = 0;
    /// The plug-in's fixed id; never nil.
    virtual KM_UUID PlugInID() const = 0;
    /// See plugin_load_time. The base returns load_when_needed.
    virtual plugin_load_time PlugInLoadTime() const;
    /// The kind of plug-in; 16 is a utility plug-in.
    virtual unsigned int PlugInType() const = 0;

    /// Called once after the file passed the version checks and before its commands can run.
    /// @return true to be loaded; false refuses. The base returns true.
    virtual bool OnLoadPlugIn();
    /// Called once before the plug-in is unloaded. The base does nothing.
    virtual void OnUnloadPlugIn();

    /// Whether the plug-in has something to keep in the document file that is about to be written.
    /// The base returns false.
    virtual bool CallWriteDocument(const CQuarnFileWriteOptions& options);
    /// Writes the plug-in's chunk of a document file. Called after CallWriteDocument returned true.
    /// What is written begins with KM_BinaryArchive::Write3dmChunkVersion; a plug-in that writes
    /// nothing at all has no chunk.
    /// @param archive  the plug-in's own, valid during the call
    /// @return false when that failed: the document is not saved then. The base returns true.
    virtual bool WriteDocument(CQuarnDoc& doc, KM_BinaryArchive& archive,
                               const CQuarnFileWriteOptions& options);
    /// Reads the plug-in's chunk of a document file. The host calls it when a file with such a
    /// chunk was opened or imported, after its objects, views and lights are in the document, and
    /// when the plug-in is loaded while a document with such a chunk is open.
    /// @param archive  stands behind the chunk's version, which is archive.ChunkVersion(), and ends
    ///                 where the chunk ends; valid during the call
    /// @return false when the chunk cannot be read; the host tells that and keeps its bytes. The
    ///         base returns true.
    virtual bool ReadDocument(CQuarnDoc& doc, KM_BinaryArchive& archive,
                              const CQuarnFileReadOptions& options);

    /// Whether the plug-in with this id is loaded now.
    static bool PlugInIsLoaded(const KM_UUID& id);

    /// Loads the plug-in with this id from the host's plug-in folders.
    ///
    /// @param quietly      do not print why the load failed, nor what the plug-in itself printed
    ///                 meanwhile
    /// @param ignore_disabled  load it although it is marked as never to be loaded
    /// @return 0 when it was loaded now, 1 when it was loaded before, negative when it cannot be
    ///         loaded: -1 unknown id, -2 file missing or not a library, -3 exports missing,
    ///         -4 version mismatch, -5 load refused
    static int LoadPlugIn(const KM_UUID& id, bool quietly, bool ignore_disabled);
};

/// A plug-in that adds commands.
class QNCORE_API CQuarnUtilityPlugIn : public CQuarnPlugIn {
public:
    CQuarnUtilityPlugIn();
    ~CQuarnUtilityPlugIn() override;
    unsigned int PlugInType() const override; ///< 16
};

/// A utility plug-in that comes with the host: listed with the host's own parts.
class QNCORE_API CQuarnUtilitySystemPlugIn : public CQuarnUtilityPlugIn {
public:
    CQuarnUtilitySystemPlugIn();
    ~CQuarnUtilitySystemPlugIn() override;
};
