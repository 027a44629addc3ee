#include "core/data/ProgramLog.h"

#include <utility>

#include "core/data/LogText.h"

ProgramLog::ProgramLog(Files& disk, const Clock& time, std::string dataFolder)
    : disk_(disk),
      time_(time),
      dataFolder_(std::move(dataFolder)),
      ring_(disk, dataFolder_ + "/logs", "program", FileBytes) {}

void ProgramLog::Started(const std::vector<std::string>& facts) {
  for (const std::string& fact : facts) {
    Write("start", fact);
  }
}

void ProgramLog::Command(std::string_view name) {
  latestCommand_ = name;
  Write("command", name);
}

void ProgramLog::BoxOpened(std::string_view title, std::string_view text) {
  Write("box", LogText(title, dataFolder_) + ": " + LogText(text, dataFolder_));
}

void ProgramLog::BoxClosed(std::string_view answer) {
  Write("answer", answer);
}

void ProgramLog::Fault(std::string_view text) {
  std::string row = LogText(text, dataFolder_);
  if (!latestCommand_.empty()) {
    row += " (latest command " + latestCommand_ + ")";
  }
  Write("fault", row);
}

void ProgramLog::PortOpening(std::string_view device, std::string_view settings, int fault) {
  std::string row = std::string(device) + ' ' + std::string(settings);
  row += fault == 0 ? " open" : " fault " + std::to_string(fault);
  Write("port", row);
}

void ProgramLog::Ended(int exitCode) {
  Write("end", "exit code " + std::to_string(exitCode));
}

void ProgramLog::Write(std::string_view kind, std::string_view text) {
  constexpr std::size_t kindWidth = 9;
  std::string row = time_.Now() + "  " + std::string(kind);
  row.append(kindWidth - kind.size(), ' ').append(text).append("\n");
  constexpr std::size_t mostWaiting = 64U << 10U;
  if (disk_.FolderExists(dataFolder_)) {
    ring_.Append(std::exchange(waiting_, {}) + row);
  } else if (waiting_.size() < mostWaiting) {
    waiting_ += row;
  }
}
