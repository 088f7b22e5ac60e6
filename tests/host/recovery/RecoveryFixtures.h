#pragma once

#include "host/app/DocumentSaving.h"
#include "host/document/file/DocumentCoding.h"
#include "host/recovery/RecoveryCoding.h"
#include "host/recovery/RecoveryMarks.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <functional>
#include <thread>

namespace quarn::test {

using Bytes = std::vector<std::uint8_t>;

/// The bytes of a document with this content, by which contents are compared.
inline Bytes documentBytes(const DocumentContent& content) {
    auto bytes = encodeDocument(content);
    EXPECT_TRUE(bytes) << (bytes ? "" : bytes.message());
    return bytes ? std::move(bytes.value()) : Bytes();
}

inline Bytes bytesOf(const std::filesystem::path& file) {
    const std::string text = readFile(file);
    return {text.begin(), text.end()};
}

/// The recovery files of a folder, sorted.
inline std::vector<std::filesystem::path> recoveryFilesIn(const std::filesystem::path& folder) {
    std::vector<std::filesystem::path> files;
    std::error_code none;
    for (const auto& entry : std::filesystem::directory_iterator(folder, none))
        if (entry.path().extension() == ".recovery")
            files.push_back(entry.path());
    std::ranges::sort(files);
    return files;
}

/// All files of a folder and of those in it.
inline int filesBelow(const std::filesystem::path& folder) {
    int count = 0;
    std::error_code none;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder, none))
        count += entry.is_regular_file() ? 1 : 0;
    return count;
}

/// Lets the marks of a folder for state be those of programs that have ended: of ones that began at
/// another time under the number that this program has now.
inline void letWritersEnd(const std::filesystem::path& state_folder) {
    const std::filesystem::path folder = recoveryFolder(state_folder);
    for (const std::filesystem::path& file : marksIn(folder)) {
        auto mark = readMark(file);
        ASSERT_TRUE(mark) << file;
        mark->writer.started += 1;
        std::filesystem::remove(file);
        ASSERT_TRUE(writeMark(folder, *mark));
    }
}

/// Waits until something holds, at most ten seconds.
inline bool waitUntil(const std::function<bool()>& holds) {
    using Clock = std::chrono::steady_clock;
    const auto end = Clock::now() + std::chrono::seconds(10);
    while (!holds() && Clock::now() < end)
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    return holds();
}

} // namespace quarn::test
