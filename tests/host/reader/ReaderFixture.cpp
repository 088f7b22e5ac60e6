#include "tests/host/reader/ReaderFixture.h"

#include <fstream>
#include <sys/resource.h>

namespace quarn::test {

SetVariable::SetVariable(const char* name, const std::string& value) : m_name(name) {
    const char* const former = std::getenv(name);
    m_former = former ? former : "";
    setenv(name, value.c_str(), 1);
}

SetVariable::~SetVariable() {
    setenv(m_name, m_former.c_str(), 1);
}

Limited::Limited(int what, unsigned long most) : m_what(what) {
    rlimit limits{};
    getrlimit(static_cast<__rlimit_resource>(what), &limits);
    m_former = limits.rlim_cur;
    limits.rlim_cur = most;
    EXPECT_EQ(setrlimit(static_cast<__rlimit_resource>(what), &limits), 0);
}

Limited::~Limited() {
    rlimit limits{};
    getrlimit(static_cast<__rlimit_resource>(m_what), &limits);
    limits.rlim_cur = m_former;
    setrlimit(static_cast<__rlimit_resource>(m_what), &limits);
}

std::vector<pid_t> childProcesses(const std::string& parent) {
    std::vector<pid_t> children;
    for (const auto& thread : std::filesystem::directory_iterator("/proc/" + parent + "/task")) {
        std::ifstream list(thread.path() / "children");
        for (pid_t child = 0; list >> child;)
            children.push_back(child);
    }
    return children;
}

int openDescriptors() {
    int count = 0;
    for ([[maybe_unused]] const auto& one : std::filesystem::directory_iterator("/proc/self/fd"))
        ++count;
    return count;
}

std::filesystem::path ModelReaderTest::largeModel() {
    constexpr int TRIANGLES = 300'000;
    std::string text;
    for (int i = 0; i < TRIANGLES; ++i)
        text += "v " + std::to_string(i) + " 0 0\nv 0 1 " + std::to_string(i % 7) +
                "\nv 0 0.5 1\nf -1 -2 -3\n";
    return folder.write("large.obj", text);
}

std::string StandInReaderTest::whyNot(const std::string& behaviour,
                                      const ModelReaderOptions& options) {
    const Result<ImportedModel> model =
        readModel(folder.write(behaviour + ".obj", std::string(100'000, ' ')), options);
    return model ? "" : model.message();
}

} // namespace quarn::test
