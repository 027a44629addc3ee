#pragma once

#include <QAbstractTableModel>
#include <string>
#include <vector>

#include "archive/import/GameImport.h"
#include "core/text/StringTable.h"

/// The files that an import refused, with line and reason. Texts are made when they come into view.
class RefusedFilesModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Columns { FileColumn, LineColumn, ReasonColumn, ColumnCount };

  /// `strings` must outlive the model.
  explicit RefusedFilesModel(const StringTable& strings) : strings_(strings) {}

  /// Lists these. Their paths are shown from `folder` on.
  void Show(std::vector<RefusedGameFile> files, const std::string& folder);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  QString ShownPath(const std::string& path) const;

  const StringTable& strings_;
  std::vector<RefusedGameFile> files_;
  std::string folder_;
};
