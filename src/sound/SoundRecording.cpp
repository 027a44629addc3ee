#include "sound/SoundRecording.h"

#include <array>
#include <chrono>

#include "core/line/Checksum.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"

using std::chrono::milliseconds;

namespace {

struct SoundExtent {
  std::uint64_t Start;
  std::int64_t Size;
};

/// The pages of a sound: as many as are nearest to its size, the last of them silent. What the file lacks is
/// zeros.
std::string ReadPages(const Files& disk, const std::string& path, const SoundExtent& extent,
                      std::int16_t pages) {
  const std::size_t total = static_cast<std::size_t>(pages) * SoundChip::PageBytes;
  if (total < SoundChip::PageBytes) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  std::string buffer = disk.ReadPart(path, extent.Start, total);
  buffer.resize(total);
  buffer.replace(total - SoundChip::PageBytes, SoundChip::PageBytes, SoundChip::PageBytes,
                 static_cast<char>(SoundChip::Silence));
  return buffer;
}

}  // namespace

void SoundRecording::Record() {
  if (!Start() || !Erase()) {
    // A wrong answer or none leaves the line open for the next try; one that is lost is closed anyway.
    parts_.Link.Job().LeaveOpen();
    return;
  }
  if (parts_.Link.Mode() != Recorder::StandAlone) {
    SendPageIndexes();
  }
  currentPage_ = 0;
  if (SendSounds()) {
    parts_.Link.ClearAck();
    parts_.Link.SendCommand({0, 0});
    parts_.Link.WaitForAck();
    parts_.Display.SetStatus("Recording Complete.");
  }
  parts_.Link.Job().Close();
  parts_.Display.SetStatus2("");
}

bool SoundRecording::Idle() {
  parts_.Display.SetStatus("Idle");
  return false;
}

bool SoundRecording::Start() {
  parts_.Display.SetStatus("Starting...");
  parts_.Link.ClearAck();
  if (parts_.Link.Mode() == Recorder::StandAlone) {
    parts_.Link.SendCommand({2, 3});
  } else {
    parts_.Link.SendCommand({10, 0});
  }
  return parts_.Link.WaitForAck() || Idle();
}

bool SoundRecording::Erase() {
  constexpr milliseconds eraseTimeLimit(30000);
  parts_.Display.SetStatus("Erasing Flash...");
  parts_.Link.ClearAck();
  if (parts_.Link.Mode() == Recorder::StandAlone) {
    parts_.Link.SendCommand({2, 3});
  } else {
    parts_.Link.SendCommand({2, 0});
  }
  if (!parts_.Link.WaitForAck()) {
    return Idle();
  }
  parts_.Link.ClearAck();
  if (!parts_.Link.WaitForAck(eraseTimeLimit)) {
    return Idle();
  }
  parts_.Display.SetStatus("Erase complete.");
  parts_.Link.ClearAck();
  return true;
}

void SoundRecording::SendPageIndexes() {
  SerialJob& job = parts_.Link.Job();
  job.Pause(RecorderLink::BlockPause);
  const auto bytes = parts_.PageIndexTable.Bytes();
  parts_.Display.SetStatus("Sending Page Indexes");
  parts_.Link.SendPrefix({1, 0, 0, 0});
  if (!parts_.Link.SendData(bytes, 0, [] { return true; })) {
    parts_.Display.SetStatus("Idle");
    return;
  }
  AddPage();
  parts_.Display.SetStatus("Page Indexes sent OK");
  job.Pause(RecorderLink::BlockPause);
}

bool SoundRecording::SendSounds() {
  const std::vector<SoundRow>& rows = parts_.List.Rows();
  for (std::size_t row = 0; row < rows.size(); ++row) {
    if (rows[row].File.empty()) {
      continue;
    }
    parts_.Display.SelectRow(row);
    // The list may be another one before this sound is sent.
    const std::string path = rows[row].File;
    if (parts_.Link.Job().Over() || !ProgramFile(path, static_cast<std::int16_t>(row))) {
      parts_.Display.SetStatus("Recording Failed.");
      return false;
    }
  }
  return true;
}

