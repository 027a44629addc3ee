#include "archive/import/RefusedFilesModel.h"

#include <utility>

#include "core/text/Filled.h"
#include "core/text/Pieces.h"
#include "ui/Text.h"

void RefusedFilesModel::Show(std::vector<RefusedGameFile> refused, std::vector<KnownGameFile> known,
                             const std::string& folder) {
  beginResetModel();
  refused_ = std::move(refused);
  known_ = std::move(known);
  folder_ = folder + "/";
  endResetModel();
}

void RefusedFilesModel::ListKnown(bool listed) {
  beginResetModel();
  listsKnown_ = listed;
  endResetModel();
}

int RefusedFilesModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(refused_.size() + (listsKnown_ ? known_.size() : 0));
}

int RefusedFilesModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

RefusedFilesModel::Row RefusedFilesModel::RowAt(int row) const {
  const auto place = static_cast<std::size_t>(row);
  return place < refused_.size() ? Row{&refused_[place], nullptr}
                                 : Row{nullptr, &known_[place - refused_.size()]};
}

QVariant RefusedFilesModel::data(const QModelIndex& index, int role) const {
  const Row row = RowAt(index.row());
  if (role == Qt::TextAlignmentRole && index.column() == LineColumn) {
    return int{Qt::AlignRight | Qt::AlignVCenter};
  }
  if (role != Qt::DisplayRole && role != Qt::ToolTipRole) {
    return {};
  }
  const std::string& path = row.Known != nullptr ? row.Known->Path : row.Refused->Path;
  const std::size_t line = row.Known != nullptr ? 0 : row.Refused->Trouble.Line;
  switch (index.column()) {
    case FileColumn:
      return role == Qt::ToolTipRole ? QString::fromStdString(path) : ShownPath(path);
    case LineColumn:
      return line == 0 ? QString() : QString::number(line);
    default:
      return ReasonOf(row);
  }
}

QString RefusedFilesModel::ReasonOf(const Row& row) const {
  if (row.Known == nullptr) {
    return QString::fromStdString(TextOf(row.Refused->Trouble, strings_));
  }
  constexpr std::size_t toTheMinute = 16;
  const std::vector<std::string> texts = PartsOf(strings_.Text(OwnText::ImportGamesKnownAs), '|');
  return QString::fromStdString(Filled(texts.at(static_cast<std::size_t>(row.Known->As)),
                                       {row.Known->Played.substr(0, toTheMinute), row.Known->Mission}));
}

QVariant RefusedFilesModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || role != Qt::DisplayRole) {
    return {};
  }
  return TextList(strings_, OwnText::ImportGamesColumns).at(section);
}

QString RefusedFilesModel::ShownPath(const std::string& path) const {
  return QString::fromStdString(path.starts_with(folder_) ? path.substr(folder_.size()) : path);
}
