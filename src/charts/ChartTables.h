#pragma once

#include <optional>
#include <vector>

#include "charts/ChartRows.h"
#include "charts/HitMapPainter.h"
#include "charts/ScoreParts.h"

/// The hits of a heat map as rows: who hit, who was hit, damage, and whether that was the own team.
class HitRows : public ChartRows {
  Q_OBJECT

 public:
  /// `strings` must outlive this.
  HitRows(const StringTable& strings, QObject* parent) : ChartRows(parent), strings_(strings) {}

  /// `matrix` must stay as it is until the next call.
  void Show(const HitMatrix& matrix);

  HitCell CellOf(int row) const { return cells_.at(static_cast<std::size_t>(row)); }
  /// The row of a cell; none if there was no hit.
  std::optional<int> RowOf(const HitCell& cell) const;

 private:
  int Rows() const override;
  int Columns() const override;
  bool IsText(int column) const override;
  QString Caption(int column) const override;
  QString Cell(int row, int column) const override;

  const StringTable& strings_;
  const HitMatrix* matrix_ = nullptr;
  std::vector<HitCell> cells_;
};

/// The bars of a score chart as rows: player, soldiering, and a column for each part that anyone has.
class ScoreRows : public ChartRows {
  Q_OBJECT

 public:
  /// `strings` must outlive this.
  ScoreRows(const StringTable& strings, QObject* parent) : ChartRows(parent), strings_(strings) {}

  /// `players` must stay as they are until the next call.
  void Show(const std::vector<PlayerParts>& players);

 private:
  int Rows() const override;
  int Columns() const override;
  bool IsText(int column) const override;
  QString Caption(int column) const override;
  QString Cell(int row, int column) const override;

  const StringTable& strings_;
  const std::vector<PlayerParts>* players_ = nullptr;
  std::vector<ScorePart> parts_;
};
