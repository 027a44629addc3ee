#include "firmware/pic24f/frmBootload.h"

#include <QContextMenuEvent>
#include <QMouseEvent>
#include <QStyle>
#include <QToolButton>

#include "core/line/CommPortSetting.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "firmware/hex/HexCheck.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_frmBootload.h"

namespace {

/// Panels of the status bar, from 1.
constexpr int StatusPanel = 1;
constexpr int PortPanel = 4;
constexpr int BitRatePanel = 5;

constexpr std::size_t MostLostBytesShown = 1000;

}  // namespace

frmBootload::frmBootload(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::frmBootload>()),
      parts_(parts),
      menus_(this),
      library_(parts.MakeLibrary([this] { return commands_.CloseRequested(); })),
      comms_({.Library = *library_,
              .Disk = parts.Disk,
              .Events = parts.Events,
              .Folder = parts.Folder,
              .ShowStatus = [this](const std::string& text) { SetStatus(text); }}),
      ini_(parts.Disk, parts.Folder),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  SetUpPanels();
  SetUpToolbar();
  ConnectMenus();
  ui_->LostBytesLabel->setText(Text(parts_.Strings, OwnText::LostBytes));
  ShowLostBytes({});
  commands_.EndWaits = [this] { comms_.RunFlag = 0; };
  commands_.Connect(
      *ui_->cmdBrowse, [this] { Browse(); }, WhileBusy::Ignore);
  commands_.Connect(*ui_->cmdBreak, [this] { comms_.RunFlag = 0; });
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
  LoadSettings();
}

frmBootload::~frmBootload() {
  if (comms_.PortHandle > 0) {
    library_->ClosePIC(comms_.PortHandle);
  }
}

void frmBootload::SetUpPanels() {
  panels_ = {ui_->StatusPanel1, ui_->StatusPanel2, ui_->StatusPanel3, ui_->StatusPanel4, ui_->StatusPanel5};
  ui_->StatusPanel3->setToolTip(Text(parts_.Strings, OwnText::FirmwareVersionPanel));
  ui_->StatusPanel4->setToolTip(Text(parts_.Strings, OwnText::PortPanel));
  ui_->StatusPanel5->setToolTip(Text(parts_.Strings, OwnText::BitRatePanel));
  for (QLabel* panel : panels_) {
    panel->installEventFilter(this);
  }
}

// A tool bar leaves its buttons out of the keyboard's reach, and they were made after the entries below them.
void frmBootload::GiveToolbarToTheKeyboard() {
  std::vector<QWidget*> below;
  for (QWidget* widget = nextInFocusChain(); widget != this; widget = widget->nextInFocusChain()) {
    if (widget->focusPolicy() != Qt::NoFocus) {
      below.push_back(widget);
    }
  }
  QWidget* last = ui_->Toolbar1;
  for (auto* button : ui_->Toolbar1->findChildren<QToolButton*>()) {
    button->setFocusPolicy(Qt::TabFocus);
    last = button;
  }
  for (QWidget* widget : below) {
    setTabOrder(last, widget);
    last = widget;
  }
}

