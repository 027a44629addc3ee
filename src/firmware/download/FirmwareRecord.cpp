#include "firmware/download/FirmwareRecord.h"

#include <array>
#include <chrono>
#include <cstdio>

#include "core/data/DatedFiles.h"
#include "core/data/LogRing.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t MostRecords = 10;

}  // namespace

FirmwareRecord::FirmwareRecord(const Parts& parts, const std::string& fileName, const std::string& contents)
    : parts_(parts),
      head_("File: " + fileName + '\n' + contents + "\nBegun: " + parts.Time.Now() + '\n'),
      transcript_([this](const std::string& rows) { Keep(rows); }, "boot-code", parts.Elapsed,
                  Transcript::Repeats::Written) {}

void FirmwareRecord::Sent(std::uint8_t byte) {
  isEmpty_ = false;
  transcript_.FromHost(byte);
}

void FirmwareRecord::Received(std::uint8_t byte) {
  isEmpty_ = false;
  transcript_.ToHost(byte);
}

void FirmwareRecord::BadAnswer(std::string_view toWhat, char answer) {
  if (++answerCount_ > MostAnswers) {
    return;
  }
  const std::chrono::duration<double> time = parts_.Elapsed.Elapsed();
  std::array<char, 40> row{};
  std::snprintf(row.data(), row.size(), "%12.6f %02X to ", time.count(), static_cast<unsigned char>(answer));
  answers_.append(row.data()).append(toWhat) += '\n';
}

void FirmwareRecord::Keep(const std::string& rows) {
  std::size_t kept = 0;
  if (leftOut_ == 0 && last_.empty()) {
    while (kept < rows.size()) {
      const std::size_t next = rows.find('\n', kept) + 1;
      if (first_.size() + next > KeptBytes) {
        break;
      }
      kept = next;
    }
    first_ += rows.substr(0, kept);
  }
  last_ += rows.substr(kept);
  if (last_.size() > KeptBytes) {
    const std::size_t surplus = last_.find('\n', last_.size() - KeptBytes - 1) + 1;
    last_.erase(0, surplus);
    leftOut_ += surplus;
  }
}

std::string FirmwareRecord::Text(std::string_view end) {
  std::string text = head_ + "Ended: " + parts_.Time.Now() + ' ';
  text.append(end) += "\n\nAnswers other than the good one:\n";
  text += answers_.empty() ? "none\n" : answers_;
  if (answerCount_ > MostAnswers) {
    text += "... " + std::to_string(answerCount_ - MostAnswers) + " more ...\n";
  }
  text += "\nTranscript:\n" + first_;
  if (leftOut_ > 0) {
    text += "... " + std::to_string(leftOut_) + " bytes left out ...\n";
  }
  return text + last_;
}

void FirmwareRecord::Write(std::string_view end) {
  transcript_.End();
  if (isEmpty_) {
    return;
  }
  try {
    if (!parts_.Disk.FolderExists(parts_.Folder)) {
      parts_.Disk.CreateFolder(parts_.Folder);
    }
    const std::string text = Text(end);
    if (parts_.Disk.FreeSpace(parts_.Folder) < LogRing::FreeBytesKept + text.size()) {
      return;
    }
    const DatedFiles records(parts_.Disk, parts_.Folder, "firmware", ".log", MostRecords);
    const std::string name = records.NameAt(parts_.Time.Now());
    parts_.Disk.Replace(parts_.Folder + '/' + name, text);
    records.DeleteOldest(name);
  } catch (const RuntimeError&) {
    return;  // the download itself is what counts
  }
}
