#include "board/AdminData.h"

#include <QAction>
#include <QHeaderView>
#include <QKeyEvent>

#include "core/text/NumberForms.h"
#include "ui/RowsAsText.h"
#include "ui/Text.h"
#include "ui_AdminData.h"

namespace {

Qt::Alignment AlignmentOf(int column) {
  return Qt::AlignVCenter | (column == 0 ? Qt::AlignLeft : Qt::AlignRight);
}

}  // namespace

AdminData::AdminData(const Game& game, const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::AdminData>()) {
  ui_->setupUi(this);
  ui_->PlayerList->setObjectName(QStringLiteral("AdminData"));  // not possible in the form: it has this name
  setWindowTitle(Text(strings, 136));
  ui_->Command1->setText(Text(strings, 137));
  ui_->Copy->setText(Text(strings, OwnText::Copy));
  ui_->CopyButton->setText(ui_->Copy->text());
  ui_->PlayerList->setHorizontalHeaderLabels({Text(strings, 104), Text(strings, 134), Text(strings, 135)});
  for (int column = 0; column < ui_->PlayerList->columnCount(); ++column) {
    ui_->PlayerList->horizontalHeaderItem(column)->setTextAlignment(AlignmentOf(column));
  }
  ui_->PlayerList->setAccessibleName(windowTitle());
  ui_->PlayerList->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
  ui_->PlayerList->verticalHeader()->hide();
  ui_->PlayerList->addAction(ui_->Copy);
  ui_->PlayerList->installEventFilter(this);
  connect(ui_->Copy, &QAction::triggered, this, &AdminData::Copy);
  connect(ui_->CopyButton, &QPushButton::clicked, ui_->Copy, &QAction::trigger);
  ShowPlayers(game);
}

AdminData::~AdminData() = default;

void AdminData::ShowPlayers(const Game& game) {
  ui_->PlayerList->setRowCount(PlayerCount);
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = game.Players(index);
    const std::string cells[] = {game.DisplayName(index), RunTimeText(player.RunCounter),
                                 std::to_string(player.AdminKillCount)};
    for (int column = 0; column < 3; ++column) {
      auto* item = new QTableWidgetItem(QString::fromStdString(cells[column]));
      item->setTextAlignment(AlignmentOf(column));
      ui_->PlayerList->setItem(index - 1, column, item);
    }
  }
}

// The list itself would copy only the text of one cell.
bool AdminData::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::KeyPress && static_cast<QKeyEvent*>(event)->matches(QKeySequence::Copy)) {
    Copy();
    return true;
  }
  return QDialog::eventFilter(watched, event);
}

void AdminData::Copy() const {
  CopyRows(*ui_->PlayerList);
}
