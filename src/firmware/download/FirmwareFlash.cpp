#include "firmware/download/FirmwareFlash.h"

#include <QFontDatabase>
#include <QGuiApplication>

#include "core/line/CommPortSetting.h"
#include "core/text/Filled.h"
#include "firmware/files/FirmwareDescription.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Text.h"
#include "ui/TimeLeft.h"
#include "ui_FirmwareFlash.h"

namespace {

/// A whole line of a QVM file; what is longer fails before it could be seen.
constexpr int LongestLine = 103;

QString LineText(const std::string& text) {
  return QString::fromLatin1(text.data(),
                             std::min<qsizetype>(static_cast<qsizetype>(text.size()), LongestLine));
}

}  // namespace

FirmwareFlash::FirmwareFlash(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::FirmwareFlash>()),
      parts_(parts),
      download_({.MSComm1 = parts.MSComm1,
                 .Events = parts.Events,
                 .Boxes = parts.Boxes,
                 .Strings = parts.Strings,
                 .Awake = parts.Awake,
                 .Record = {.Disk = parts.Disk,
                            .Folder = parts.LogFolder,
                            .Elapsed = parts.Elapsed,
                            .Time = parts.Time}},
                *this),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  SetUpLook();
  commands_.Connect(*this,
                    {{ui_->cmdBrowse, &FirmwareFlash::Browse}, {ui_->cmdDownload, &FirmwareFlash::Download}});
  commands_.Connect(*ui_->cmdBreak, [this] { download_.RequestAbort(); });
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
  connect(ui_->txtFileName, &QLineEdit::editingFinished, this,
          [this] { commands_.Run([this] { DescribeFile(); }); });
  FormLoad();
}

FirmwareFlash::~FirmwareFlash() {
  // A window that is destroyed while it is shown takes the focus from its entry.
  ui_->txtFileName->disconnect(this);
}

void FirmwareFlash::SetUpLook() {
  const QFont fixed = QFontDatabase::systemFont(QFontDatabase::FixedFont);
  for (QWidget* digits : {static_cast<QWidget*>(ui_->lblCurrentBuffer), static_cast<QWidget*>(ui_->Text1)}) {
    digits->setFont(fixed);
  }
  ui_->lblCurrentBuffer->setMinimumWidth(QFontMetrics(fixed).horizontalAdvance(u'0') * LongestLine + 4);
  ui_->lblDownloadBarFG->setBackgroundRole(QPalette::Highlight);
  ui_->Text1->setAccessibleName(Text(parts_.Strings, OwnText::DigitsLeft));
  ui_->lblConnect->setText(Text(parts_.Strings, OwnText::DeviceLamp));
  ui_->lblComplete->setText(Text(parts_.Strings, OwnText::TransferLamp));
}

void FirmwareFlash::FormLoad() {
  FirmwareFlash::SetBar(0);  // this class's own, since it is under construction
  try {
    ReadSettings();
    ui_->cmdDownload->setEnabled(parts_.Disk.FileExists(ui_->txtFileName->text().toStdString()));
  } catch (const RuntimeError& error) {
    if (error.Number() == Fault::FileNotFound || error.Number() == Fault::PastEndOfFile) {
      portNumber_ = 1;
    } else {
      parts_.Boxes.Show(std::to_string(error.Number()) + " = " + error.what(), DefaultBoxTitle,
                        BoxIcon::Exclamation);
    }
  }
  DescribeFile();
}

void FirmwareFlash::ReadSettings() {
  firmwarePath_ = parts_.Ini.ReadIni(Keys::FirmwarePath);
  ui_->txtFileName->setText(QString::fromStdString(firmwarePath_));
  portNumber_ = CommPortSetting(parts_.Ini, parts_.Devices).Number();
}