void frmBootload::SetUpToolbar() {
  const auto icon = [this](QStyle::StandardPixmap which) { return style()->standardIcon(which); };
  ui_->Open->setIcon(icon(QStyle::SP_DialogOpenButton));
  ui_->Abort->setIcon(icon(QStyle::SP_BrowserStop));
  // It comes in 16 and 32 pixels, and the smaller one would leave the caption higher than the others.
  ui_->Connect->setIcon(icon(QStyle::SP_ComputerIcon).pixmap(32));
  ui_->Write->setIcon(icon(QStyle::SP_DialogSaveButton));
  ui_->Erase->setIcon(icon(QStyle::SP_TrashIcon));
  ui_->Run->setIcon(icon(QStyle::SP_MediaPlay));
  GiveToolbarToTheKeyboard();
  for (QAction* button : {ui_->Connect, ui_->Run}) {
    // The toolkit toggles a check button however it is pressed; during an operation nothing is to change.
    connect(button, &QAction::triggered, this, [this, button](bool checked) {
      if (commands_.Running()) {
        button->setChecked(!checked);
      }
    });
  }
  commands_.Connect(
      *ui_->Connect, [this] { ConnectOrDisconnect(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->Write, [this] { Write(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->Erase, [this] { Erase(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->Run, [this] { RunDevice(); }, WhileBusy::Ignore);
}

void frmBootload::ConnectMenus() {
  for (std::size_t i = 0; i < menus_.M_FPPort.size(); ++i) {
    commands_.Connect(
        *menus_.M_FPPort[i], [this, i] { SetPort(i); }, WhileBusy::Ignore);
  }
  for (std::size_t i = 0; i < menus_.M_FPBaud.size(); ++i) {
    commands_.Connect(
        *menus_.M_FPBaud[i], [this, i] { SetBitRate(i); }, WhileBusy::Ignore);
  }
}

/// A failure in it leaves the window with what was read so far, and is not told.
void frmBootload::LoadSettings() {
  try {
    SetUiState(0);
    comms_.Settings = ReadBootSettings(ini_);
    if (comms_.Settings.SelectDevWin != 0) {
      Selector().Open();
    }
    comms_.Device = {};
    comms_.PortName = "COM" + Str(std::int32_t{CommPortSetting(parts_.Ini, parts_.Devices).Number()});
    ui_->StatusPanel4->setText(QString::fromStdString(comms_.PortName));
    const auto index = comms_.Settings.BitRateIndex;
    if (index < 1 || index > static_cast<std::int32_t>(menus_.M_FPBaud.size())) {
      throw RuntimeError(Fault::SubscriptOutOfRange);
    }
    SetBitRate(static_cast<std::size_t>(index - 1));
    SetStatus("Not connected...");
  } catch (const RuntimeError&) {
    return;
  }
}

DeviceSelector& frmBootload::Selector() const {
  if (parts_.Selector == nullptr) {
    throw RuntimeError(Fault::ObjectNotSet);
  }
  return *parts_.Selector;
}

void frmBootload::Browse() {
  const auto path = parts_.CommonDialog1.ShowOpen(
      {.Filter = "INHEX32 Files (*.HEX)|*.HEX|All Files (*.*)|*.*", .Title = "Open HEX File"});
  if (!path) {
    return;
  }
  ui_->txtFileName->setText(QString::fromStdString(*path));
  ShowLostBytes({});
  const WaitCursor cursor;
  try {
    const ImagePaths images = comms_.Settings.Images(parts_.Folder);
    const std::int16_t code = ImportHexFile(parts_.Disk, parts_.Boxes, *path, images);
    if (code > 0) {
      ShowLostBytes(CompareImages(parts_.Disk, *path, images));
    }
    SetStatus(code > 0                     ? "HEX file imported..."
              : code == HexCode::NotPadded ? "HEX file not padded properly..."
                                           : "Invalid HEX file...");
  } catch (const RuntimeError&) {
    SetStatus("Invalid HEX file...");
    throw;
  }
}

void frmBootload::ShowLostBytes(const std::vector<LostStretch>& lost) {
  ui_->LostBytesList->clear();
  for (std::size_t i = 0; i < std::min(lost.size(), MostLostBytesShown); ++i) {
    ui_->LostBytesList->addItem(QString::fromStdString(Filled(
        parts_.Strings.Text(OwnText::LostBytesAt),
        {AddressText(lost[i]), std::to_string(lost[i].Count), LossText(lost[i].Reason, parts_.Strings)})));
  }
  if (lost.size() > MostLostBytesShown) {
    ui_->LostBytesList->addItem(QString::fromStdString(
        Filled(parts_.Strings.Text(OwnText::AndMore), {std::to_string(lost.size() - MostLostBytesShown)})));
  }
  ui_->LostBytesLabel->setVisible(!lost.empty());
  ui_->LostBytesList->setVisible(!lost.empty());
}

void frmBootload::SetPort(std::size_t index) {
  for (std::size_t i = 0; i < menus_.M_FPPort.size(); ++i) {
    menus_.M_FPPort[i]->setChecked(i == index);
  }
  comms_.PortName = menus_.M_FPPort[index]->text().toStdString();
  ui_->StatusPanel4->setText(menus_.M_FPPort[index]->text());
  SetUiState(0);
}

void frmBootload::SetBitRate(std::size_t index) {
  comms_.BitRate = menus_.M_FPBaud[index]->text().toInt();
  ui_->StatusPanel5->setText(menus_.M_FPBaud[index]->text());
  SetUiState(0);
}

bool frmBootload::eventFilter(QObject* watched, QEvent* event) {
  const auto* const found = std::find(panels_.begin(), panels_.end(), watched);
  if (found != panels_.end()) {
    const int panel = static_cast<int>(found - panels_.begin()) + 1;
    if (event->type() == QEvent::MouseButtonPress) {
      panel_ = panel;
      return true;
    }
    if (event->type() == QEvent::MouseButtonRelease) {
      const auto* mouse = static_cast<QMouseEvent*>(event);
      if (mouse->button() == Qt::RightButton) {
        PopUp(panel_, mouse->globalPosition().toPoint());
      }
      return true;
    }
    if (event->type() == QEvent::ContextMenu &&
        static_cast<QContextMenuEvent*>(event)->reason() == QContextMenuEvent::Keyboard) {
      PopUp(panel, (*found)->mapToGlobal(QPoint(0, 0)));
      return true;
    }
  }
  return QDialog::eventFilter(watched, event);
}

void frmBootload::PopUp(int panel, const QPoint& place) {
  QMenu* const menu = panel == StatusPanel    ? menus_.M_Program
                      : panel == PortPanel    ? menus_.M_PortSettings
                      : panel == BitRatePanel ? menus_.M_BitRateSettings
                                              : nullptr;
  if (menu != nullptr && menu->isEnabled()) {
    menu->popup(place);
  }
}

void frmBootload::SetUiState(std::uint8_t flags) {
  constexpr std::uint8_t connected = 1;
  constexpr std::uint8_t busy = 2;
  constexpr std::size_t slowRates = 5;  // the faster ones can always be chosen
  const bool isBusy = (flags & busy) != 0;
  const bool isConnected = (flags & connected) != 0;
  ui_->Connect->setEnabled(true);
  ui_->Open->setEnabled(true);
  for (QAction* port : menus_.M_FPPort) {
    port->setEnabled(!isBusy);
  }
  for (std::size_t i = 0; i < slowRates; ++i) {
    menus_.M_FPBaud[i]->setEnabled(!isBusy);
  }
  for (QAction* memory : menus_.M_MemAccess) {
    memory->setEnabled(!isBusy);
  }
  menus_.M_PSendCfg->setVisible(isConnected && !isBusy);
  menus_.space101->setVisible(isConnected);
  if (isConnected) {
    for (QAction* button : {ui_->Abort, ui_->Write, ui_->Erase}) {
      button->setEnabled(true);
    }
    menus_.M_Program->setEnabled(true);
  }
  SetUiStateOfDevice();
}

void frmBootload::SetUiStateOfDevice() {
  const auto show = [this](std::size_t memory, bool shown) {
    menus_.M_MemAccess[memory]->setVisible(shown);
    menus_.M_MemAccess[memory]->setChecked(shown);
  };
  constexpr std::size_t eeData = 1;
  constexpr std::size_t config = 2;
  constexpr std::size_t userId = 3;
  switch (comms_.Device.DeviceType) {
    case 0:
      show(config, false);
      show(userId, false);
      menus_.M_PSendCfg->setVisible(false);
      menus_.space101->setVisible(false);
      break;
    case 1:
      show(eeData, true);
      show(config, true);
      show(userId, false);
      menus_.M_PSendCfg->setVisible(true);
      break;
    case 2:
      show(eeData, false);
      show(config, false);
      show(userId, false);
      menus_.M_PSendCfg->setVisible(false);
      break;
    default:
      break;
  }
}

void frmBootload::SetStatus(const std::string& text) {
  ui_->StatusPanel1->setText(QString::fromStdString(text));
}

void frmBootload::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
