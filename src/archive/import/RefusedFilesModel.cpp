#include "archive/import/RefusedFilesModel.h"

#include <utility>

#include "ui/Text.h"

void RefusedFilesModel::Show(std::vector<RefusedGameFile> files, const std::string& folder) {
  beginResetModel();
  files_ = std::move(files);
  folder_ = folder + "/";
  endResetModel();
}

int RefusedFilesModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(files_.size());
}

int RefusedFilesModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant RefusedFilesModel::data(const QModelIndex& index, int role) const {
  const RefusedGameFile& file = files_[static_cast<std::size_t>(index.row())];
  if (role == Qt::TextAlignmentRole && index.column() == LineColumn) {
    return int{Qt::AlignRight | Qt::AlignVCenter};
  }
  if (role != Qt::DisplayRole && role != Qt::ToolTipRole) {
    return {};
  }
  switch (index.column()) {
    case FileColumn:
      return role == Qt::ToolTipRole ? QString::fromStdString(file.Path) : ShownPath(file.Path);
    case LineColumn:
      return file.Trouble.Line == 0 ? QString() : QString::number(file.Trouble.Line);
    default:
      return QString::fromStdString(TextOf(file.Trouble, strings_));
  }
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