bool SoundRecording::ProgramFile(const std::string& path, std::int16_t soundNumber) {
  SoundExtent extent{0, 0};
  if (IsWave(path)) {
    if (!parts_.Wave.WaveOpenFile(path)) {
      return false;
    }
    extent = {parts_.Wave.DataOffset(), parts_.Wave.ReadSize()};
  } else {
    extent.Size = RawSize(parts_.Disk, path);
  }
  const std::int16_t pages = ToPage(SoundChip::PagesOf(extent.Size));
  const std::string buffer = ReadPages(parts_.Disk, path, extent, pages);
  if (!SendHeader(soundNumber)) {
    parts_.Display.SetStatus("Idle");
    return false;
  }
  SerialJob& job = parts_.Link.Job();
  job.Pause(RecorderLink::BlockPause);
  if (parts_.Link.Mode() == Recorder::StandAlone) {
    parts_.Link.ClearAck();
    job.Send(LoByte(pages));
    job.Pause(RecorderLink::BlockPause);
    job.Send(HiByte(pages));
  }
  parts_.Display.SetStatus("Programming File: " + path);
  bool sent = true;
  for (std::int32_t page = 0; sent && page < pages; ++page) {
    parts_.Display.PageBegins();
    job.Pause(RecorderLink::BlockPause);
    parts_.Display.SetStatus2("Sending Page Number: " + Str(page) + " of " + Str(std::int32_t{pages} - 1));
    const auto* data = reinterpret_cast<const std::uint8_t*>(buffer.data());
    sent = SendPage(
        RecorderLink::Data(data + std::ptrdiff_t{page} * SoundChip::PageBytes, RecorderLink::DataBytes));
  }
  parts_.Display.SetStatus("Idle");
  return sent;
}

bool SoundRecording::SendHeader(std::int16_t soundNumber) {
  SerialJob& job = parts_.Link.Job();
  job.Pause(RecorderLink::BlockPause);
  if (parts_.Link.Mode() == Recorder::StandAlone) {
    parts_.Link.SendCommand({1, static_cast<std::uint8_t>(soundNumber)});
  }
  // Not cleared before: after the first sound the acknowledgement of the last page ends this wait.
  return parts_.Link.WaitForAck();
}

bool SoundRecording::SendPage(RecorderLink::Data page) {
  std::uint8_t crc = 0;
  if (parts_.Link.Mode() != Recorder::StandAlone) {
    const std::array number = {LoByte(currentPage_), HiByte(currentPage_)};
    parts_.Link.SendPrefix({1, 0, number[0], number[1]});
    crc = Crc8(number);
  }
  if (!parts_.Link.SendData(page, crc, [this] { return parts_.Link.Mode() != Recorder::StandAlone; })) {
    return false;
  }
  parts_.Link.DoEvents();
  parts_.Link.Job().Pause(RecorderLink::BlockPause);
  AddPage();
  return true;
}

void SoundRecording::AddPage() {
  currentPage_ = ToPage(currentPage_ + 1);
}

void TestSounds(RecorderLink& link, const SoundList& list, RecorderDisplay& display) {
  constexpr milliseconds playTimeLimit(60000);
  constexpr milliseconds betweenSounds(1000);
  for (std::size_t row = 0; row < list.Rows().size(); ++row) {
    const std::string number = std::to_string(row + 1);
    link.ClearAck();
    display.SetStatus("Testing sound: " + number);
    link.DoEvents();
    const auto sound = static_cast<std::uint8_t>(row);
    if (link.Mode() == Recorder::StandAlone) {
      link.SendCommand({3, 2, sound});
    } else {
      link.SendCommand({14, 0, sound});
    }
    if (!link.WaitForAck(playTimeLimit)) {
      display.SetStatus("Test of sound " + number + " failed.");
      break;
    }
    link.Job().Pause(betweenSounds);
    link.DoEvents();
  }
  display.SetStatus("Testing complete.");
  link.Job().Close();
}
