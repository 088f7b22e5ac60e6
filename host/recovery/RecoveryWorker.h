#pragma once

#include "host/recovery/RecoveryJournal.h"

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>

namespace quarn {

/// The thread that writes recovery files. Its callers hand over states, which belong to it from
/// then on, and never wait but where they say so.
class RecoveryWorker {
public:
    using Clock = std::chrono::steady_clock;

    /// @param state_folder  as for RecoveryJournal
    explicit RecoveryWorker(std::filesystem::path state_folder);
    /// Ends the thread when it has written what it is writing just now; what waits is not written.
    ~RecoveryWorker();
    RecoveryWorker(const RecoveryWorker&) = delete;
    RecoveryWorker& operator=(const RecoveryWorker&) = delete;

    /// Hands over a state to be written at that time; one that still waits is dropped for it.
    /// @param replaced_mark  mark of a recovery file that is removed once the state is on the disk;
    ///                       empty: none
    void keep(std::unique_ptr<RecoveryState> state, Clock::time_point time,
              std::filesystem::path replaced_mark = {});
    /// Has what waits written at once, and waits until it is on the disk.
    /// @return how the last write ended
    Result<void> finish();
    /// Removes the recovery file, and one that another mark leads to; nothing waits to be written
    /// any more.
    void remove(std::filesystem::path other_mark = {});
    /// Waits until all that was to be removed is gone.
    void waitUntilRemoved();

    /// Whether the last write failed.
    bool isInTrouble();
    /// Why a write failed, unless the one before failed for the same reason; comes once.
    std::optional<std::string> takeTrouble();

private:
    using Lock = std::unique_lock<std::mutex>;
    void work();
    bool doNext(Lock& lock);
    void write(Lock& lock);
    Result<void> writeNow(RecoveryState& state);
    void removeAll(Lock& lock);
    void note(const Result<void>& written);

    RecoveryJournal m_journal;
    std::mutex m_mutex; ///< of all below
    std::condition_variable m_changed;
    std::unique_ptr<RecoveryState> m_waiting; ///< null: none
    Clock::time_point m_time;                 ///< when it is written
    std::filesystem::path m_replaced_mark;
    bool m_is_writing = false;
    unsigned m_removals_wanted = 0;
    unsigned m_removals_done = 0;
    std::vector<std::filesystem::path> m_other_marks; ///< to be removed too
    bool m_ends = false;
    Result<void> m_last;
    std::string m_known_trouble; ///< empty: the last write went well
    std::optional<std::string> m_news;
    std::thread m_thread; ///< last: it uses the others
};

} // namespace quarn
