#include "platform/libreoffice/LibreOffice.h"

#include <dlfcn.h>
#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <cstdio>
#include <random>
#include <thread>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/libreoffice/OfficeClient.h"

namespace {

constexpr int CannotStart = 429;

std::string NewPipeName() {
  std::random_device random;
  char name[64];
  std::snprintf(name, sizeof name, "tessarine-%d-%08x%08x", getpid(), random(), random());
  return name;
}

}  // namespace

LibreOffice::LibreOffice(std::string folder) : folder_(std::move(folder)) {}

LibreOffice::~LibreOffice() {
  LibreOffice::Quit();
}

void LibreOffice::LoadModule() {
  if (client_ != nullptr) {
    return;
  }
  // A call to a LibreOffice that has just died must fail instead of ending this program.
  std::signal(SIGPIPE, SIG_IGN);
  // Never unloaded: LibreOffice's libraries keep threads of their own.
  void* const module = dlopen((folder_ + "/libtessarine-office.so").c_str(), RTLD_NOW | RTLD_LOCAL);
  void* const symbol = module == nullptr ? nullptr : dlsym(module, NewOfficeClientName);
  if (symbol == nullptr) {
    throw RuntimeError(CannotStart, dlerror());
  }
  client_.reset(reinterpret_cast<NewOfficeClientFunction*>(symbol)());
}

void LibreOffice::Start() {
  if (State() != WordState::Ended) {
    return;
  }
  LoadModule();
  StartHost();
}

void LibreOffice::StartHost() {
  const std::string office = client_->ProgramFolder() + "/soffice.bin";
  const std::string host = folder_ + "/tessarine-office-host";
  if (access(office.c_str(), X_OK) != 0) {
    throw RuntimeError(CannotStart, "There is no program " + office);
  }
  pipe_ = NewPipeName();
  int leash[2];
  if (pipe2(leash, O_CLOEXEC) != 0) {
    throw RuntimeError(CannotStart, "No pipe");
  }
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_adddup2(&actions, leash[0], STDIN_FILENO);
  char* const arguments[] = {const_cast<char*>(host.c_str()), const_cast<char*>(office.c_str()), pipe_.data(),
                             nullptr};
  const int failure = posix_spawn(&host_, host.c_str(), &actions, nullptr, arguments, environ);
  posix_spawn_file_actions_destroy(&actions);
  close(leash[0]);
  if (failure != 0) {
    close(leash[1]);
    host_ = 0;
    throw RuntimeError(CannotStart, "The program " + host + " cannot be started");
  }
  leash_ = leash[1];
}

bool LibreOffice::HostRuns() {
  if (host_ != 0 && waitpid(host_, nullptr, WNOHANG) != 0) {
    close(leash_);
    leash_ = -1;
    host_ = 0;
    ready_ = false;
  }
  return host_ != 0;
}

WordState LibreOffice::State() {
  if (!HostRuns()) {
    return WordState::Ended;
  }
  ready_ = ready_ || client_->Connect(pipe_);
  return ready_ ? WordState::Ready : WordState::Starting;
}

std::unique_ptr<WordDocument> LibreOffice::Add(const std::string& path) {
  if (State() != WordState::Ready) {
    throw RuntimeError(CannotStart, "The word processor does not run");
  }
  return client_->Add(path);
}

void LibreOffice::JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                           const std::function<void()>& onProgress) {
  LoadModule();
  client_->JoinPdfs(parts, target, onProgress);
}

void LibreOffice::Quit() noexcept {
  if (!HostRuns()) {
    return;
  }
  // LibreOffice is not asked to quit: it would not answer if it hangs, and it has nothing to save.
  client_->Disconnect();
  close(leash_);
  leash_ = -1;
  // The host ends promptly whatever LibreOffice does; waiting for it leaves no process behind.
  while (waitpid(host_, nullptr, 0) < 0 && errno == EINTR) {
  }
  host_ = 0;
  ready_ = false;
}
