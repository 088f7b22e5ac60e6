#include "host/recording/KnownFrames.h"

#include "ground/Checksum.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

namespace fs = std::filesystem;

RecordingFingerprint fingerprintOf(const FramesManifest& manifest) {
    return {manifest.program, manifest.document, manifest.settings, manifest.instructions};
}

} // namespace

KnownFrames::KnownFrames(Place place, RecordingFingerprint fingerprint)
    : m_place(std::move(place)), m_fingerprint(std::move(fingerprint)) {}

void KnownFrames::readManifest() {
    const auto manifest = readFramesManifest(m_place.folder / manifestName(m_place.animation));
    if (!manifest || manifest.value().name != m_place.animation ||
        fingerprintOf(manifest.value()) != m_fingerprint)
        return;
    for (const ManifestFrame& frame : manifest.value().images)
        put(frame);
}

void KnownFrames::refresh() {
    if (!std::exchange(m_has_read_manifest, true))
        readManifest();
    for (const fs::path& file : journalsIn(m_place.folder, m_place.animation))
        readOn(readerOf(file));
}

JournalReader& KnownFrames::readerOf(const fs::path& file) {
    const auto found = std::ranges::find(m_journals, file, &JournalReader::file);
    return found != m_journals.end() ? *found : m_journals.emplace_back(file);
}

/// What is damaged tells of its frames up to there.
void KnownFrames::readOn(JournalReader& journal) {
    const std::size_t known = journal.content().frames.size();
    (void)journal.readOn().ok();
    const RecordingJournal& content = journal.content();
    if (content.head.animation != m_place.animation || content.head.fingerprint != m_fingerprint)
        return;
    for (std::size_t i = known; i < content.frames.size(); ++i)
        put(content.frames[i].frame);
}

const JournalReader* KnownFrames::journal(const std::string& file_name) {
    const fs::path file = m_place.folder / file_name;
    std::error_code error;
    if (!fs::exists(file, error))
        return nullptr;
    JournalReader& journal = readerOf(file);
    readOn(journal);
    return &journal;
}

const ManifestFrame* KnownFrames::find(int frame) const {
    const auto found = m_frames.find(frame);
    return found == m_frames.end() ? nullptr : &found->second;
}

bool KnownFrames::isThere(const ManifestFrame& frame) const {
    std::error_code error;
    return fs::file_size(m_place.folder / frame.file, error) == frame.bytes && !error;
}

bool KnownFrames::isWhole(const ManifestFrame& frame) const {
    if (!isThere(frame))
        return false;
    const auto sum = checksumOfFile(m_place.folder / frame.file);
    return sum && sum.value().bytes == frame.bytes && sum.value().xxh64 == frame.xxh64;
}

} // namespace quarn
