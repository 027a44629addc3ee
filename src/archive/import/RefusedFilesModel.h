#pragma once

#include <QAbstractTableModel>
#include <string>
#include <vector>

#include "archive/import/GameImport.h"
#include "core/text/StringTable.h"

/// The files that an import refused, with line and reason; behind them, where they are wanted, those whose
/// games were there already. Texts are made when they come into view.
class RefusedFilesModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Columns { FileColumn, LineColumn, ReasonColumn, ColumnCount };

  /// `strings` must outlive the model.
  explicit RefusedFilesModel(const StringTable& strings) : strings_(strings) {}

  /// Lists these. Their paths are shown from `folder` on.
  void Show(std::vector<RefusedGameFile> refused, std::vector<KnownGameFile> known,
            const std::string& folder);

  void ListKnown(bool listed);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  /// What a row is about. One of both is null.
  struct Row {
    const RefusedGameFile* Refused;
    const KnownGameFile* Known;
  };

  Row RowAt(int row) const;
  QString ShownPath(const std::string& path) const;
  QString ReasonOf(const Row& row) const;

  const StringTable& strings_;
  std::vector<RefusedGameFile> refused_;
  std::vector<KnownGameFile> known_;
  bool listsKnown_ = false;
  std::string folder_;
};
