#include "platform/linux/LinuxPrograms.h"

#include <fcntl.h>
#include <sys/wait.h>

#include "platform/RuntimeError.h"
#include "platform/linux/ChildProcess.h"
#include "platform/linux/Descriptor.h"

void LinuxPrograms::Start(const std::vector<std::string>& words) {
  ForgetEnded();
  if (words.empty()) {
    throw RuntimeError(Fault::InvalidProcedureCall);
  }
  const Descriptor nothing(open("/dev/null", O_RDWR | O_CLOEXEC));
  const int number = nothing.Number();
  running_.push_back(StartProcess(words, {number, number, number}, ProcessKind::Detached));
}

void LinuxPrograms::ForgetEnded() {
  std::erase_if(running_, [](pid_t id) { return waitpid(id, nullptr, WNOHANG) != 0; });
}
