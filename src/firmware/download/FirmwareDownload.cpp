#include "firmware/download/FirmwareDownload.h"

#include <array>
#include <cstdio>
#include <exception>
#include <new>
#include <optional>

#include "core/line/Checksum.h"
#include "firmware/download/Qvm2Route.h"
#include "firmware/download/QvmRoute.h"

namespace {

/// Five times a full image of a device, so that no file holds the window up.
constexpr std::size_t MostFileBytes = 8U << 20U;

void ThrowIfTooLarge(std::string_view bytes) {
  if (bytes.size() > MostFileBytes) {
    throw RuntimeError(Fault::OutOfMemory);
  }
}

/// Shows the hourglass as long as it exists.
class BusyPointer {
 public:
  explicit BusyPointer(FirmwareDisplay& display) : display_(display) { display_.SetBusy(true); }
  ~BusyPointer() { display_.SetBusy(false); }
  BusyPointer(const BusyPointer&) = delete;
  BusyPointer& operator=(const BusyPointer&) = delete;

 private:
  FirmwareDisplay& display_;
};

std::string ContentsText(std::string_view bytes) {
  std::array<char, 64> text{};
  std::snprintf(text.data(), text.size(), "%zu bytes, CRC-32 %08X", bytes.size(), Crc32(bytes));
  return text.data();
}

}  // namespace

FirmwareDownload::FirmwareDownload(const Parts& parts, FirmwareDisplay& display)
    : parts_(parts), display_(display) {}

void FirmwareDownload::Run(const std::string& fileName, const std::function<std::string()>& device) {
  Begin();
  const FirmwareFileType type = TypeOf(fileName);
  std::optional<FirmwareRecord> record;
  std::optional<DownloadLine> line;
  try {
    if (!Load(type, fileName)) {
      Advise(OwnText::AdviceNotStarted);
      return;
    }
    record.emplace(parts_.Record, fileName, contents_);
    line.emplace(parts_.MSComm1, parts_.Events, parts_.Boxes, flags_, *record);
    display_.SetLamps(false, false);
    display_.SetDownload("Running...");
    display_.SetStatus("Power up device now. Waiting for device response...");
    line->Open(device());
  } catch (const std::exception&) {
    Advise(OwnText::AdviceNotStarted);
    throw;
  }
  record->Write(Converse(type, *line));
}

void FirmwareDownload::Begin() {
  flags_ = {};
  stage_ = FirmwareStage::Announcing;
  display_.SetAdvice({});
  display_.SetSent(0, 0);
  display_.SetBar(0);
  display_.SetDownload("Downloading...");
  ClosePort();
}

bool FirmwareDownload::Load(FirmwareFileType type, const std::string& fileName) {
  contents_ = "not loaded";
  lines_.reset();
  if (type == FirmwareFileType::Qvm) {
    if (fileName.empty()) {
      Tell("Error, no QVM file found");
      return false;
    }
    const BusyPointer busy(display_);
    std::string bytes = ReadStart(fileName);
    ThrowIfTooLarge(bytes);
    contents_ = ContentsText(bytes);
    lines_ = std::make_unique<QvmLines>(std::move(bytes));
  } else if (type == FirmwareFileType::Qvm2 && !LoadQvm2File(fileName)) {
    Tell("Failed to load the QVM2 file.");
    return false;
  }
  return true;
}

bool FirmwareDownload::LoadQvm2File(const std::string& fileName) {
  const BusyPointer busy(display_);
  const std::string bytes = ReadStart(fileName);
  const std::size_t whole = bytes.size() > MostFileBytes ? bytes.rfind('\n') + 1 : bytes.size();
  // Of a file that is too large the start may tell more: above all that there is more data than room for it.
  const bool loaded = image_.LoadQvm2File(std::string_view(bytes).substr(0, whole));
  ThrowIfTooLarge(bytes);
  contents_ = ContentsText(bytes);
  return loaded;
}

