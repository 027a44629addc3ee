#include "missions/MissionNameEntry.h"

#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_MissionNameEntry.h"

MissionNameEntry::MissionNameEntry(const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::MissionNameEntry>()) {
  ui_->setupUi(this);
  SetCaptions(strings, {{ui_->Label1, 138}, {this, 139}, {ui_->OK, 140}, {ui_->Cancel, 141}});
  ui_->MissionEntry->setText(Text(strings, 139));
  ui_->MissionEntry->selectAll();
}

MissionNameEntry::~MissionNameEntry() = default;

std::string MissionNameEntry::EnteredName() const {
  return result() == QDialog::Accepted ? ui_->MissionEntry->text().toStdString() : std::string();
}
