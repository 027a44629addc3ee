#include "firmware/download/DownloadLine.h"

#include "platform/Fault.h"

using std::chrono::milliseconds;

namespace {

constexpr std::string_view Announcement = "BOOT";

}  // namespace

DownloadLine::DownloadLine(SerialPort& port, EventPump& events, MessageBoxes& boxes,
                           const DownloadFlags& flags, FirmwareRecord& record)
    : job_(port, events, "boot-code", [&flags] { return flags.Closing; }),
      events_(events),
      boxes_(boxes),
      flags_(flags),
      record_(record) {}

DownloadStep DownloadLine::CheckAbort() {
  events_.DoEvents();
  return Ended();
}

DownloadStep DownloadLine::Ended() const {
  if (flags_.AbortRequested || job_.Stopped()) {
    return Stopped();
  }
  return std::nullopt;
}

FirmwareEnd DownloadLine::Stopped() const {
  return flags_.AbortRequested ? FirmwareEnd::Aborted : FirmwareEnd::ProgramCloses;
}

DownloadStep DownloadLine::SendString(std::string_view text) {
  for (const char character : text) {
    const auto byte = static_cast<std::uint8_t>(character);
    if (job_.Send(byte)) {
      record_.Sent(byte);
    } else if (job_.Fault()) {
      return TellOfFault();
    }
  }
  return std::nullopt;
}

void DownloadLine::SendByte(std::uint8_t byte) {
  if (job_.Send(byte)) {
    record_.Sent(byte);
  } else if (job_.Fault()) {
    throw RuntimeError(job_.Fault()->Error);
  }
}

void DownloadLine::SendBytes(std::span<const std::uint8_t> bytes) {
  for (const std::uint8_t byte : bytes) {
    SendByte(byte);
    events_.DoEvents();
  }
}

DownloadStep DownloadLine::AwaitAnnouncement() {
  std::string announced;
  const auto arrived = [&] {
    while (const auto character = ReadChar()) {
      // Longer than the announcement, it can never equal it again.
      if (Announcement.find(*character) != std::string_view::npos &&
          announced.size() <= Announcement.size()) {
        announced += *character;
      }
      if (announced == Announcement) {
        return true;
      }
    }
    return false;
  };
  const DownloadStep end = Wait(arrived, First::Abort, milliseconds::max());
  return end == FirmwareEnd::Aborted ? FirmwareEnd::NoLoadMode : end;
}

DownloadReply DownloadLine::Await(std::string_view wanted, First first) {
  DownloadReply reply;
  reply.End = Wait(
      [&] {
        while (const auto character = ReadChar()) {
          if (wanted.find(*character) != std::string_view::npos) {
            reply.Character = *character;
            return true;
          }
          NoteBadReply("nothing, while \"" + std::string(wanted) + "\" is awaited", *character);
        }
        return false;
      },
      first, ReplyLimit);
  return reply;
}

DownloadStep DownloadLine::Ask(std::string_view command, std::string_view answer) {
  if (const DownloadStep end = SendString(command)) {
    return end;
  }
  return Await(answer).End;
}

DownloadReply DownloadLine::AwaitReply() {
  DownloadReply reply;
  reply.End = Wait(
      [&] {
        const auto character = ReadChar();
        reply.Character = character.value_or('\0');
        return character.has_value();
      },
      First::Abort, ReplyLimit);
  return reply;
}

std::optional<char> DownloadLine::ReadChar() {
  const auto byte = job_.Take();
  if (!byte) {
    return std::nullopt;
  }
  record_.Received(*byte);
  return static_cast<char>(*byte);
}

DownloadStep DownloadLine::Wait(const std::function<bool()>& arrived, First first, milliseconds limit) {
  bool met = false;
  const LineWait wait = job_.WaitUntil(
      [&] {
        met = !(first == First::Abort && flags_.AbortRequested) && arrived();
        return met || flags_.AbortRequested;
      },
      limit);
  if (met) {
    return std::nullopt;
  }
  switch (wait) {
    case LineWait::TimedOut:
      return FirmwareEnd::TimedOut;
    case LineWait::Fault:
      return TellOfFault();
    default:
      return Stopped();
  }
}

FirmwareEnd DownloadLine::TellOfFault() {
  const LineFault fault = *job_.Fault();
  if (fault.Error.Number() == Fault::PortLost) {
    throw RuntimeError(fault.Error);
  }
  boxes_.Show(fault.Sending ? "Error occured sending data. Please try again."
                            : "Error occured receiving data. Please try again.",
              DefaultBoxTitle, BoxIcon::Exclamation);
  return FirmwareEnd::LineFailed;
}
