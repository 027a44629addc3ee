#include "settings/Settings.h"

#include "core/line/EnumPorts.h"
#include "core/text/NumberForms.h"
#include "ui/Captions.h"
#include "ui_Settings.h"

namespace {
constexpr std::int16_t HighestListedPort = 100;
}

Settings::Settings(IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
                   const StringTable& strings, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::Settings>()),
      ini_(ini),
      commands_(*this, boxes),
      checks_(commands_, boxes) {
  ui_->setupUi(this);
  SetCaptions(strings, {{this, 160}, {ui_->Frame1, 161}, {ui_->SaveExit, 162}, {ui_->Cancel, 141}});
  ui_->CommPortNumber->setText(QString::fromStdString(ini_.ReadIni(Keys::CommPort)));
  ui_->CommPortNumber->selectAll();
  ListAvailablePorts(devices);
  checks_.Add(*ui_->CommPortNumber, [this] { return FaultOfPortNumber(); });
  checks_.LeaveFreelyFor(*ui_->SaveExit);
  checks_.LeaveFreelyFor(*ui_->Cancel);
  commands_.Connect(*this, {{ui_->SaveExit, &Settings::SaveAndExit}});
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

std::optional<EntryFault> Settings::FaultOfPortNumber() const {
  const std::string text = ui_->CommPortNumber->text().toStdString();
  if (!IsNumeric(text)) {
    return EntryFault{"Please enter a valid number"};
  }
  if (ToInt16(text) < 1) {
    return EntryFault{"Please enter a valid number (greater than 0)"};
  }
  return std::nullopt;
}

void Settings::SaveAndExit() {
  if (checks_.Holds(*ui_->CommPortNumber)) {
    ini_.WriteIni(Keys::CommPort, Str(std::int32_t{ToInt16(ui_->CommPortNumber->text().toStdString())}));
    accept();
  }
}
