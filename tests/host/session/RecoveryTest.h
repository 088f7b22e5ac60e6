#pragma once

#include "host/document/file/DocumentFile.h"
#include "host/session/DocumentState.h"
#include "host/session/Recovery.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/SampleContent.h"
#include "tests/host/recovery/RecoveryFixtures.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <optional>

namespace quarn::test {

/// A program that keeps unsaved work, in folders of its own, and that ends as a crash would end it.
class RecoveryTest : public HostTest {
protected:
    RecoveryTest() {
        std::filesystem::create_directory(documents);
        setenv("XDG_STATE_HOME", (folder / "home").c_str(), 1); // what commands look into
    }
    ~RecoveryTest() override { unsetenv("XDG_STATE_HOME"); }

    Document& document() { return Document::of(session.document()); }
    bool modified() { return isModified(session.document()); }
    void runAll(std::initializer_list<std::wstring> lines) {
        for (const std::wstring& line : lines)
            ASSERT_EQ(session.runCommand(line), CQuarnCommand::success) << printed();
    }
    std::wstring path(const char* name) const {
        return L"\"" + (documents / name).wstring() + L"\"";
    }

    /// Opens the sample document from a file and changes it.
    void workOnSample(const char* name) {
        ASSERT_TRUE(writeDocumentFile(sampleContent(), documents / name));
        runAll({L"Open " + path(name), L"Point 1,2,3"});
    }
    Bytes work() {
        const auto content = contentToSave(document());
        EXPECT_TRUE(content) << content.message();
        return content ? documentBytes(content.value()) : Bytes();
    }
    /// Lets the program end without a person's wish, as far as its files can tell.
    void crash() {
        EXPECT_EQ(keeper->keepNow(), std::nullopt);
        keeper.reset();
        letWritersEnd(state_folder);
        runAll({L"New"});
    }
    void restart(std::chrono::milliseconds every = std::chrono::milliseconds(0)) {
        keeper.emplace(session, RecoveryOptions{state_folder, every});
    }
    std::vector<RecoverableDocument> found() const {
        return recoverableDocuments({.state_folder = state_folder});
    }
    int keptFiles() const { return filesBelow(state_folder) + countOf(recoveryFilesIn(documents)); }
    static int countOf(const std::vector<std::filesystem::path>& files) {
        return static_cast<int>(files.size());
    }

    TempFolder folder;
    const std::filesystem::path documents = folder / "documents";
    const std::filesystem::path state_folder = folder / "home" / "quarn";
    /// With every beat due.
    std::optional<RecoveryKeeper> keeper{
        std::in_place, session, RecoveryOptions{state_folder, std::chrono::milliseconds(0)}};
};

} // namespace quarn::test
