#include "devices/box/BoxProgrammer.h"

#include "platform/RuntimeError.h"

namespace {

using std::chrono::milliseconds;

constexpr milliseconds BytePause{1};
constexpr milliseconds AckTimer{2000};
constexpr std::uint8_t Accepted = 0xAA;

}  // namespace

void BoxProgrammer::Program(const BoxEntries& entries) {
  if (waiting_ != nullptr) {
    SerialJob& job = *waiting_;
    failed_ = !Succeeds(job, [&] { Send(job, entries); });
    return;
  }
  failed_ = false;
  SerialJob job(parts_.MSComm1, parts_.Events, "utility-box", [this] { return parts_.Stopped() || failed_; });
  sent_ = entries;
  const bool sent = Succeeds(job, [&] {
    job.Open(parts_.Port.Device(), LineSettings);
    Send(job, entries);
  });
  if (!sent) {
    return;
  }
  waiting_ = &job;
  const auto [wait, answer] = job.WaitForByte(AckTimer);
  waiting_ = nullptr;
  switch (wait) {
    case LineWait::Met:
      TellAnswer(answer);
      break;
    case LineWait::TimedOut:
      Tell(BoxResult::NoResponse);
      parts_.Boxes.Show("No response from Box, please check serial connection and try again.",
                        "Communications Error", BoxIcon::None);
      break;
    case LineWait::Fault:
    case LineWait::Stopped:
      Tell(BoxResult::Unconfirmed);
      if (const auto fault = job.FaultToTell()) {
        job.Close();
        throw fault->Error;
      }
      break;
  }
}

bool BoxProgrammer::Succeeds(SerialJob& job, const std::function<void()>& steps) {
  try {
    steps();
    return true;
  } catch (const RuntimeError& error) {
    job.Close();
    failed_ = true;
    if (waiting_ == nullptr) {
      Tell(BoxResult::NotSent);
    }
    parts_.Boxes.Show(
        error.Number() == Fault::PortAlreadyOpen ? "Could not access Comms port" : "Comm port error.",
        "Comms error", BoxIcon::Exclamation);
    return false;
  }
}

void BoxProgrammer::Send(SerialJob& job, const BoxEntries& entries) {
  const auto frame = BoxFrame(entries);
  job.Send(frame.front());
  for (std::size_t i = 1; i < frame.size(); ++i) {
    job.Pause(BytePause);
    job.Send(frame[i]);
  }
  if (const auto fault = job.FaultToTell()) {
    throw fault->Error;
  }
  sent_ = entries;
}

void BoxProgrammer::TellAnswer(std::uint8_t answer) {
  if (answer == Accepted) {
    Tell(BoxResult::Accepted);
    parts_.Boxes.Show("Programming Successful", "Orvalin Box Config", BoxIcon::Information);
  } else {
    Tell(BoxResult::Rejected);
    parts_.Boxes.Show("Programming rejected by Box, please check values and try again", "Orvalin Box Config",
                      BoxIcon::Exclamation);
  }
}
