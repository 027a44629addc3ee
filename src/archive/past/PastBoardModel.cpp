#include "archive/past/PastBoardModel.h"

#include <QGuiApplication>
#include <QPalette>
#include <utility>

#include "ui/TeamColours.h"

namespace {

QVariant PastAlignmentOf(int column) {
  const auto horizontal = column == static_cast<int>(BoardColumn::Rank)     ? Qt::AlignHCenter
                          : column == static_cast<int>(BoardColumn::Player) ? Qt::AlignLeft
                                                                            : Qt::AlignRight;
  return QVariant(Qt::AlignVCenter | horizontal);
}

}  // namespace

PastBoardModel::PastBoardModel(const StringTable& strings)
    : strings_(strings), none_(strings), texts_(std::make_unique<BoardTexts>(none_.Game, strings)) {}

void PastBoardModel::Show(PastGame game, const NickNames& nickNames) {
  ShowNothing();
  auto shown = std::make_unique<PastGame>(std::move(game));
  ListPastPlayers(*shown, nickNames, board_);
  beginResetModel();
  game_ = std::move(shown);
  texts_ = std::make_unique<BoardTexts>(game_->Game, strings_);
  endResetModel();
}

void PastBoardModel::ShowNothing() {
  beginResetModel();
  texts_ = std::make_unique<BoardTexts>(none_.Game, strings_);
  game_.reset();
  endResetModel();
}

int PastBoardModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() || !game_ ? 0 : board_.RowCount();
}

int PastBoardModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : BoardColumnCount;
}

QVariant PastBoardModel::data(const QModelIndex& index, int role) const {
  const BoardRow& row = board_.RowAt(index.row());
  const auto column = static_cast<BoardColumn>(index.column());
  switch (role) {
    case Qt::DisplayRole:
      return QString::fromStdString(texts_->Cell(row, column));
    case Qt::ToolTipRole:
      return column == BoardColumn::Player ? QString::fromStdString(texts_->Cell(row, column)) : QVariant();
    case Qt::TextAlignmentRole:
      return PastAlignmentOf(index.column());
    case Qt::DecorationRole:
      return column == BoardColumn::Player ? QVariant(TeamBadge(row.Team)) : QVariant();
    case Qt::BackgroundRole:
      return TeamTint(row.Team, QGuiApplication::palette().base().color());
    default:
      return {};
  }
}

QVariant PastBoardModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal) {
    return QAbstractTableModel::headerData(section, orientation, role);
  }
  const auto column = static_cast<BoardColumn>(section);
  switch (role) {
    case Qt::DisplayRole:
      return QString::fromStdString(texts_->Header(BoardList::Players, column));
    case Qt::ToolTipRole:
      return QString::fromStdString(texts_->HeaderTip(BoardList::Players, column));
    case Qt::TextAlignmentRole:
      return PastAlignmentOf(section);
    default:
      return {};
  }
}
