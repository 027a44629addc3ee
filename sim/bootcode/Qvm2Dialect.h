#pragma once

#include <optional>
#include <string>
#include <vector>

#include "sim/bootcode/BootDialect.h"
#include "sim/bootcode/ImageFlash.h"

namespace sim {

/// A device of the second kind: packets of 6 bytes, which erase a page, and of 198, which write a row, each
/// with its address and a byte that makes the sum of all 0.
class Qvm2Dialect : public BootDialect {
 public:
  /// Throws like ImageFlash.
  explicit Qvm2Dialect(const std::optional<std::string>& path) : flash_(path) {}

  std::uint8_t Product() const override { return 'd'; }
  std::uint8_t Begun() const override { return 's'; }
  void Restart() override { packet_.clear(); }
  Heard Take(std::uint8_t byte) override;
  bool EndsByQuiet() const override { return false; }
  std::size_t PacketBytes() const override { return packet_.size(); }
  bool MayFinish() const override { return packet_.empty(); }
  BootVerdict CarryOut() override;
  void Drop() override { packet_.clear(); }

 private:
  BootVerdict Judge();
  BootVerdict Erase(std::size_t address);
  BootVerdict Write(std::size_t address);

  ImageFlash flash_;
  std::vector<std::uint8_t> packet_;
};

}  // namespace sim
