#pragma once

#include "host/app/LibraryFile.h"
#include "host/app/PendingObjects.h"
#include "host/front_end/PlugInLoad.h"
#include "kelmar/KM_Uuid.h"

#include <filesystem>
#include <map>
#include <memory>
#include <vector>

namespace quarn {

class Application;

/// A plug-in that is loaded. The object lives until the plug-in is unloaded.
struct LoadedPlugIn {
    KM_UUID id = KM_nil_uuid;
    CQuarnPlugIn* plug_in = nullptr;
};

/// Loads plug-ins and keeps them until the session ends.
class PlugInLoader {
public:
    explicit PlugInLoader(Application& application);
    /// Unloads all plug-ins, the last loaded first.
    ~PlugInLoader();
    PlugInLoader(const PlugInLoader&) = delete;
    PlugInLoader& operator=(const PlugInLoader&) = delete;

    /// Loads a plug-in file.
    PlugInLoad load(const std::filesystem::path& file);

    /// Loads a plug-in by its id: the animation plug-in, the host's dialog plug-in, or one that was
    /// loaded before in this session, from the file it came from.
    /// @param ignore_disabled  also one that says it is never to be loaded
    PlugInLoad loadById(const KM_UUID& id, bool ignore_disabled);

    /// As Session::adoptProgramPlugIn.
    PlugInLoad adoptProgram();

    bool isLoaded(const KM_UUID& id) const { return find(id) != nullptr; }
    /// The loaded plug-in with this id, or null.
    CQuarnPlugIn* findPlugIn(const KM_UUID& id) const;
    /// The loaded plug-ins in the order in which they were loaded.
    std::vector<LoadedPlugIn> loaded() const;

    /// The address of a name that a loaded plug-in exports; null when the plug-in is not loaded or
    /// exports no such name.
    void* findEntry(const KM_UUID& plug_in_id, const char* name) const;

private:
    struct Loaded;
    struct Request {
        std::filesystem::path file;
        bool ignore_disabled = true;
        KM_UUID wanted_id = KM_nil_uuid; ///< nil takes any
    };

    PlugInLoad load(const Request& request);
    PlugInLoad open(const Request& request);
    PlugInLoad adopt(std::unique_ptr<Loaded> candidate, const PendingObjects& objects,
                     const Request& request);
    PlugInLoad takeObjects(Loaded& candidate, const PendingObjects& objects) const;
    PlugInLoad identify(Loaded& candidate, const Request& request) const;
    PlugInLoad registerCommands(Loaded& candidate);
    PlugInLoad startUp(Loaded& candidate);
    void loadTexts(const Loaded& candidate);
    void readWhatWaited(const KM_UUID& id);
    void withdraw(Loaded& loaded);
    void unload(Loaded& loaded);

    const Loaded* find(const KM_UUID& id) const;
    std::filesystem::path findInFolders(const std::filesystem::path& name) const;

    Application& m_application;
    std::vector<std::unique_ptr<Loaded>> m_loaded;
    std::map<KM_UUID, std::filesystem::path> m_catalogue; ///< id to file, or to a file's name
};

} // namespace quarn