void FirmwareFlash::Browse() {
  const auto chosen = parts_.Cd1.ShowOpen(
      {.Filter = "QVM Files (*.QVM;*.QVM2)|*.QVM;*.QVM2| All Files (*.*)|*.*", .Title = "Select a file "});
  if (!chosen) {
    return;
  }
  firmwarePath_ = *chosen;
  ui_->txtFileName->setText(QString::fromStdString(firmwarePath_));
  ui_->cmdDownload->setEnabled(true);
  DescribeFile();
}

void FirmwareFlash::Download() {
  DescribeFile();
  download_.Run(ui_->txtFileName->text().toStdString(),
                [this] { return CommPortSetting(parts_.Ini, parts_.Devices).DeviceOf(portNumber_); });
}

void FirmwareFlash::DescribeFile() {
  ui_->lblDescription->setText(QString::fromStdString(
      ::DescribeFile(parts_.Disk, ui_->txtFileName->text().toStdString(), parts_.Strings)));
}

void FirmwareFlash::reject() {
  download_.Close();
  download_.ResetWindow();
  if (commands_.MayClose()) {
    setEnabled(false);  // nothing starts while events run for the last time
    CleanUp();
    QDialog::reject();
  }
}

void FirmwareFlash::CleanUp() {
  parts_.Events.DoEvents();
  parts_.Ini.WriteIni(Keys::FirmwarePath, ui_->txtFileName->text().toStdString());
}

void FirmwareFlash::SetStatus(const std::string& text) {
  ui_->lblStatus->setText(QString::fromStdString(text));
}

void FirmwareFlash::SetDownload(const std::string& text) {
  ui_->lblDownload->setText(QString::fromStdString(text));
}

void FirmwareFlash::SetCurrentBuffer(const std::string& text) {
  ui_->lblCurrentBuffer->setText(LineText(text));
}

void FirmwareFlash::SetDigits(const std::string& text) {
  ui_->Text1->setText(LineText(text));
}

void FirmwareFlash::SetBar(double share) {
  ui_->lblDownloadBarBG->SetShare(share);
}

void FirmwareFlash::SetLamps(bool connected, bool complete) {
  ui_->sptConnect->SetGreen(connected);
  ui_->sptComplete->SetGreen(complete);
}

void FirmwareFlash::SetBreakCaption(const std::string& caption) {
  ui_->cmdBreak->setText(QString::fromStdString(caption));
}

void FirmwareFlash::EnableButtons(bool running) {
  const bool stopHasFocus = ui_->cmdBreak->hasFocus();
  ui_->cmdBreak->setEnabled(running);  // first, so that the focus goes here and not to Close
  ui_->cmdDownload->setEnabled(!running);
  ui_->cmdBrowse->setEnabled(!running);
  if (stopHasFocus && !running) {
    ui_->cmdDownload->setFocus();
  }
}

void FirmwareFlash::SetBusy(bool busy) {
  if (busy) {
    QGuiApplication::setOverrideCursor(Qt::WaitCursor);
  } else {
    QGuiApplication::restoreOverrideCursor();
  }
}

void FirmwareFlash::SetSent(std::uint64_t sent, std::uint64_t all) {
  using std::chrono::microseconds;
  if (all == 0) {
    transferBegun_ = microseconds(-1);
  } else if (transferBegun_ < microseconds(0)) {
    transferBegun_ = parts_.Elapsed.Elapsed();
  }
  const auto spent =
      std::chrono::duration_cast<std::chrono::milliseconds>(parts_.Elapsed.Elapsed() - transferBegun_);
  const auto left =
      all == 0 ? std::nullopt : TimeLeft(spent, static_cast<double>(sent), static_cast<double>(all));
  ui_->lblTimeLeft->setText(
      left ? QString::fromStdString(Filled(
                 parts_.Strings.Text(OwnText::DownloadTimeLeft),
                 {MinutesText(std::chrono::round<std::chrono::seconds>(*left).count(), parts_.Strings)}))
           : QString());
}

void FirmwareFlash::SetAdvice(const std::string& text) {
  ui_->lblAdvice->setText(QString::fromStdString(text));
  if (!text.empty()) {
    Announce(*ui_->lblAdvice);
  }
}
