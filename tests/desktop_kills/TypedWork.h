#pragma once

#include "tests/quarn/ProgramRun.h"

#include <chrono>
#include <csignal>
#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn::test {

/// The window with somebody who types at it (tests/window_typist), in a home of its own.
class TypedWork {
public:
    using Clock = std::chrono::steady_clock;

    TypedWork();

    /// Starts the program and waits until the first point is made.
    void begin(const std::vector<std::string>& options);
    void kill() { stop(SIGKILL); }
    /// Lets it stand still at a moment when its recovery file is newer than the document's own.
    /// @return false where there was no such moment for as long as tests wait
    bool holdWhereUnsavedWorkIsKept();
    /// Sends it a signal and waits until it has ended.
    Ended stop(int signal);
    /// Starts the program again and takes the recovery that it offers.
    /// @return how that run ended
    Ended recover(const std::vector<std::string>& options);

    /// The points that were made until then.
    int doneUntil(Clock::time_point when) const;
    int begun() const { return last("begun"); }
    int saved() const { return last("saved"); }
    /// Whether it was killed while it saved.
    bool isSaving() const { return last("saving") > saved() || !has("saved"); }
    bool wasOffered() const { return has("offered"); }
    /// Whether the next start has unsaved work to offer that is not older than its file. Of a
    /// program that has ended.
    bool isRecoverable() const;

    std::filesystem::path file() const { return folder() / "work.quarn"; }
    std::filesystem::path savedCopy() const { return folder() / "saved.quarn"; }
    std::filesystem::path recovered() const { return folder() / "recovered.quarn"; }
    std::filesystem::path stateFolder() const { return m_home / "state" / "quarn"; }

private:
    struct Note {
        std::string what;
        int point;
        Clock::time_point when;
    };
    std::filesystem::path folder() const { return m_home / "work"; }
    Start start(const std::vector<std::string>& options) const;
    std::vector<Note> notes() const;
    bool has(const std::string& what) const;
    int last(const std::string& what) const;
    /// Whether its recovery file is newer than the document's own.
    bool keepsUnsavedWork() const;

    TempFolder m_home;
    std::unique_ptr<RunningProgram> m_program;
};

/// How many objects a document file holds; nothing where it cannot be opened.
std::optional<int> objectsIn(const std::filesystem::path& file);

} // namespace quarn::test
