#include <fcntl.h>
#include <langinfo.h>
#include <poll.h>
#include <sys/prctl.h>
#include <sys/signalfd.h>
#include <sys/wait.h>
#include <unistd.h>

#include <clocale>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <string_view>
#include <system_error>

namespace {

/// Exit codes with which LibreOffice asks to be restarted, as it does after creating a new profile.
constexpr int RestartAfterCrash = 79;
constexpr int Restart = 81;

/// A folder for LibreOffice's profile and temporary files, deleted with everything in it at the end.
class Profile {
 public:
  Profile() {
    std::error_code none;
    path_ = std::filesystem::temp_directory_path(none) / "tessarine-office-XXXXXX";
    if (mkdtemp(path_.data()) == nullptr) {
      std::exit(EXIT_FAILURE);
    }
  }
  ~Profile() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }
  Profile(const Profile&) = delete;
  Profile& operator=(const Profile&) = delete;

  const std::string& Path() const { return path_; }

 private:
  std::string path_;
};

/// `path` percent-encoded for a file URL.
std::string UrlPath(const std::string& path) {
  std::string url;
  for (const char c : path) {
    const bool plain = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') ||
                       c == '/' || c == '-' || c == '_' || c == '.';
    char code[4];
    std::snprintf(code, sizeof code, "%%%02X", static_cast<unsigned char>(c));
    url += plain ? std::string(1, c) : code;
  }
  return url;
}

/// LibreOffice finds only files whose names the locale can encode, and names come in every script. C.UTF-8
/// exists whatever locales are installed.
void SpellAllNames() {
  if (std::setlocale(LC_CTYPE, "") == nullptr || std::string_view(nl_langinfo(CODESET)) != "UTF-8") {
    setenv("LC_ALL", "C.UTF-8", 1);
  }
}

/// Replaces this process by LibreOffice, which is killed when its parent, the host, dies.
[[noreturn]] void BecomeOffice(const char* office, const std::string& profile, const std::string& pipe,
                               pid_t host) {
  prctl(PR_SET_PDEATHSIG, SIGKILL);
  if (getppid() != host) {
    _exit(EXIT_FAILURE);
  }
  sigset_t none;
  sigemptyset(&none);
  sigprocmask(SIG_SETMASK, &none, nullptr);
  const int nothing = open("/dev/null", O_RDWR);
  dup2(nothing, STDIN_FILENO);
  dup2(nothing, STDOUT_FILENO);
  dup2(nothing, STDERR_FILENO);
  const std::string installation = "-env:UserInstallation=file://" + UrlPath(profile);
  const std::string accept = "--accept=pipe,name=" + pipe + ";urp";
  setenv("SAL_USE_VCLPLUGIN", "svp", 1);
  setenv("TMPDIR", profile.c_str(), 1);  // so that leftovers are deleted with the profile
  SpellAllNames();
  execl(office, office, installation.c_str(), "--headless", "--norestore", "--nologo", "--nodefault",
        accept.c_str(), nullptr);
  _exit(EXIT_FAILURE);
}

/// A signalfd for LibreOffice's end and for requests to end this program.
int WatchedSignals() {
  sigset_t watched;
  sigemptyset(&watched);
  for (const int number : {SIGCHLD, SIGTERM, SIGINT, SIGHUP}) {
    sigaddset(&watched, number);
  }
  sigprocmask(SIG_BLOCK, &watched, nullptr);
  return signalfd(-1, &watched, SFD_CLOEXEC);
}

/// Waits until LibreOffice exits and returns its wait status. If a signal asks this program to end, or the
/// other end of its standard input is closed, kills LibreOffice and returns SIGKILL.
int WaitForEnd(pid_t office, int signals) {
  pollfd sources[] = {{STDIN_FILENO, 0, 0}, {signals, POLLIN, 0}};
  while (poll(sources, 2, -1) >= 0 && (sources[0].revents & (POLLHUP | POLLERR | POLLNVAL)) == 0) {
    signalfd_siginfo signal{};
    if (read(signals, &signal, sizeof signal) != sizeof signal || signal.ssi_signo != SIGCHLD) {
      break;
    }
    int status = 0;
    if (waitpid(office, &status, WNOHANG) == office) {
      return status;
    }
  }
  kill(office, SIGKILL);
  waitpid(office, nullptr, 0);
  return SIGKILL;
}

}  // namespace

/// tessarine-office-host PROGRAM PIPE: runs LibreOffice (soffice.bin) listening on PIPE with a new profile,
/// until it exits or standard input is closed. Leaves neither the process nor the profile behind.
int main(int argc, char** argv) {
  if (argc != 3) {
    std::fprintf(stderr, "usage: tessarine-office-host PROGRAM PIPE\n");
    return 2;
  }
  // Ctrl+C in the main program's terminal must not reach this process.
  setsid();
  const int signals = WatchedSignals();
  const Profile profile;
  const pid_t self = getpid();
  int status = 0;
  do {
    const pid_t office = fork();
    if (office == 0) {
      BecomeOffice(argv[1], profile.Path(), argv[2], self);
    }
    status = office < 0 ? SIGKILL : WaitForEnd(office, signals);
  } while (WIFEXITED(status) && (WEXITSTATUS(status) == Restart || WEXITSTATUS(status) == RestartAfterCrash));
  // A killed LibreOffice leaves its pipe behind, always in /tmp whatever TMPDIR says.
  unlink(("/tmp/OSL_PIPE_" + std::to_string(getuid()) + "_" + argv[2]).c_str());
  return WIFEXITED(status) ? WEXITSTATUS(status) : EXIT_FAILURE;
}
