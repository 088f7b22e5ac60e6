#include "host/recovery/RecoveryWorker.h"

#include "host/recovery/RecoveryMarks.h"

#include <csignal>
#include <exception>
#include <utility>

namespace quarn {

namespace {

/// A thread that no signal is handed to: those who wait for one wait in the main thread.
template <class Work> std::thread deafThread(Work work) {
    sigset_t all;
    sigset_t before;
    sigfillset(&all);
    pthread_sigmask(SIG_SETMASK, &all, &before);
    std::thread thread(work);
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
    return thread;
}

/// Gives the content of a state its objects.
void addObjects(RecoveryState& state) {
    if (!state.objects)
        return;
    state.content.objects.reserve(state.objects->size());
    for (const auto& object : *state.objects)
        state.content.objects.push_back(*object);
}

} // namespace

RecoveryWorker::RecoveryWorker(std::filesystem::path state_folder)
    : m_journal(std::move(state_folder), currentProcess()),
      m_thread(deafThread([this] { work(); })) {}

RecoveryWorker::~RecoveryWorker() {
    {
        const Lock lock(m_mutex);
        m_ends = true;
    }
    m_changed.notify_all();
    m_thread.join();
}

void RecoveryWorker::keep(std::unique_ptr<RecoveryState> state, Clock::time_point time,
                          std::filesystem::path replaced_mark) {
    std::unique_ptr<RecoveryState> dropped; // freed without the lock
    {
        const Lock lock(m_mutex);
        dropped = std::exchange(m_waiting, std::move(state));
        if (dropped && m_waiting->picture.width == 0)
            m_waiting->picture = std::move(dropped->picture);
        m_time = time;
        m_replaced_mark = std::move(replaced_mark);
    }
    m_changed.notify_all();
}

Result<void> RecoveryWorker::finish() {
    Lock lock(m_mutex);
    m_time = {};
    m_changed.notify_all();
    m_changed.wait(lock, [this] { return !m_waiting && !m_is_writing; });
    return m_last;
}

void RecoveryWorker::remove(std::filesystem::path other_mark) {
    {
        const Lock lock(m_mutex);
        m_waiting.reset();
        ++m_removals_wanted;
        m_journal.stop();
        if (!other_mark.empty())
            m_other_marks.push_back(std::move(other_mark));
    }
    m_changed.notify_all();
}

void RecoveryWorker::waitUntilRemoved() {
    Lock lock(m_mutex);
    m_changed.wait(lock, [this] { return m_removals_done == m_removals_wanted; });
}

bool RecoveryWorker::isInTrouble() {
    const Lock lock(m_mutex);
    return !m_known_trouble.empty();
}

std::optional<std::string> RecoveryWorker::takeTrouble() {
    const Lock lock(m_mutex);
    return std::exchange(m_news, std::nullopt);
}

void RecoveryWorker::work() {
    Lock lock(m_mutex);
    while (doNext(lock))
        m_changed.notify_all();
}

/// @return false when the thread has to end
bool RecoveryWorker::doNext(Lock& lock) {
    const bool is_due = m_waiting && Clock::now() >= m_time;
    if (m_removals_done != m_removals_wanted)
        removeAll(lock);
    else if (m_ends)
        return false;
    else if (is_due)
        write(lock);
    else if (m_waiting)
        m_changed.wait_until(lock, m_time);
    else
        m_changed.wait(lock);
    return true;
}

void RecoveryWorker::removeAll(Lock& lock) {
    const auto marks = std::exchange(m_other_marks, {});
    const unsigned wanted = m_removals_wanted;
    lock.unlock();
    m_journal.remove();
    for (const std::filesystem::path& mark : marks)
        removeRecovery(mark);
    lock.lock();
    m_removals_done = wanted;
    m_known_trouble.clear();
}

void RecoveryWorker::write(Lock& lock) {
    std::unique_ptr<RecoveryState> state = std::exchange(m_waiting, nullptr);
    const std::filesystem::path replaced_mark = std::exchange(m_replaced_mark, {});
    m_is_writing = true;
    lock.unlock();
    const auto written = writeNow(*state);
    if (written && !replaced_mark.empty())
        removeRecovery(replaced_mark);
    state.reset();
    lock.lock();
    m_is_writing = false;
    if (m_removals_done == m_removals_wanted)
        note(written);
}

Result<void> RecoveryWorker::writeNow(RecoveryState& state) {
    try {
        addObjects(state);
    } catch (const std::exception&) {
        return Error{"There is too little memory to keep unsaved work for recovery."};
    }
    return m_journal.write(state);
}

void RecoveryWorker::note(const Result<void>& written) {
    m_last = written;
    if (!written && written.message() != m_known_trouble)
        m_news = written.message();
    m_known_trouble = written ? "" : written.message();
}

} // namespace quarn
