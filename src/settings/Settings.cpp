#include "settings/Settings.h"

#include <QFocusEvent>
#include <QTimer>

#include "core/line/EnumPorts.h"
#include "core/text/NumberForms.h"
#include "platform/ErrorReport.h"
#include "ui/Text.h"
#include "ui_Settings.h"

namespace {
constexpr std::int16_t HighestListedPort = 100;
}

Settings::Settings(IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
                   const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::Settings>()), ini_(ini), boxes_(boxes) {
  ui_->setupUi(this);
  setWindowTitle(Text(strings, 160));
  ui_->Frame1->setTitle(Text(strings, 161));
  ui_->SaveExit->setText(Text(strings, 162));
  ui_->Cancel->setText(Text(strings, 141));
  ui_->CommPortNumber->setText(QString::fromStdString(ini_.ReadIni(Keys::CommPort)));
  ui_->CommPortNumber->selectAll();
  ui_->CommPortNumber->installEventFilter(this);
  ListAvailablePorts(devices);
  connect(ui_->SaveExit, &QPushButton::clicked, this,
          [this] { ReportErrors(boxes_, [this] { SaveAndExit(); }); });
}

Settings::~Settings() = default;

void Settings::ListAvailablePorts(const SerialDevices& devices) {
  ui_->AvailablePorts->addItem(QStringLiteral("Available Comm Ports List"));
  ui_->AvailablePorts->addItem(QStringLiteral("(for display only, enter value above)"));
  const EnumPorts ports(ini_, devices);
  for (std::int16_t number = 1; number <= HighestListedPort; ++number) {
    if (ports.PortExists(number)) {
      auto* item = new QListWidgetItem(QStringLiteral("Comm %1").arg(number), ui_->AvailablePorts);
      item->setToolTip(QString::fromStdString(ports.DeviceOf(number)));
    }
  }
}

bool Settings::eventFilter(QObject* watched, QEvent* event) {
  if (watched == ui_->CommPortNumber && event->type() == QEvent::FocusOut) {
    const auto reason = static_cast<QFocusEvent*>(event)->reason();
    const bool staysInWindow = reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason;
    // Save checks by itself, Cancel never does; a box opened in the middle of a focus change would upset
    // both.
    const bool leavesForButton = ui_->SaveExit->hasFocus() || ui_->Cancel->hasFocus();
    if (isVisible() && staysInWindow && !leavesForButton) {
      QTimer::singleShot(0, this, [this] { ReportErrors(boxes_, [this] { ValidateCommPortNumber(); }); });
    }
  }
  return QDialog::eventFilter(watched, event);
}

bool Settings::ValidateCommPortNumber() {
  const std::string text = ui_->CommPortNumber->text().toStdString();
  const char* message = nullptr;
  if (!IsNumeric(text)) {
    message = "Please enter a valid number";
  } else if (ToInt16(text) < 1) {
    message = "Please enter a valid number (greater than 0)";
  }
  if (message == nullptr) {
    return true;
  }
  boxes_.Show(message, DefaultBoxTitle, BoxIcon::Critical);
  ui_->CommPortNumber->setFocus();
  ui_->CommPortNumber->selectAll();
  return false;
}

void Settings::SaveAndExit() {
  if (ValidateCommPortNumber()) {
    ini_.WriteIni(Keys::CommPort, Str(std::int32_t{ToInt16(ui_->CommPortNumber->text().toStdString())}));
    accept();
  }
}
