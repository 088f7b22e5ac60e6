#include "host/app/PlugInLoader.h"

#include "host/app/Application.h"
#include "host/app/FileOptionsAccess.h"
#include "host/app/PlugInChunks.h"
#include "host/app/PlugInExports.h"
#include "host/border/Border.h"
#include "host/document/DisplayModeList.h"
#include "host/document/file/FileRemainder.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "sdk/vexui/VexUi.h"

#include <algorithm>

namespace quarn {

namespace {

using Outcome = PlugInLoad::Outcome;

/// What `adoptProgram` calls the file of the program's own plug-in.
constexpr const char* PROGRAM = "of this program";

PlugInLoad refused(const std::filesystem::path& file, const std::string& reason) {
    std::string message = "The plug-in " + file.string() + " was not loaded: " + reason;
    if (!message.ends_with("."))
        message += ".";
    return {Outcome::load_refused, std::move(message)};
}

} // namespace

/// A plug-in with what it brought along. The library comes first, so that it goes last.
struct PlugInLoader::Loaded {
    LibraryFile library; ///< nothing for the program itself
    std::filesystem::path file;
    CWinApp* application = nullptr;
    CQuarnPlugIn* plug_in = nullptr;
    KM_UUID id = KM_nil_uuid;
    std::vector<CQuarnCommand*> commands;
};

PlugInLoader::PlugInLoader(Application& application) : m_application(application) {
    m_catalogue[ZelVexUiPlugInId] = "ZEL_VexUI.qnp";
    m_catalogue[ZoetrixPlugInId] = "Zoetrix.qnp";
}

PlugInLoader::~PlugInLoader() {
    while (!m_loaded.empty()) {
        unload(*m_loaded.back());
        m_loaded.pop_back();
    }
}

// ---- Finding

const PlugInLoader::Loaded* PlugInLoader::find(const KM_UUID& id) const {
    const auto found =
        std::ranges::find(m_loaded, id, [](const auto& loaded) { return loaded->id; });
    return found == m_loaded.end() ? nullptr : found->get();
}

CQuarnPlugIn* PlugInLoader::findPlugIn(const KM_UUID& id) const {
    const Loaded* loaded = find(id);
    return loaded ? loaded->plug_in : nullptr;
}

std::vector<LoadedPlugIn> PlugInLoader::loaded() const {
    std::vector<LoadedPlugIn> plug_ins;
    for (const auto& loaded : m_loaded)
        plug_ins.push_back({loaded->id, loaded->plug_in});
    return plug_ins;
}

void* PlugInLoader::findEntry(const KM_UUID& plug_in_id, const char* name) const {
    const Loaded* loaded = find(plug_in_id);
    return loaded ? loaded->library.find(name) : nullptr;
}

std::filesystem::path PlugInLoader::findInFolders(const std::filesystem::path& name) const {
    for (const std::filesystem::path& folder : m_application.options().plug_in_folders) {
        std::error_code error;
        if (std::filesystem::exists(folder / name, error))
            return folder / name;
    }
    return name;
}

// ---- Loading

PlugInLoad PlugInLoader::loadById(const KM_UUID& id, bool ignore_disabled) {
    if (isLoaded(id))
        return {Outcome::loaded_before, {}};
    const auto known = m_catalogue.find(id);
    if (known == m_catalogue.end())
        return {Outcome::unknown_id,
                "No plug-in with the id " + KM_UuidToString(id).ToUtf8() + " is known."};
    return load(Request{findInFolders(known->second), ignore_disabled, id});
}

PlugInLoad PlugInLoader::load(const std::filesystem::path& file) {
    return load(Request{file});
}

PlugInLoad PlugInLoader::load(const Request& request) {
    const std::filesystem::path& file = request.file;
    std::error_code error;
    if (!std::filesystem::is_regular_file(file, error))
        return {Outcome::file_missing, "There is no plug-in file " + file.string() + "."};
    const std::filesystem::path whole_path = std::filesystem::canonical(file, error);
    if (error)
        return {Outcome::file_missing,
                "The plug-in file " + file.string() + " cannot be reached: " + error.message()};
    const auto same_file = [&](const auto& loaded) { return loaded->file == whole_path; };
    if (std::ranges::any_of(m_loaded, same_file))
        return {Outcome::loaded_before, {}};
    if (LibraryFile::isOpen(whole_path))
        return refused(whole_path, "the program has this file open already");
    IQnZoetrixDynamicAccess* const access_before = Zoetrix_QuarnDynamicAccess();
    PlugInLoad opened = open(Request{whole_path, request.ignore_disabled, request.wanted_id});
    // The objects of a refused file are gone now. One that removes its dynamic access as it goes
    // removes whichever is installed.
    if (!opened.ok())
        Zoetrix_SetQuarnDynamicAccess(access_before);
    return opened;
}

PlugInLoad PlugInLoader::open(const Request& request) {
    auto candidate = std::make_unique<Loaded>();
    candidate->file = request.file;
    PendingObjects objects;
    {
        const PendingObjects::Scope scope;
        Result<LibraryFile> library = LibraryFile::open(request.file);
        if (!library)
            return refusedByLinker(library.message(), request.file);
        candidate->library = std::move(library.value());
        objects = scope.objects();
    }
    if (PlugInLoad checked = checkExports(candidate->library, request.file); !checked.ok())
        return checked;
    return adopt(std::move(candidate), objects, request);
}

PlugInLoad PlugInLoader::adoptProgram() {
    const auto of_program = [](const auto& loaded) { return loaded->file == PROGRAM; };
    if (std::ranges::any_of(m_loaded, of_program))
        return {Outcome::loaded_before, {}};
    auto candidate = std::make_unique<Loaded>();
    candidate->file = PROGRAM;
    return adopt(std::move(candidate), PendingObjects::program(), Request{PROGRAM});
}

PlugInLoad PlugInLoader::adopt(std::unique_ptr<Loaded> candidate, const PendingObjects& objects,
                               const Request& request) {
    if (PlugInLoad taken = takeObjects(*candidate, objects); !taken.ok())
        return taken;
    if (PlugInLoad identified = identify(*candidate, request); !identified.ok())
        return identified;
    loadTexts(*candidate);
    PlugInLoad started = registerCommands(*candidate);
    if (started.ok())
        started = startUp(*candidate);
    if (!started.ok()) {
        withdraw(*candidate);
        return started;
    }
    m_catalogue[candidate->id] = candidate->file;
    m_loaded.push_back(std::move(candidate));
    m_application.documents().rememberFreshRecord();
    readWhatWaited(m_loaded.back()->id);
    return started;
}

/// A document that was opened before the plug-in was loaded kept what the plug-in has in its file.
void PlugInLoader::readWhatWaited(const KM_UUID& id) {
    Document* document = m_application.documents().active();
    if (!document)
        return;
    const PlugInContent* waiting = document->fileRemainder().find(id);
    if (!waiting)
        return;
    const auto options = FileOptionsAccess::forReading(CQuarnFileReadOptions::open_mode);
    for (const std::string& warning :
         readPlugInContents(m_application, *document, {*waiting}, options).warnings)
        m_application.tell(warning);
    document->markRecordSaved();
}

PlugInLoad PlugInLoader::takeObjects(Loaded& candidate, const PendingObjects& objects) const {
    if (objects.plug_ins.size() != 1)
        return refused(candidate.file, "it has " + std::to_string(objects.plug_ins.size()) +
                                           " plug-in objects instead of one");
    if (objects.applications.size() != 1)
        return refused(candidate.file, "it has " + std::to_string(objects.applications.size()) +
                                           " application objects instead of one");
    candidate.application = objects.applications.front();
    candidate.plug_in = objects.plug_ins.front();
    candidate.commands = objects.commands;
    return {};
}

PlugInLoad PlugInLoader::identify(Loaded& candidate, const Request& request) const {
    const CQuarnPlugIn& plug_in = *candidate.plug_in;
    const Result<KM_UUID> asked = acrossBorder([&] { return plug_in.PlugInID(); });
    if (!asked || KM_UuidIsNil(asked.value()))
        return refused(candidate.file, "it has no id");
    candidate.id = asked.value();
    const std::string id_text = KM_UuidToString(candidate.id).ToUtf8();
    if (!KM_UuidIsNil(request.wanted_id) && candidate.id != request.wanted_id)
        return refused(candidate.file, "it has another id (" + id_text + ") than was asked for");
    if (isLoaded(candidate.id))
        return refused(candidate.file, "a plug-in with the id " + id_text + " is loaded");

    const auto load_time = acrossBorder([&] { return plug_in.PlugInLoadTime(); });
    if (load_time && load_time.value() == CQuarnPlugIn::load_disabled && !request.ignore_disabled)
        return refused(candidate.file, "it is marked as never to be loaded");
    return {};
}

/// Adds the plug-in's texts. They may name display modes in a language that the host has no table
/// of; the plug-in then compares its texts with the modes' names, so the modes take them over.
void PlugInLoader::loadTexts(const Loaded& candidate) {
    const std::filesystem::path name = candidate.file.stem();
    std::vector<std::filesystem::path> folders = {candidate.file.parent_path() / "locale" / name};
    for (const std::filesystem::path& host_folder : m_application.options().locale_folders)
        folders.push_back(host_folder.parent_path() / name);
    if (Result<void> texts = m_application.texts().load(candidate.file.string(), folders); !texts)
        m_application.tell(texts.message());
    DisplayModeList::instance().localize();
}

PlugInLoad PlugInLoader::registerCommands(Loaded& candidate) {
    for (CQuarnCommand* command : candidate.commands) {
        if (Result<void> added = m_application.commands().add(*command); !added)
            return refused(candidate.file, added.message() + ".");
        if (!command->PlugIn())
            CQuarnCommandRegistration::setPlugIn(*command, candidate.plug_in);
    }
    return {};
}

PlugInLoad PlugInLoader::startUp(Loaded& candidate) {
    CWinApp& application = *candidate.application;
    CQuarnPlugIn& plug_in = *candidate.plug_in;
    const Result<bool> started = acrossBorder([&] { return application.InitInstance(); });
    if (!started)
        return refused(candidate.file, "InitInstance stopped with an error: " + started.message());
    if (!started.value())
        return refused(candidate.file, "its InitInstance refused");

    const Result<bool> loaded = acrossBorder([&] { return plug_in.OnLoadPlugIn(); });
    if (loaded && loaded.value())
        return {};
    (void)acrossBorder([&] { return application.ExitInstance(); });
    if (!loaded)
        return refused(candidate.file, "OnLoadPlugIn stopped with an error: " + loaded.message());
    return refused(candidate.file, "its OnLoadPlugIn refused");
}

// ---- Unloading

void PlugInLoader::withdraw(Loaded& loaded) {
    for (CQuarnCommand* command : loaded.commands) {
        m_application.commands().remove(*command);
        if (command->PlugIn() == loaded.plug_in)
            CQuarnCommandRegistration::setPlugIn(*command, nullptr);
    }
    m_application.texts().remove(loaded.file.string());
}

void PlugInLoader::unload(Loaded& loaded) {
    if (const Result<void> ended = acrossBorder([&] { loaded.plug_in->OnUnloadPlugIn(); }); !ended)
        m_application.tell("OnUnloadPlugIn of " + loaded.file.string() +
                           " stopped with an error: " + ended.message());
    if (const Result<int> ended = acrossBorder([&] { return loaded.application->ExitInstance(); });
        !ended)
        m_application.tell("ExitInstance of " + loaded.file.string() +
                           " stopped with an error: " + ended.message());
    withdraw(loaded);
}

} // namespace quarn
