#pragma once

#include "host/reader/ModelReader.h"
#include "host/reader/ReaderProgram.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <sys/types.h>

namespace quarn::test {

/// Sets a variable of the environment; puts back what it was.
class SetVariable {
public:
    SetVariable(const char* name, const std::string& value);
    ~SetVariable();
    SetVariable(const SetVariable&) = delete;
    SetVariable& operator=(const SetVariable&) = delete;

private:
    const char* m_name;
    std::string m_former;
};

/// A limit of this process for as long as it lives; what it starts inherits it.
class Limited {
public:
    Limited(int what, unsigned long most);
    ~Limited();
    Limited(const Limited&) = delete;
    Limited& operator=(const Limited&) = delete;

private:
    int m_what;
    unsigned long m_former;
};

/// Calls something on every look; it says whether the reading goes on.
class CallingWatch final : public ReadingWatch {
public:
    using Look = std::function<bool(ReadingStep step, double share)>;
    explicit CallingWatch(Look look) : m_look(std::move(look)) {}
    bool goesOn(ReadingStep step, double share) override { return m_look(step, share); }

private:
    Look m_look;
};

/// Processes that a process has started and not waited for.
/// @param parent  "self", or its number
std::vector<pid_t> childProcesses(const std::string& parent = "self");
int openDescriptors();

/// Reads models with the program that comes with the host.
class ModelReaderTest : public testing::Test {
protected:
    TemporaryFolder folder;
    std::filesystem::path triangle =
        folder.write("triangle.obj", "o Roof\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    /// One that takes a good part of a second to read.
    std::filesystem::path largeModel();
};

/// Reads models with a program that behaves as the name of the file asks for.
class StandInReaderTest : public ModelReaderTest {
protected:
    /// @return why it could not be read; empty where it could
    std::string whyNot(const std::string& behaviour, const ModelReaderOptions& options = {});

    SetVariable stand_in{READER_VARIABLE, QUARN_STAND_IN_READER};
};

} // namespace quarn::test
