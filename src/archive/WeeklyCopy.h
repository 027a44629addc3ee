#pragma once

#include <memory>
#include <string>

#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"

/// The archive's own copies: one a week, of which the last two stay. Each is made in many small steps, for
/// the time in which nobody waits for the program, and is looked through before an older one goes.
class WeeklyCopy {
 public:
  struct Parts {
    Files& Disk;
    const Clock& Time;
    const StringTable& Strings;
    std::string UserDataFolder;
  };

  /// Copies leave this to games and settings, in bytes.
  static constexpr std::uint64_t RoomForOthers = std::uint64_t{32} << 20U;

  explicit WeeklyCopy(Parts parts) : parts_(std::move(parts)) {}
  ~WeeklyCopy() { Stop(); }
  WeeklyCopy(const WeeklyCopy&) = delete;
  WeeklyCopy& operator=(const WeeklyCopy&) = delete;

  /// True if the last copy is a week old, or there is none.
  bool IsDue() const;

  /// Does the next step of the copy of `archive`, which must be the same one until the copy is whole or
  /// stopped. True once it is whole. Throws RuntimeError; the copy is stopped then.
  bool Step(Database& archive);

  /// Gives the copy up; the next step begins it anew. To be called before the archive is closed.
  void Stop() noexcept;

  bool IsRunning() const { return copy_ != nullptr; }

 private:
  void Begin(Database& archive);
  void Finish(const std::string& path);
  void DeletePart();
  /// The one that was just made stays, even if the computer's clock was set back.
  void DeleteOldest(const std::string& made);

  const Parts parts_;
  std::string partPath_;  ///< while it is made
  std::unique_ptr<StepwiseCopy> copy_;
};
