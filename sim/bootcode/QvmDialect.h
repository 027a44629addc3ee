#pragma once

#include <optional>
#include <string>
#include <vector>

#include "sim/bootcode/BootDialect.h"
#include "sim/bootcode/BufferStore.h"

namespace sim {

/// A device of the first kind: "S" with three bytes sets it up, then each "Z" brings a buffer of up to 51
/// bytes. Nothing in a buffer tells its length to one who does not know its inner structure, so it ends when
/// 51 bytes have come or the line falls quiet. Buffers are taken as they are.
class QvmDialect : public BootDialect {
 public:
  /// Throws like BufferStore.
  explicit QvmDialect(std::optional<std::string> path) : store_(std::move(path)) {}

  std::uint8_t Product() const override { return 'p'; }
  std::uint8_t Begun() const override { return 'b'; }
  void Restart() override;
  Heard Take(std::uint8_t byte) override;
  bool EndsByQuiet() const override { return PacketBytes() > 0; }
  std::size_t PacketBytes() const override { return setUp_ ? piece_.size() : 0; }
  bool MayFinish() const override { return setUp_ && piece_.empty(); }
  BootVerdict CarryOut() override;
  void Drop() override { piece_.clear(); }

 private:
  BootVerdict SetUp();

  BufferStore store_;
  bool setUp_ = false;
  std::vector<std::uint8_t> piece_;  // with the letter that begins it
};

}  // namespace sim
