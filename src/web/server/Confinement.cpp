#include "web/server/Confinement.h"

#include <grp.h>
#include <linux/audit.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <cstddef>
#include <ctime>
#include <vector>

namespace {

constexpr rlim_t MostMemory = 192UL * 1024 * 1024;  ///< address space, with the libraries' own
constexpr rlim_t MostData = 96UL * 1024 * 1024;
constexpr unsigned Nobody = 65534;

#if defined(__SANITIZE_ADDRESS__)
constexpr bool Watched = true;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
constexpr bool Watched = true;  ///< sanitizers need memory, files and processes of their own
#else
constexpr bool Watched = false;
#endif
#else
constexpr bool Watched = false;
#endif

bool Limit(__rlimit_resource what, rlim_t most) {
  const rlimit limit{.rlim_cur = most, .rlim_max = most};
  return setrlimit(what, &limit) == 0;
}

bool LimitResources(std::size_t handles) {
  const bool memory = Watched || (Limit(RLIMIT_AS, MostMemory) && Limit(RLIMIT_DATA, MostData));
  return memory && Limit(RLIMIT_CORE, 0) && Limit(RLIMIT_FSIZE, 0) && Limit(RLIMIT_NOFILE, handles) &&
         (Watched || Limit(RLIMIT_NPROC, 0));
}

bool DropRights() {
  if (geteuid() == 0 && (setgroups(0, nullptr) != 0 || setgid(Nobody) != 0 || setuid(Nobody) != 0)) {
    return false;
  }
  // Only now: a change of the user cancels the signal.
  return prctl(PR_SET_PDEATHSIG, SIGKILL) == 0 && prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) == 0;
}

#if defined(__x86_64__) || defined(__aarch64__)

#if defined(__x86_64__)
constexpr unsigned OwnMachine = AUDIT_ARCH_X86_64;
#else
constexpr unsigned OwnMachine = AUDIT_ARCH_AARCH64;
#endif

/// What the loop, the library and the memory of the process call.
constexpr int AllowedCalls[] = {
    __NR_read,         __NR_write,           __NR_writev,       __NR_sendto,
    __NR_recvfrom,     __NR_sendmsg,         __NR_recvmsg,      __NR_accept4,
    __NR_close,        __NR_shutdown,        __NR_setsockopt,   __NR_getsockopt,
    __NR_getsockname,  __NR_getpeername,     __NR_epoll_ctl,    __NR_epoll_pwait,
    __NR_ppoll,        __NR_fcntl,           __NR_mmap,         __NR_munmap,
    __NR_mremap,       __NR_mprotect,        __NR_madvise,      __NR_brk,
    __NR_futex,        __NR_clock_gettime,   __NR_gettimeofday, __NR_getpid,
    __NR_gettid,       __NR_tgkill,          __NR_rt_sigaction, __NR_rt_sigprocmask,
    __NR_rt_sigreturn, __NR_restart_syscall, __NR_getrandom,    __NR_exit,
    __NR_exit_group,
#if defined(__NR_poll)
    __NR_poll,         __NR_epoll_wait,      __NR_accept,
#endif
};

/// All other calls fail with EPERM.
bool FilterCalls() {
  constexpr auto refuse = SECCOMP_RET_ERRNO | EPERM;
  std::vector<sock_filter> steps{BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, arch)),
                                 BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, OwnMachine, 1, 0),
                                 BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_KILL_PROCESS),
                                 BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr))};
  for (const int call : AllowedCalls) {
    steps.push_back(BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, static_cast<unsigned>(call), 0, 1));
    steps.push_back(BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW));
  }
  steps.push_back(BPF_STMT(BPF_RET | BPF_K, refuse));
  const sock_fprog program{.len = static_cast<unsigned short>(steps.size()), .filter = steps.data()};
  return prctl(PR_SET_SECCOMP, SECCOMP_MODE_FILTER, &program) == 0;
}

#else

bool FilterCalls() {
  return true;  // the numbers of the calls are known for two kinds of machines
}

#endif

/// The C library reads the time zone's file at its first date; there will be no other chance.
void ReadTimeZone() {
  const std::time_t now = std::time(nullptr);
  std::tm parts{};
  gmtime_r(&now, &parts);
}

}  // namespace

std::size_t MostHandles() {
  rlimit limit{};
  return getrlimit(RLIMIT_NOFILE, &limit) == 0 ? limit.rlim_max : 0;
}

bool Confine(std::size_t handles) {
  ReadTimeZone();
  return LimitResources(handles) && DropRights() && (Watched || FilterCalls());
}
