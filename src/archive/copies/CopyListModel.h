#pragma once

#include <QAbstractTableModel>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "archive/copies/CopyWork.h"

/// The databases in use, then their copies from the newest. Rows of each are counted one by one, when asked.
class CopyListModel : public QAbstractTableModel {
 public:
  enum Column { Data, Time, Made, Rows, Difference, Size, ColumnCount };

  struct Entry {
    std::size_t Database = 0;        ///< index in the databases
    std::optional<BackupCopy> Copy;  ///< none for the one in use
    std::uint64_t Bytes = 0;
  };

  /// All must outlive the model.
  CopyListModel(const std::vector<CopiedDatabase>& databases, const CopyWork& work, const Files& disk,
                const StringTable& strings)
      : databases_(databases), work_(work), disk_(disk), strings_(strings) {}

  /// Reads the folder of the copies anew. What was counted of copies stays known. Returns why the folder
  /// could not be read, if so; the databases in use are listed nevertheless.
  std::string Refresh(const std::string& folder);

  /// Counts the rows of one that is not counted yet; those in use come first. False if all are.
  bool CountNext();

  const Entry& At(int row) const { return entries_[static_cast<std::size_t>(row)]; }

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  /// Rows, or why they could not be counted.
  struct Count {
    std::optional<int> Rows;
    std::string Reason;
  };

  void AddInUse(std::size_t database);
  std::string KeyOf(const Entry& entry) const;
  const Count* CountOf(const Entry& entry) const;
  Count CountRows(const Entry& entry) const;
  QString TextOf(const Entry& entry, int column) const;
  QString TimeText(const Entry& entry) const;
  QString RowsText(const Entry& entry) const;
  QString DifferenceTo(const Entry& entry) const;

  const std::vector<CopiedDatabase>& databases_;
  const CopyWork& work_;
  const Files& disk_;
  const StringTable& strings_;
  std::vector<Entry> entries_;
  std::map<std::string, Count> counts_;
};
