#pragma once

#include "host/app/Application.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "sdk/qncore/QnCommand.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <utility>

namespace quarn::test {

/// What a command of a test does.
using CommandWork = std::function<CQuarnCommand::result(const CQuarnCommandContext&)>;

/// A command made of a function; `Base` is CQuarnCommand or CQuarnScriptCommand.
template <class Base> class CommandOf : public Base {
public:
    CommandOf(const wchar_t* name, CommandWork work)
        : m_name(name), m_id(KM_CreateUuid()), m_work(std::move(work)) {}
    KM_UUID CommandUUID() override { return m_id; }
    const wchar_t* EnglishCommandName() override { return m_name; }
    const wchar_t* LocalCommandName() override { return m_local_name ? m_local_name : m_name; }
    CQuarnCommand::result RunCommand(const CQuarnCommandContext& context) override {
        return m_work(context);
    }

    const wchar_t* m_name;
    const wchar_t* m_local_name = nullptr;
    KM_UUID m_id;

private:
    CommandWork m_work;
};

using TestCommand = CommandOf<CQuarnCommand>;
using TestScriptCommand = CommandOf<CQuarnScriptCommand>;

/// A session in English with a scripted front end.
class HostTest : public ::testing::Test {
protected:
    void add(CQuarnCommand& command) {
        const Result<void> added = Application::current()->commands().add(command);
        ASSERT_TRUE(added) << added.message();
    }
    CQuarnCommand::result run(const wchar_t* line) { return session.runCommand(line); }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }

    ScriptedFrontEnd front_end;
    Session session{front_end, {{}, {}, "C", {}}};
};

} // namespace quarn::test
