#pragma once

#include <QAbstractTableModel>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "archive/ArchiveQueries.h"
#include "core/game/PublicName.h"
#include "core/text/StringTable.h"

/// Past games, any number of them. A game's row is read when it comes into view.
class PastGameModel : public QAbstractTableModel {
 public:
  enum Column {
    Time,
    Mission,
    Players,
    FirstTeam,
    LastTeam = FirstTeam + TeamCount - 1,
    Best,
    Pulls,
    Committed,
    ColumnCount
  };

  struct Parts {
    /// The row of a game; none if it has gone. May throw RuntimeError.
    std::function<std::optional<ListedGame>(std::int64_t gameId)> Read;
    NickNames NickNameOf;
    /// The guest name of a player of a game, clean; empty without one. May throw RuntimeError.
    std::function<std::string(std::int64_t gameId, int index)> GuestNameOf;
    /// Called with the reason when a row cannot be read, once until Show is called again.
    std::function<void(const std::string& reason)> Failed;
  };

  /// `strings` must outlive the model.
  PastGameModel(Parts parts, const StringTable& strings);

  /// Shows these games. All rows are read anew.
  void Show(std::vector<std::int64_t> games);

  const std::vector<std::int64_t>& Games() const { return games_; }
  /// The row of a game; -1 if it is not shown.
  int RowOf(std::int64_t gameId) const;
  /// The game of a row, none if it cannot be read. Valid until another one is asked for.
  const ListedGame* GameIn(int row) const;

  /// A game's time as the lists show it.
  static QString TimeText(const std::string& played);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  struct Row {
    ListedGame Game;
    std::string Best;  ///< public name of the best player
  };

  const Row* RowAt(int row) const;
  std::optional<Row> ReadRow(std::int64_t gameId) const;
  std::string BestOf(const ListedGame& game) const;
  QString TextOf(const Row& row, int column) const;

  const Parts parts_;
  const StringTable& strings_;
  std::vector<std::int64_t> games_;
  mutable std::unordered_map<std::int64_t, std::optional<Row>> rows_;
  mutable bool failed_ = false;
};
