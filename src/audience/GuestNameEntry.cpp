#include "audience/GuestNameEntry.h"

#include <QLabel>
#include <QLineEdit>

#include "core/game/PublicName.h"
#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_GuestNameEntry.h"

GuestNameEntry::GuestNameEntry(const Game& game, const GuestList& guests, const StringTable& strings,
                               QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::GuestNameEntry>()), guests_(guests) {
  ui_->setupUi(this);
  SetCaptions(strings,
              {{this, static_cast<int>(OwnText::GuestNamesTitle)}, {ui_->SaveExit, 162}, {ui_->Cancel, 141}});
  for (int index = 1; index <= PlayerCount; ++index) {
    if (game.Players(index).Active && game.Players(index).MemberIndex == 0) {
      AddEntry(index, GunName(game, index));
    }
  }
  ui_->Explanation->setText(Text(strings, entries_.empty() ? OwnText::NoGuests : OwnText::GuestNamesAre));
  ui_->Guns->setVisible(!entries_.empty());
  ui_->SaveExit->setEnabled(!entries_.empty());
  // The buttons were made before the entries. Only what takes the Tab key can have something behind it.
  ui_->Guns->setFocusPolicy(Qt::TabFocus);
  QWidget* last = ui_->Guns;
  for (const auto& [index, entry] : entries_) {
    setTabOrder(last, entry);
    last = entry;
  }
  ui_->Guns->setFocusPolicy(Qt::NoFocus);
  if (!entries_.empty()) {
    entries_.begin()->second->setFocus();
  }
}

GuestNameEntry::~GuestNameEntry() = default;

void GuestNameEntry::AddEntry(int index, const std::string& gun) {
  auto* entry = new QLineEdit(ui_->Entries);
  entry->setObjectName(QStringLiteral("Guest%1").arg(index));
  entry->setMaxLength(static_cast<int>(LongestPublicName));
  entry->setText(QString::fromStdString(guests_.NameOf(index)));
  auto* label = new QLabel(QString::fromStdString(gun), ui_->Entries);
  label->setBuddy(entry);
  ui_->entriesLayout->addRow(label, entry);
  entries_[index] = entry;
}

GuestList::Names GuestNameEntry::Names() const {
  GuestList::Names names = guests_.All();
  for (const auto& [index, entry] : entries_) {
    names.erase(index);
    if (const std::string name = CleanName(entry->text().toStdString()); !name.empty()) {
      names[index] = name;
    }
  }
  return names;
}
