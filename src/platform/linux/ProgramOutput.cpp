#include "platform/linux/ProgramOutput.h"

#include <fcntl.h>
#include <poll.h>

#include <array>

#include "platform/RuntimeError.h"
#include "platform/linux/ChildProcess.h"

namespace {

/// Reads what a pipe holds. False at its end.
bool ReadSome(const Descriptor& pipe, std::string& text) {
  std::array<char, 4096> buffer;
  const ssize_t got = read(pipe.Number(), buffer.data(), buffer.size());
  if (got > 0) {
    text.append(buffer.data(), static_cast<std::size_t>(got));
  }
  return got > 0;
}

}  // namespace

ProgramOutput RunToEnd(const std::vector<std::string>& words, std::chrono::milliseconds patience,
                       const std::function<bool()>& keepOn) {
  constexpr int betweenQuestions = 20;  // milliseconds
  const Descriptor nothing(open("/dev/null", O_RDWR | O_CLOEXEC));
  Pipe output;
  Pipe errors;
  ChildProcess child(words, {nothing.Number(), output.WriteEnd.Number(), errors.WriteEnd.Number()});
  output.WriteEnd.Close();
  errors.WriteEnd.Close();
  const auto end = std::chrono::steady_clock::now() + patience;
  ProgramOutput result;
  pollfd watched[] = {{output.ReadEnd.Number(), POLLIN, 0}, {errors.ReadEnd.Number(), POLLIN, 0}};
  while (watched[0].fd >= 0 || watched[1].fd >= 0 || child.Running()) {
    if (!keepOn()) {
      return {};
    }
    if (std::chrono::steady_clock::now() > end) {
      throw RuntimeError(Fault::DeviceUnavailable,
                         words.front() + ": " + std::to_string(patience.count()) + " ms");
    }
    poll(static_cast<pollfd*>(watched), 2, betweenQuestions);
    if (watched[0].fd >= 0 && watched[0].revents != 0 && !ReadSome(output.ReadEnd, result.Text)) {
      watched[0].fd = -1;
    }
    if (watched[1].fd >= 0 && watched[1].revents != 0 && !ReadSome(errors.ReadEnd, result.Errors)) {
      watched[1].fd = -1;
    }
  }
  result.Succeeded = child.Wait();
  return result;
}
