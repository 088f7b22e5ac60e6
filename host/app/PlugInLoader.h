#pragma once

#include "host/app/LibraryFile.h"
#include "host/app/PendingObjects.h"
#include "host/front_end/Session.h"
#include "kelmar/KM_Uuid.h"

#include <filesystem>
#include <map>
#include <memory>
#include <vector>

namespace quarn {

class Application;

/// Loads plug-ins and keeps them until the session ends.
class PlugInLoader {
public:
    explicit PlugInLoader(Application& application);
    /// Unloads all plug-ins, the last loaded first.
    ~PlugInLoader();
    PlugInLoader(const PlugInLoader&) = delete;
    PlugInLoader& operator=(const PlugInLoader&) = delete;

    /// Loads a plug-in file.
    /// @param ignore_disabled  also one that says it is never to be loaded
    PlugInLoad load(const std::filesystem::path& file, bool ignore_disabled = true);

    /// Loads a plug-in by its id: the host's dialog plug-in, or one that was loaded before in this
    /// session, from the file it came from.
    PlugInLoad loadById(const KM_UUID& id, bool ignore_disabled);

    /// As Session::adoptProgramPlugIn.
    PlugInLoad adoptProgram();

    bool isLoaded(const KM_UUID& id) const { return find(id) != nullptr; }

    /// The address of a name that a loaded plug-in exports; null when the plug-in is not loaded or
    /// exports no such name.
    void* findEntry(const KM_UUID& plug_in_id, const char* name) const;

private:
    struct Loaded;

    PlugInLoad open(const std::filesystem::path& file, bool ignore_disabled);
    PlugInLoad commit(Loaded& candidate, const PendingObjects& objects, bool ignore_disabled);
    PlugInLoad adopt(std::unique_ptr<Loaded> candidate, const PendingObjects& objects,
                     bool ignore_disabled);
    PlugInLoad registerCommands(Loaded& candidate);
    PlugInLoad startUp(Loaded& candidate);
    void loadTexts(const Loaded& candidate);
    void withdraw(Loaded& loaded);
    void unload(Loaded& loaded);

    const Loaded* find(const KM_UUID& id) const;
    std::filesystem::path findInFolders(const std::filesystem::path& name) const;

    Application& m_application;
    std::vector<std::unique_ptr<Loaded>> m_loaded;
    std::map<KM_UUID, std::filesystem::path> m_catalogue; ///< id to file, or to a file's name
};

} // namespace quarn
