#include "host/recovery/RecoveryJournal.h"

#include "engine/images/ImageFile.h"
#include "engine/images/Opacity.h"
#include "engine/scene/MaterialFields.h"
#include "ground/PathText.h"
#include "host/recovery/RecoveryCoding.h"
#include "host/recovery/RecoveryMarks.h"

#include <algorithm>
#include <exception>
#include <string>
#include <system_error>
#include <unordered_set>
#include <utility>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr const char* STOPPED = "it was stopped";
/// Less than this is not worth writing a file anew for.
constexpr std::uint64_t LEAST_GARBAGE = 16 << 20;

Error cannotKeep(const std::string& why) {
    return {"Unsaved work cannot be kept for recovery: " + why + "."};
}

/// The beginning of a document's name that leaves room for what follows it.
std::string shortened(std::string name) {
    constexpr std::size_t most = 120;
    if (name.size() <= most)
        return name;
    std::size_t end = most;
    while (end > 0 && (static_cast<unsigned char>(name[end]) & 0xC0) == 0x80)
        --end; // not within a character
    name.resize(end);
    return name;
}

/// A name that nothing has, hidden.
fs::path freeName(const fs::path& folder, const fs::path& document, const ProcessIdentity& writer) {
    const std::string name = document.empty() ? "unsaved" : shortened(document.filename().native());
    const std::string stem = "." + name + "-" + writer.host + "-" + std::to_string(writer.pid);
    fs::path file = folder / (stem + ".recovery");
    std::error_code ignored;
    for (int number = 2; fs::exists(fs::symlink_status(file, ignored)); ++number)
        file = folder / (stem + "-" + std::to_string(number) + ".recovery");
    return file;
}

/// Calls `visit` with each mesh, material and texture of each object.
template <class Visit> void forEachShared(const DocumentContent& content, Visit visit) {
    for (const ObjectContent& object : content.objects) {
        const auto& material = object.placed.material;
        if (object.placed.mesh)
            visit(object.placed.mesh);
        if (material)
            visit(material);
        if (material)
            forEachTexture(*material, visit);
    }
}

} // namespace

RecoveryJournal::RecoveryJournal(fs::path state_folder, ProcessIdentity writer)
    : m_folder(recoveryFolder(state_folder)), m_writer(std::move(writer)) {}

Result<void> RecoveryJournal::write(const RecoveryState& state) {
    try {
        const auto written = writeSomewhere(state);
        return written ? written : cannotKeep(written.message());
    } catch (const std::exception&) {
        m_file.close();
        return cannotKeep("there is too little memory");
    }
}

Result<void> RecoveryJournal::writeSomewhere(const RecoveryState& state) {
    std::error_code ignored;
    if (!m_mark.empty() && m_document != state.document)
        remove();
    if (m_file.isOpen() && !m_file.isAt(m_path)) { // somebody moved or removed it
        m_file.close();
        fs::remove(std::exchange(m_mark, {}), ignored);
    }
    if (m_mark.empty())
        return begin(state);
    if (m_file.isOpen())
        return append(state);
    const auto written = rewrite(state);
    return written ? written : beginElsewhere(state);
}

void RecoveryJournal::remove() {
    m_file.close();
    if (!m_mark.empty())
        removeRecovery(m_mark);
    m_mark.clear();
    m_picture.clear();
    m_is_stopped = false;
}

Result<void> RecoveryJournal::begin(const RecoveryState& state) {
    if (m_folder.is_relative())
        return Error{"there is no folder for state; set XDG_STATE_HOME or HOME"};
    m_document = state.document;
    Result<void> begun;
    if (!state.document.empty())
        begun = beginAt(freeName(state.document.parent_path(), state.document, m_writer), state);
    if (state.document.empty() || !begun)
        begun = beginAt(freeName(m_folder, state.document, m_writer), state);
    return begun;
}

/// Where the file can be written no more, another one may: on another disk.
Result<void> RecoveryJournal::beginElsewhere(const RecoveryState& state) {
    const fs::path old_path = m_path;
    const fs::path old_mark = std::exchange(m_mark, {});
    const auto begun = begin(state);
    if (begun) {
        removeRecovery(old_mark);
        return begun;
    }
    m_path = old_path;
    m_mark = old_mark;
    return begun;
}

/// The mark comes first: a file that nothing leads to would stay for ever.
Result<void> RecoveryJournal::beginAt(const fs::path& file, const RecoveryState& state) {
    const auto mark = writeMark(m_folder, {m_writer, file, state.document});
    if (!mark)
        return mark.error();
    m_path = file;
    const auto written = rewrite(state);
    if (written)
        m_mark = mark.value();
    else
        removeRecovery(mark.value());
    return written;
}

