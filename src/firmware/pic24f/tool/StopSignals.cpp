#include "firmware/pic24f/tool/StopSignals.h"

#include <sys/signalfd.h>
#include <unistd.h>

#include <csignal>

namespace {

int CatchSignals() {
  sigset_t caught;
  sigemptyset(&caught);
  for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
    sigaddset(&caught, signal);
  }
  pthread_sigmask(SIG_BLOCK, &caught, nullptr);
  return signalfd(-1, &caught, SFD_CLOEXEC | SFD_NONBLOCK);
}

}  // namespace

StopSignals::StopSignals() : descriptor_(CatchSignals()) {
  notifier_.emplace(descriptor_.Number(), QSocketNotifier::Read);
  QObject::connect(&*notifier_, &QSocketNotifier::activated, [this] { Take(); });
}

void StopSignals::Take() {
  signalfd_siginfo info{};
  while (read(descriptor_.Number(), &info, sizeof info) == sizeof info) {
    ++count_;
  }
}
