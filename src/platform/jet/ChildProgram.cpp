#include "platform/jet/ChildProgram.h"

#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <iterator>

#include "platform/linux/ChildProcess.h"

namespace {

constexpr std::size_t MostOfError = 4096;

}  // namespace

ChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                  std::chrono::milliseconds silence, const std::function<void(std::string_view)>& onOutput) {
  Pipe output;
  Pipe errors;
  std::vector<std::string> words = {program};
  std::copy(arguments.begin(), arguments.end(), std::back_inserter(words));
  ChildProcess child(words, {.Output = output.WriteEnd.Number(), .Error = errors.WriteEnd.Number()});
  output.WriteEnd.Close();
  errors.WriteEnd.Close();
  ChildEnd end;
  using Clock = std::chrono::steady_clock;
  Clock::time_point limit = Clock::now() + silence;
  std::array<pollfd, 2> sources = {
      {{output.ReadEnd.Number(), POLLIN, 0}, {errors.ReadEnd.Number(), POLLIN, 0}}};
  std::vector<char> buffer(std::size_t{1} << 18U);
  while (sources[0].fd >= 0 || sources[1].fd >= 0) {
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(limit - Clock::now()).count();
    if (left <= 0) {
      end.TimedOut = true;
      child.Kill();
      break;
    }
    const int ready = poll(sources.data(), sources.size(), static_cast<int>(left));
    for (pollfd& source : sources) {
      if (ready <= 0 || source.fd < 0 || source.revents == 0) {
        continue;
      }
      const ssize_t count = read(source.fd, buffer.data(), buffer.size());
      if (count <= 0) {
        source.fd = -1;  // closed: no longer polled
      } else if (&source == sources.data()) {
        onOutput({buffer.data(), static_cast<std::size_t>(count)});
        limit = Clock::now() + silence;
      } else if (end.Error.size() < MostOfError) {
        end.Error.append(buffer.data(), static_cast<std::size_t>(count));
      }
    }
  }
  end.Error = end.Error.substr(0, end.Error.find('\n'));
  end.Succeeded = child.Wait() && !end.TimedOut;
  return end;
}
