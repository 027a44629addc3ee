#include "missions/MissionNameEntry.h"

#include "ui_MissionNameEntry.h"

MissionNameEntry::MissionNameEntry(const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::MissionNameEntry>()) {
  ui_->setupUi(this);
  const auto text = [&strings](int number) { return QString::fromStdString(strings.Text(number)); };
  ui_->Label1->setText(text(138));
  setWindowTitle(text(139));
  ui_->OK->setText(text(140));
  ui_->Cancel->setText(text(141));
  ui_->MissionEntry->setText(text(139));
  ui_->MissionEntry->selectAll();
}

MissionNameEntry::~MissionNameEntry() = default;

std::string MissionNameEntry::EnteredName() const {
  return result() == QDialog::Accepted ? ui_->MissionEntry->text().toStdString() : std::string();
}
