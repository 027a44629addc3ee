#include "platform/jet/ChildProgram.h"

#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <iterator>

#include "platform/linux/ChildProcess.h"

namespace {

using SteadyClock = std::chrono::steady_clock;

constexpr std::size_t MostOfErrorKept = 4096;
constexpr std::size_t MostOfError = std::size_t{1} << 20U;
constexpr std::chrono::milliseconds BetweenWaits(50);

/// Reads both streams of a running child.
class Reading {
 public:
  Reading(const Pipe& output, const Pipe& errors, std::chrono::milliseconds silence,
          const ChildListener& listener)
      : sources_{{{output.ReadEnd.Number(), POLLIN, 0}, {errors.ReadEnd.Number(), POLLIN, 0}}},
        buffer_(std::size_t{1} << 18U),
        silence_(silence),
        listener_(listener) {}

  /// Reads until both streams are closed. False if the child has to be killed instead.
  bool ToTheEnd(ChildEnd& end) {
    SteadyClock::time_point limit = SteadyClock::now() + silence_;
    SteadyClock::time_point nextWait = SteadyClock::now() + BetweenWaits;
    while (sources_[0].fd >= 0 || sources_[1].fd >= 0) {
      const SteadyClock::time_point now = SteadyClock::now();
      if (now >= limit || errorBytes_ > MostOfError) {
        return false;
      }
      if (now >= nextWait) {
        listener_.OnWait();
        nextWait = SteadyClock::now() + BetweenWaits;
      }
      const auto pause = std::chrono::ceil<std::chrono::milliseconds>(std::min(limit, nextWait) - now);
      const int ready = poll(sources_.data(), sources_.size(), std::max(0, static_cast<int>(pause.count())));
      if (ready > 0 && ReadWhatIsThere(end)) {
        limit = SteadyClock::now() + silence_;
      }
    }
    return true;
  }

 private:
  /// True if there was standard output.
  bool ReadWhatIsThere(ChildEnd& end) {
    bool anyOutput = false;
    for (pollfd& source : sources_) {
      if (source.fd < 0 || source.revents == 0) {
        continue;
      }
      const ssize_t count = read(source.fd, buffer_.data(), buffer_.size());
      if (count <= 0) {
        source.fd = -1;  // closed: no longer polled
      } else if (&source == sources_.data()) {
        listener_.OnOutput({buffer_.data(), static_cast<std::size_t>(count)});
        anyOutput = true;
      } else {
        errorBytes_ += static_cast<std::size_t>(count);
        const std::size_t kept = MostOfErrorKept - end.Error.size();
        end.Error.append(buffer_.data(), std::min(static_cast<std::size_t>(count), kept));
      }
    }
    return anyOutput;
  }

  std::array<pollfd, 2> sources_;
  std::vector<char> buffer_;
  std::chrono::milliseconds silence_;
  const ChildListener& listener_;
  std::size_t errorBytes_ = 0;
};

}  // namespace

ChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                  std::chrono::milliseconds silence, const ChildListener& listener) {
  Pipe output;
  Pipe errors;
  constexpr int roomInPipe = 1 << 20;  // as much as the system grants an ordinary user
  fcntl(output.WriteEnd.Number(), F_SETPIPE_SZ, roomInPipe);
  std::vector<std::string> words = {program};
  std::copy(arguments.begin(), arguments.end(), std::back_inserter(words));
  ChildProcess child(words, {.Output = output.WriteEnd.Number(), .Error = errors.WriteEnd.Number()});
  output.WriteEnd.Close();
  errors.WriteEnd.Close();
  ChildEnd end;
  if (!Reading(output, errors, silence, listener).ToTheEnd(end)) {
    end.TimedOut = true;
    child.Kill();
  }
  end.Error = end.Error.substr(0, end.Error.find('\n'));
  end.Succeeded = child.Wait() && !end.TimedOut;
  return end;
}