/// The new file takes its name when it is whole, so that there is a whole state at any moment.
Result<void> RecoveryJournal::rewrite(const RecoveryState& state) {
    const fs::path unfinished = unfinishedRecovery(m_path);
    std::error_code ignored;
    fs::remove(unfinished, ignored); // of a try that failed
    m_file.close();
    auto file = AppendedFile::make(unfinished);
    if (!file)
        return file.error();
    auto done = writeWhole(file.value(), state);
    if (done)
        done = moveOver(unfinished, m_path);
    if (done)
        m_file = std::move(file.value());
    else
        fs::remove(unfinished, ignored);
    return done;
}

Result<void> RecoveryJournal::writeWhole(AppendedFile& file, const RecoveryState& state) {
    m_places = {};
    m_shared.clear();
    takePicture(state.picture);
    if (const auto done = file.append(recoveryBeginning()); !done)
        return done;
    return appendParts(file, state, !m_picture.empty());
}

Result<void> RecoveryJournal::append(const RecoveryState& state) {
    const std::uint64_t needed = sizeNeeded(state);
    if (m_file.size() > needed + std::max(needed, LEAST_GARBAGE))
        return rewrite(state);
    const std::uint64_t size_before = m_file.size();
    const auto done = appendParts(m_file, state, takePicture(state.picture));
    if (done)
        return done;
    // Places were given to what does not stand in the file.
    m_file.cutTo(size_before);
    m_file.close();
    return done;
}

Result<void> RecoveryJournal::appendParts(AppendedFile& file, const RecoveryState& state,
                                          bool has_picture) {
    if (const auto done = appendShared(file, state.content); !done)
        return done;
    if (const auto done = has_picture ? appendTo(file, pictureChunk(m_picture)) : Result<void>();
        !done)
        return done;
    const std::uint64_t size_before = file.size();
    if (const auto done = appendTo(file, stateChunk(state, m_places)); !done)
        return done;
    m_state_size = file.size() - size_before;
    return file.flush();
}

Result<void> RecoveryJournal::appendShared(AppendedFile& file, const DocumentContent& content) {
    forgetGone();
    const SharedThings added = m_places.add(content);
    Result<void> done;
    for (auto at = added.textures.begin(); done && at != added.textures.end(); ++at)
        done = appendThing(file, *at, textureChunk(**at));
    for (auto at = added.materials.begin(); done && at != added.materials.end(); ++at)
        done = appendThing(file, *at, materialChunks(**at, m_places));
    for (auto at = added.meshes.begin(); done && at != added.meshes.end(); ++at)
        done = appendThing(file, *at, meshChunk(**at));
    forEachShared(content, [this](const auto& thing) { m_shared[thing.get()].thing = thing; });
    return done;
}

Result<void> RecoveryJournal::appendThing(AppendedFile& file, const void* thing,
                                          const Result<std::vector<std::uint8_t>>& chunk) {
    if (chunk)
        m_shared[thing].size = chunk.value().size();
    return appendTo(file, chunk);
}

/// Another thing may be made in the memory of one that is gone.
void RecoveryJournal::forgetGone() {
    std::erase_if(m_shared, [this](const auto& shared) {
        const bool is_gone = shared.second.thing.expired();
        if (is_gone)
            m_places.forget(shared.first);
        return is_gone;
    });
}

Result<void> RecoveryJournal::appendTo(AppendedFile& file,
                                       const Result<std::vector<std::uint8_t>>& chunk) const {
    if (!chunk)
        return chunk.error();
    return m_is_stopped ? Error{STOPPED} : file.append(chunk.value());
}

/// @return whether there is a new one; one that cannot be encoded is done without
bool RecoveryJournal::takePicture(const Image& picture) {
    if (picture.width == 0)
        return false;
    // Lists show it on grounds of their own colours, dark ones too.
    Image space;
    auto png = encodeImage(onWhite(picture, space), ImageFormat::png);
    if (png)
        m_picture = std::move(png.value());
    return png.ok();
}

/// What a file with this state alone would take, but for what it would be the first to hold.
std::uint64_t RecoveryJournal::sizeNeeded(const RecoveryState& state) const {
    std::uint64_t size = m_state_size + m_picture.size();
    std::unordered_set<const void*> counted;
    forEachShared(state.content, [&](const auto& thing) {
        const auto known = m_shared.find(thing.get());
        if (known != m_shared.end() && counted.insert(thing.get()).second)
            size += known->second.size;
    });
    return size;
}

} // namespace quarn
