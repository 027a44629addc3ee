#pragma once

#include <QAbstractTableModel>
#include <QString>

#include "sound/SoundList.h"

/// The rows of a sound list: event, file, and what its sound takes of the chip.
class SoundListModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Column { EventColumn, FileColumn, SecondsColumn, PagesColumn, ColumnCount };

  /// `list` must outlive the model; the two texts are headers of columns.
  SoundListModel(const SoundList& list, const QString& seconds, const QString& pages, QObject* parent);

  /// The list was filled anew.
  void Reset();
  /// Files or pages have changed.
  void Refresh();

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  const SoundList& list_;
  const QString seconds_;
  const QString pages_;
  int shownRows_ = 0;
};
