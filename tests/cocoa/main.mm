#include <AppKit/AppKit.h>

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace {

constexpr const char* RUNS_TESTS = "QUARN_COCOA_RUNS_TESTS";
constexpr int MOST_TRIES = 20;

void startApplication() {
    // GNUstep's own title bar, since no window manager runs here; and no icon of the program.
    NSDictionary* const settings =
        [NSDictionary dictionaryWithObjectsAndKeys:@"NO", @"GSX11HandlesWindowDecorations", @"YES",
                                                   @"GSSuppressAppIcon", nil];
    [[NSUserDefaults standardUserDefaults] registerDefaults:settings];
    [NSApplication sharedApplication];
}

/// The program once more, as the process that runs the tests, with what it logs in a pipe.
pid_t startTests(char** arguments, int (&log)[2]) {
    if (pipe(log) != 0)
        return -1;
    const pid_t tests = fork();
    if (tests == 0) {
        dup2(log[1], STDERR_FILENO);
        setenv(RUNS_TESTS, "1", 1);
        execv("/proc/self/exe", arguments);
        _exit(1);
    }
    close(log[1]);
    return tests;
}

/// Passes on what is logged until the process ends.
std::string passOn(int log) {
    std::string all;
    char bytes[4096];
    for (ssize_t length; (length = read(log, bytes, sizeof bytes)) > 0;) {
        all.append(bytes, static_cast<std::size_t>(length));
        fwrite(bytes, 1, static_cast<std::size_t>(length), stderr);
    }
    close(log);
    return all;
}

/// GNUstep loses fonts in about one process of ten, whichever there are, says so and comes to grief
/// over it: that depends on where the process lies in memory, so the tests begin anew then.
/// @return as the program ends
int watchTests(char** arguments) {
    for (int tried = 0; tried < MOST_TRIES; ++tried) {
        int log[2];
        const pid_t tests = startTests(arguments, log);
        if (tests < 0)
            return 1;
        const bool lost_fonts = passOn(log[0]).find("can't be found") != std::string::npos;
        int status = 0;
        waitpid(tests, &status, 0);
        if (!lost_fonts)
            return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
    }
    return 1;
}

} // namespace

int main(int argument_count, char** arguments) {
    if (!getenv(RUNS_TESTS))
        return watchTests(arguments);
    NSAutoreleasePool* const pool = [[NSAutoreleasePool alloc] init];
    startApplication();
    testing::InitGoogleTest(&argument_count, arguments);
    const int result = RUN_ALL_TESTS();
    [pool release];
    return result;
}
