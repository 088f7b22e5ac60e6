#pragma once

#include "ground/ProcessIdentity.h"
#include "ground/Result.h"
#include "host/recording/FramesManifest.h"
#include "host/recording/RecordingFingerprint.h"

#include <chrono>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// A frame that a writer has recorded.
struct JournalFrame {
    ManifestFrame frame;
    double seconds = 0.0; ///< that drawing and writing it took

    friend bool operator==(const JournalFrame&, const JournalFrame&) = default;
};

/// Who writes a journal, and what they record.
struct JournalHead {
    std::string animation; ///< the name
    ProcessIdentity writer;
    RecordingFingerprint fingerprint;
    double loading_seconds = 0.0; ///< from the program's start to the beginning of the recording

    friend bool operator==(const JournalHead&, const JournalHead&) = default;
};

/// What a file NAME.<writer>.journal beside the pictures of a recording holds. Several programs may
/// record frames of one recording; each has a journal of its own, which grows with each of its
/// frames. While it is renewed its writer counts as alive. docs/recording-file.md describes it.
struct RecordingJournal {
    JournalHead head;
    std::vector<JournalFrame> frames; ///< as they were written
    bool has_ended = false;           ///< its writer has come to its end, whole or not
    std::string trouble;              ///< why before all was done, in a sentence; empty: nothing

    friend bool operator==(const RecordingJournal&, const RecordingJournal&) = default;
};

/// The lines of a journal.
std::string journalHeadLine(const JournalHead& head);
std::string journalFrameLine(const JournalFrame& frame);
std::string journalEndLine(const std::string& trouble);

/// Reads a journal back, also while it grows.
class JournalReader {
public:
    explicit JournalReader(std::filesystem::path file) : m_file(std::move(file)) {}

    const std::filesystem::path& file() const { return m_file; }
    /// Reads what was added since the last call. A last line that is not whole is left for the next
    /// one: its writer was killed, or has not come to its end yet.
    /// @return an error, in one sentence, where the file is something else or damaged
    Result<void> readOn();
    /// The same with what was added.
    Result<void> take(std::string_view text);

    /// What was read; no frames, and a head without a name, before there was a whole line.
    const RecordingJournal& content() const { return m_content; }
    bool hasHead() const { return !m_content.head.animation.empty(); }

private:
    std::filesystem::path m_file;
    std::uintmax_t m_read_bytes = 0;
    RecordingJournal m_content;
};

/// The journals of a recording in a folder, by their names.
std::vector<std::filesystem::path> journalsIn(const std::filesystem::path& folder,
                                              const std::string& animation);

/// A journal while it is written.
class JournalWriter {
public:
    /// Makes a journal with a name of its own.
    /// @return an error, in one sentence
    static Result<JournalWriter> create(const std::filesystem::path& folder,
                                        const JournalHead& head);
    JournalWriter(JournalWriter&& other) noexcept;
    JournalWriter& operator=(JournalWriter&& other) noexcept;
    ~JournalWriter();

    const std::filesystem::path& file() const { return m_file; }
    /// @return an error, in one sentence, where the disk does not take it
    Result<void> add(const JournalFrame& frame) { return append(journalFrameLine(frame)); }
    /// Says that the writer lives.
    /// @return the time of the disk, by which all journals on it are renewed
    std::filesystem::file_time_type renew() const;
    /// @param trouble  as RecordingJournal has it
    void end(const std::string& trouble) { (void)append(journalEndLine(trouble)).ok(); }
    void remove() const;

private:
    JournalWriter(std::filesystem::path file, int descriptor)
        : m_file(std::move(file)), m_descriptor(descriptor) {}
    Result<void> append(const std::string& line) const;

    std::filesystem::path m_file;
    int m_descriptor;
};

/// Whether the writer of another journal may still be at work: it has not ended on this machine,
/// its journal does not say so, and it was renewed lately.
/// @param now    time of the disk, as JournalWriter::renew tells it; clocks of machines may differ
/// @param lease  for how long a journal counts after it was renewed
bool isWriterAlive(const JournalReader& journal, std::filesystem::file_time_type now,
                   std::chrono::seconds lease);

} // namespace quarn
