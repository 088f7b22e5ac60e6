#pragma once

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "sdk/qncore/qncore.h"
#include "sdk/vexui/VexUi.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>

namespace quarn::test {

/// A session that loads the small plug-ins of the tests; what they do stands in their journal.
class LoaderTest : public ::testing::Test {
protected:
    using Outcome = PlugInLoad::Outcome;

    void SetUp() override {
        for (const char* variable : {"QUARN_TEST_JOURNAL", "QUARN_TEST_FAULT"})
            unsetenv(variable);
        start({{}, {}, "C", {}});
    }
    void start(SessionOptions options) {
        session.reset();
        session = std::make_unique<Session>(front_end, std::move(options));
    }

    static std::wstring textOf(const std::filesystem::path& path) {
        return std::wstring(KM_wString::FromUtf8(path.native()).View());
    }
    static std::filesystem::path folder() { return TEST_PLUGIN_DIR; }
    PlugInLoad load(const std::string& name) { return session->loadPlugIn(folder() / name); }
    CQuarnCommand::result run(const wchar_t* line) { return session->runCommand(line); }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }
    static std::string journal() {
        const char* written = std::getenv("QUARN_TEST_JOURNAL");
        return written ? written : "";
    }

    ScriptedFrontEnd front_end;
    std::unique_ptr<Session> session;
};

} // namespace quarn::test
