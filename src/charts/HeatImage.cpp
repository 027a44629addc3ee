#include "charts/HeatImage.h"

#include <algorithm>
#include <vector>

#include "charts/HeatScale.h"

namespace {

constexpr QRgb Paper = qRgb(255, 255, 255);
constexpr QRgb PaperOfOwnTeam = qRgb(238, 238, 238);
constexpr QRgb Line = qRgb(205, 205, 205);
constexpr int LeastLinedCell = 6;
constexpr int LeastCornerCell = 12;

/// Pixels of one row of cells.
class CellRow {
 public:
  CellRow(QImage& image, int row, int cell) : image_(image), top_(row * cell), cell_(cell) {}

  void Fill(int column, QRgb colour) {
    for (int y = 0; y < cell_; ++y) {
      std::fill_n(At(column, 0, y), cell_, colour);
    }
  }

  /// The upper right corner, or in a small cell a stroke from there to the lower left one.
  void Mark(int column, QRgb colour) {
    const int side = cell_ >= LeastCornerCell ? cell_ / 3 : cell_;
    const int stroke = std::max(cell_ / 4, 1);
    for (int y = 0; y < side; ++y) {
      const int length = cell_ >= LeastCornerCell ? side - y : std::min(stroke, cell_ - y);
      const int from = cell_ >= LeastCornerCell ? cell_ - length : cell_ - y - length;
      std::fill_n(At(column, from, y), length, colour);
    }
  }

  void Rule(int column) {
    for (int y = 0; y < cell_; ++y) {
      *At(column, cell_ - 1, y) = Line;
    }
    std::fill_n(At(column, 0, cell_ - 1), cell_, Line);
  }

 private:
  QRgb* At(int column, int x, int y) {
    // scanLine would check each time whether the image is shared.
    return reinterpret_cast<QRgb*>(bits_ + static_cast<std::ptrdiff_t>(top_ + y) * stride_) +
           static_cast<std::ptrdiff_t>(column) * cell_ + x;
  }

  QImage& image_;
  const int top_;
  const int cell_;
  uchar* const bits_ = image_.bits();
  const std::ptrdiff_t stride_ = image_.bytesPerLine();
};

}  // namespace

QRgb HeatOf(std::int32_t damage, std::int32_t most) {
  constexpr double least = 0.06;  // so that the smallest hit can be told from none
  const Rgb colour = HeatColour(most > 0 ? least + (1 - least) * damage / most : 0);
  return qRgb(colour.Red, colour.Green, colour.Blue);
}

QColor InkOn(QRgb colour) {
  constexpr double bright = 55;
  const Rgb parts{static_cast<std::uint8_t>(qRed(colour)), static_cast<std::uint8_t>(qGreen(colour)),
                  static_cast<std::uint8_t>(qBlue(colour))};
  return LightnessOf(parts) > bright ? Qt::black : Qt::white;
}

QImage HeatImage(const HitMatrix& matrix, int cell) {
  const int size = matrix.Size();
  QImage image(size * cell, size * cell, QImage::Format_RGB32);
  for (int shooter = 0; shooter < size; ++shooter) {
    CellRow row(image, shooter, cell);
    for (int victim = 0; victim < size; ++victim) {
      const std::int32_t damage = matrix.Damage(shooter, victim);
      const bool isOwnTeam = matrix.IsOwnTeam(shooter, victim);
      if (damage == 0) {
        row.Fill(victim, isOwnTeam ? PaperOfOwnTeam : Paper);
      } else {
        const QRgb heat = HeatOf(damage, matrix.Most());
        row.Fill(victim, heat);
        if (isOwnTeam) {
          row.Mark(victim, InkOn(heat).rgb());
        }
      }
      if (cell >= LeastLinedCell) {
        row.Rule(victim);
      }
    }
  }
  return image;
}
