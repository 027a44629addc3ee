#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/OldDatabases.h"
#include "takeover/OldInstallation.h"
#include "takeover/OldSettings.h"

/// A database of the program that an old installation may have too.
struct TakenDatabase {
  OldItem What;
  std::string Table;                 ///< the one whose rows are taken
  std::string DefaultPath;           ///< a new one; a taken one has all columns of it
  std::function<Database&()> InUse;  ///< as it is open at the moment
  /// Keeps a copy of what is in use and returns its name; nothing if it was stopped. Throws RuntimeError.
  std::function<std::optional<std::string>(const KeepOn& keepOn)> KeepCopy;
};

/// What an old installation has of one kind, and what is in use of it. Times are local, "YYYY-MM-DD
/// HH:MM:SS", and empty where they are not known.
struct FoundItem {
  enum Condition { Missing, Usable, Unusable };

  OldItem What;
  Condition State = Missing;
  std::int64_t Count = 0;    ///< rows, settings or files
  std::string Changed = {};  ///< of game files, the earliest
  std::string Latest = {};   ///< of game files
  std::int64_t CountNow = 0;
  std::string ChangedNow = {};
  std::int64_t Different = 0;  ///< settings that differ from those in use
  std::string Remark = {};     ///< why it is unusable, or what of it is left out
};

/// What Take does at the moment.
enum class TakeStep { Keeping, Placing };

/// How a take-over ended.
struct TakenOver {
  enum Ending {
    Done,
    Stopped,  ///< nothing was changed
    Refused,  ///< nothing was changed
    Pending   ///< it will be finished at the next start, and the program must end before anything is changed
  };
  Ending What = Done;
  std::vector<std::string> KeptAs = {};  ///< names of the copies of what was there before
  std::string Reason = {};               ///< for the operator, if it failed
};

/// Takes over the data of an old installation: makes and checks everything in a folder of its own first, then
/// exchanges the files. The old installation is only read.
class TakeOverWork {
 public:
  /// All must outlive this object.
  struct Parts {
    DatabaseEngine& Engine;
    OldDatabases& Old;
    Files& Disk;
    const Clock& Time;
    const StringTable& Strings;
    std::string DataFolder;
    std::vector<TakenDatabase> Databases;
    /// Asks the operator a question; true for yes.
    std::function<bool(const std::string& question)> Ask;
    /// True if this computer has a serial port of that number.
    std::function<bool(std::int16_t)> HasPort;
  };

  /// Asked between the steps of a look; false stops it.
  using OnLook = std::function<bool(OldItem)>;
  /// Asked between the steps of a take-over; false stops it before the files are exchanged.
  using OnTake = std::function<bool(TakeStep)>;

  explicit TakeOverWork(Parts parts) : parts_(std::move(parts)) {}
  /// Deletes what was made, unless it is still to be put in place.
  ~TakeOverWork();
  TakeOverWork(const TakeOverWork&) = delete;
  TakeOverWork& operator=(const TakeOverWork&) = delete;

  /// Finds out what the old installation has, converts and checks it. One entry for each kind; none if it was
  /// stopped. Throws RuntimeError if the folder beside the data cannot be written.
  std::vector<FoundItem> Look(const OldInstallation& old, const OnLook& keepOn);

  /// Keeps copies of what is in use, then puts these kinds, if the last Look found them usable, in its place.
  /// Game files are not its business. When it was Done, what is open still belongs to the old files: open it
  /// anew.
  TakenOver Take(const std::set<OldItem>& wanted, const OnTake& keepOn);

 private:
  class Conversion;

  std::string MadePath(const std::string& name) const;
  void Delete(const std::string& path) const;
  bool CopyOldFile(const std::string& path, const std::string& target, const KeepOn& keepOn) const;
  /// False if it was stopped. Throws RuntimeError with the reason for an unusable file.
  bool LookAtDatabase(const TakenDatabase& database, const std::string& path, FoundItem& found,
                      const KeepOn& keepOn) const;
  /// `path` is that of the old file, `copied` that of its copy.
  bool MakeDatabase(const TakenDatabase& database, const std::string& path, const std::string& copied,
                    FoundItem& found, const KeepOn& keepOn) const;
  void DeleteCopied() const;
  void CheckColumns(Database& made, const TakenDatabase& database) const;
  void LookAtTemplate(const std::string& path, FoundItem& found) const;
  void LookAtSettings(const std::string& path, FoundItem& found);
  bool LookAtGames(const std::string& folder, FoundItem& found, const KeepOn& keepOn) const;
  bool LookAt(const OldInstallation& old, FoundItem& found, const KeepOn& keepOn);
  void TellPresent(FoundItem& found) const;

  /// Everything up to the mark. Returns the names to mark; nothing if it was stopped.
  std::optional<std::vector<std::string>> Prepare(const std::set<OldItem>& items, const OnTake& keepOn,
                                                  TakenOver& taken) const;
  /// The file in use is shown to be replaceable, and its copy's name is added.
  void KeepFile(const std::string& name, TakenOver& taken) const;
  void CheckRoomFor(const std::vector<std::string>& names) const;
  void Place(const std::vector<std::string>& names, const OnTake& keepOn, TakenOver& taken) const;
  void DropCopies(TakenOver& taken) const;

  const Parts parts_;
  OldSettings settings_;
  std::set<OldItem> ready_;  ///< made, checked, and not in place
};
