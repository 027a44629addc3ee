#include "platform/libreoffice/LibreOffice.h"

#include <dlfcn.h>
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

std::string NewPipeName() {
  std::random_device random;
  char name[64];
  std::snprintf(name, sizeof name, "tessarine-%d-%08x%08x", getpid(), random(), random());
  return name;
}

}  // namespace

LibreOffice::LibreOffice(const std::string& folder)
    : module_(folder + "/libtessarine-office.so"), hostProgram_(folder + "/tessarine-office-host") {}

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
  void* const module = dlopen(module_.Path().c_str(), RTLD_NOW | RTLD_LOCAL);
  void* const symbol = module == nullptr ? nullptr : dlsym(module, NewOfficeClientName);
  if (symbol == nullptr) {
    throw RuntimeError(Fault::CannotCreateObject, dlerror());
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
  if (access(office.c_str(), X_OK) != 0) {
    throw RuntimeError(Fault::CannotCreateObject, "There is no program " + office);
  }
  pipe_ = NewPipeName();
  try {
    Pipe leash;
    host_.emplace(std::vector<std::string>{hostProgram_.Path(), office, pipe_},
                  StandardStreams{.Input = leash.ReadEnd.Number()});
    leash_ = std::move(leash.WriteEnd);
  } catch (const RuntimeError&) {
    throw RuntimeError(Fault::CannotCreateObject,
                       "The program " + hostProgram_.Name() + " cannot be started");
  }
}

bool LibreOffice::HostRuns() {
  if (host_ && !host_->Running()) {
    ForgetHost();
  }
  return host_.has_value();
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
    throw RuntimeError(Fault::CannotCreateObject, "The word processor does not run");
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
  leash_.Close();
  // The host ends promptly whatever LibreOffice does; waiting for it leaves no process behind.
  host_->Wait();
  ForgetHost();
}

void LibreOffice::ForgetHost() {
  leash_.Close();
  host_.reset();
  ready_ = false;
}
