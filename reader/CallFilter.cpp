#include "reader/CallFilter.h"

#include <cerrno>
#include <cstdint>
#include <fcntl.h>
#include <memory>
#include <sched.h>
#include <seccomp.h>
#include <unistd.h>

namespace quarn {

namespace {

/// Harmless whatever they are asked.
constexpr int ALLOWED[] = {
    // what is open already
    SCMP_SYS(read), SCMP_SYS(pread64), SCMP_SYS(readv), SCMP_SYS(preadv), SCMP_SYS(write),
    SCMP_SYS(pwrite64), SCMP_SYS(writev), SCMP_SYS(close), SCMP_SYS(lseek), SCMP_SYS(fcntl),
    SCMP_SYS(dup), SCMP_SYS(pipe), SCMP_SYS(pipe2), SCMP_SYS(fadvise64), SCMP_SYS(poll),
    SCMP_SYS(ppoll), SCMP_SYS(sendto), SCMP_SYS(sendmsg), SCMP_SYS(recvfrom), SCMP_SYS(recvmsg),
    SCMP_SYS(getdents64),
    // looking at files
    SCMP_SYS(fstat), SCMP_SYS(newfstatat), SCMP_SYS(stat), SCMP_SYS(lstat), SCMP_SYS(statx),
    SCMP_SYS(fstatfs), SCMP_SYS(statfs), SCMP_SYS(access), SCMP_SYS(faccessat),
    SCMP_SYS(faccessat2), SCMP_SYS(readlink), SCMP_SYS(readlinkat), SCMP_SYS(getcwd),
    // memory
    SCMP_SYS(mmap), SCMP_SYS(mprotect), SCMP_SYS(munmap), SCMP_SYS(mremap), SCMP_SYS(madvise),
    SCMP_SYS(brk), SCMP_SYS(mincore), SCMP_SYS(mlock), SCMP_SYS(munlock),
    // threads
    SCMP_SYS(futex), SCMP_SYS(sched_yield), SCMP_SYS(sched_getaffinity),
    SCMP_SYS(sched_setaffinity), SCMP_SYS(sched_getparam), SCMP_SYS(sched_getscheduler),
    SCMP_SYS(sched_get_priority_max), SCMP_SYS(sched_get_priority_min), SCMP_SYS(set_robust_list),
    SCMP_SYS(get_robust_list), SCMP_SYS(rseq), SCMP_SYS(membarrier), SCMP_SYS(getcpu),
    SCMP_SYS(arch_prctl), SCMP_SYS(set_tid_address), SCMP_SYS(restart_syscall),
    // signals that come
    SCMP_SYS(rt_sigaction), SCMP_SYS(rt_sigprocmask), SCMP_SYS(rt_sigreturn), SCMP_SYS(sigaltstack),
    // clocks and facts
    SCMP_SYS(clock_gettime), SCMP_SYS(clock_getres), SCMP_SYS(clock_nanosleep), SCMP_SYS(nanosleep),
    SCMP_SYS(gettimeofday), SCMP_SYS(time), SCMP_SYS(times), SCMP_SYS(getrusage),
    SCMP_SYS(getrlimit), SCMP_SYS(sysinfo), SCMP_SYS(uname), SCMP_SYS(getrandom), SCMP_SYS(getpid),
    SCMP_SYS(gettid), SCMP_SYS(getppid), SCMP_SYS(getuid), SCMP_SYS(geteuid), SCMP_SYS(getgid),
    SCMP_SYS(getegid),
    // the end
    SCMP_SYS(exit), SCMP_SYS(exit_group)};

/// Only who was taken over by a file makes these.
constexpr int DEADLY[] = {SCMP_SYS(execve),
                          SCMP_SYS(execveat),
                          SCMP_SYS(fork),
                          SCMP_SYS(vfork),
                          SCMP_SYS(ptrace),
                          SCMP_SYS(process_vm_readv),
                          SCMP_SYS(process_vm_writev)};

constexpr std::uint64_t WRITING = O_ACCMODE | O_CREAT | O_TRUNC;

/// Adds rules to a filter while all before could be added.
class Rules {
public:
    Rules() : m_filter(seccomp_init(SCMP_ACT_ERRNO(EPERM)), &seccomp_release) {}

    void add(std::uint32_t action, int call) {
        m_ok = m_ok && seccomp_rule_add_array(m_filter.get(), action, call, 0, nullptr) == 0;
    }
    void allowIf(int call, scmp_arg_cmp condition) {
        m_ok = m_ok &&
               seccomp_rule_add_array(m_filter.get(), SCMP_ACT_ALLOW, call, 1, &condition) == 0;
    }
    bool load() { return m_ok && seccomp_load(m_filter.get()) == 0; }

private:
    std::unique_ptr<void, decltype(&seccomp_release)> m_filter;
    bool m_ok = m_filter != nullptr;
};

} // namespace

bool filterCalls() {
    Rules rules;
    for (const int call : ALLOWED)
        rules.add(SCMP_ACT_ALLOW, call);
    for (const int call : DEADLY)
        rules.add(SCMP_ACT_KILL_PROCESS, call);
    rules.allowIf(SCMP_SYS(open), SCMP_A1(SCMP_CMP_MASKED_EQ, WRITING, O_RDONLY));
    rules.allowIf(SCMP_SYS(openat), SCMP_A2(SCMP_CMP_MASKED_EQ, WRITING, O_RDONLY));
    // A thread, but no process. What the newer call is asked cannot be seen from here; the C
    // library falls back on the older one where it is not there.
    rules.allowIf(SCMP_SYS(clone), SCMP_A0(SCMP_CMP_MASKED_EQ, CLONE_THREAD, CLONE_THREAD));
    rules.add(SCMP_ACT_ERRNO(ENOSYS), SCMP_SYS(clone3));
    // Limits may be read; an abort is a signal to oneself.
    rules.allowIf(SCMP_SYS(prlimit64), SCMP_A2(SCMP_CMP_EQ, 0));
    rules.allowIf(SCMP_SYS(tgkill), SCMP_A0(SCMP_CMP_EQ, static_cast<scmp_datum_t>(getpid())));
    return rules.load();
}

} // namespace quarn
