#include "sound/RecorderLink.h"

#include "core/line/Checksum.h"

using std::chrono::milliseconds;

const char* LineSettings(Recorder recorder) {
  return recorder == Recorder::StandAlone ? "115200,N,8,1" : "19200,N,8,1";
}

RecorderLink::RecorderLink(const Parts& parts)
    : parts_(parts), job_(parts.MSComm1, parts.Events, "sound-recorder", parts.StopRequested) {}

void RecorderLink::Open(const std::string& device) {
  if (parts_.MSComm1.PortOpen()) {
    job_.ClearInput();
  } else {
    job_.Open(device, LineSettings(Mode()));
  }
}

void RecorderLink::SetupComm() {
  job_.SetSettings(LineSettings(Mode()));
}

void RecorderLink::SendCommand(std::initializer_list<std::uint8_t> bytes) {
  bool first = true;
  for (const std::uint8_t byte : bytes) {
    if (!first) {
      job_.Pause(CommandPause);
    }
    first = false;
    job_.Send(byte);
  }
}

void RecorderLink::SendPrefix(std::initializer_list<std::uint8_t> bytes) {
  for (const std::uint8_t byte : bytes) {
    job_.Send(byte);
    job_.Pause(CommandPause);
  }
}

bool RecorderLink::WaitForAck(milliseconds limit) {
  const LineWait wait = job_.WaitUntil(
      [this] {
        while (!ackReceived_) {
          const auto byte = job_.Take();
          if (!byte) {
            return false;
          }
          Take(*byte);
        }
        return true;
      },
      limit);
  if (wait == LineWait::TimedOut) {
    parts_.Boxes.Show("Timed out waiting for response from device. Check connections and retry",
                      DefaultBoxTitle, BoxIcon::Exclamation);
  }
  return wait == LineWait::Met;
}

bool RecorderLink::SendData(Data data, std::uint8_t crc, const std::function<bool()>& paced) {
  constexpr std::size_t blockBytes = 32;
  constexpr milliseconds bytePause(1);
  for (std::size_t start = 0; start < data.size() && !job_.Over(); start += blockBytes) {
    const auto block = data.subspan(start, blockBytes);
    for (const std::uint8_t byte : block) {
      job_.Send(byte);
      if (paced()) {
        job_.Pause(bytePause);
      }
    }
    crc = Crc8(block, crc);
    ClearAck();
    DoEvents();
  }
  job_.Pause(BlockPause);
  job_.Send(crc);
  return WaitForAck();
}

void RecorderLink::DoEvents() {
  parts_.Events.DoEvents();
  while (const auto byte = job_.Take()) {
    Take(*byte);
  }
}

void RecorderLink::ThrowIfLineLost() {
  if (const auto fault = job_.FaultToTell()) {
    throw fault->Error;
  }
}