std::string FirmwareDownload::ReadStart(const std::string& fileName) const {
  return parts_.Record.Disk.ReadPart(fileName, 0, MostFileBytes + 1);
}

std::string FirmwareDownload::Converse(FirmwareFileType type, DownloadLine& line) {
  try {
    return End(Transfer(type, line).value_or(FirmwareEnd::Complete), line);
  } catch (const RuntimeError& error) {
    return Fail(error, line);
  } catch (const std::bad_alloc&) {
    return Fail(RuntimeError(Fault::OutOfMemory), line);
  }
}

DownloadStep FirmwareDownload::Transfer(FirmwareFileType type, DownloadLine& line) {
  const StayAwake awake(parts_.Awake, parts_.Strings.Text(OwnText::FirmwareWakeReason));
  display_.EnableButtons(true);
  display_.SetBreakCaption("&Stop Waiting");
  if (const DownloadStep end = line.AwaitAnnouncement()) {
    return end;
  }
  stage_ = FirmwareStage::Identifying;
  display_.SetBreakCaption("Abort");
  display_.SetStatus("Syncronising with device...");
  display_.SetLamps(true, false);
  if (const DownloadStep end = line.Ask("X", "x")) {
    return end;
  }
  switch (type) {
    case FirmwareFileType::Qvm:
      return QvmRoute(line, display_, stage_).Transfer(lines_->BufferLines());
    case FirmwareFileType::Qvm2:
      return Qvm2Route(line, display_, stage_).Transfer(image_);
    default:
      return std::nullopt;
  }
}

std::string FirmwareDownload::End(FirmwareEnd end, DownloadLine& line) {
  display_.SetSent(0, 0);
  if (end == FirmwareEnd::Complete) {
    display_.SetDownload("Download Complete!");
    display_.SetLamps(true, true);
    display_.EnableButtons(false);
    line.Close();
    return "complete";
  }
  const FirmwareEndTold told = ToldOf(end);
  if (told.Text != nullptr) {
    Tell(told.Text);
  }
  if (told.Resets) {
    ResetWindow();
  }
  if (end != FirmwareEnd::LineFailed && end != FirmwareEnd::ProgramCloses) {
    line.LeaveOpen();
  }
  if (end == FirmwareEnd::WrongProduct) {
    Advise(OwnText::AdviceWrongProduct, OwnText::AdviceClose);
  } else if (!told.Resets) {
    Advise(AdviceFor(stage_), OwnText::AdviceClose);
  } else {
    Advise(AdviceFor(stage_));
  }
  return told.Text != nullptr ? told.Text : "ended";
}

std::string FirmwareDownload::Fail(const RuntimeError& error, DownloadLine& line) {
  Tell(std::string("Error Occured, ") + error.what());
  parts_.Boxes.Show(std::to_string(error.Number()), DefaultBoxTitle, BoxIcon::None);
  line.Close();
  display_.SetSent(0, 0);
  display_.EnableButtons(false);
  display_.SetStatus("Error");
  display_.SetCurrentBuffer("Buffer Empty");
  display_.SetDownload("Idle");
  Advise(AdviceFor(stage_));
  return std::to_string(error.Number()) + ' ' + error.what();
}

void FirmwareDownload::ResetWindow() {
  display_.SetStatus("Idle");
  display_.SetDownload("Idle");
  display_.EnableButtons(false);
}

void FirmwareDownload::Close() {
  flags_ = {.AbortRequested = true, .Closing = true};
  ClosePort();
}

void FirmwareDownload::ClosePort() {
  if (parts_.MSComm1.PortOpen()) {
    parts_.MSComm1.Close();
  }
}

void FirmwareDownload::Tell(const std::string& text) {
  parts_.Boxes.Show(text, DefaultBoxTitle, BoxIcon::Exclamation);
}

template <typename... Texts>
void FirmwareDownload::Advise(Texts... texts) {
  std::string advice;
  ((advice += (advice.empty() ? "" : " ") + parts_.Strings.Text(texts)), ...);
  display_.SetAdvice(advice);
}
