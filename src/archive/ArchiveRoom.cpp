#include "archive/ArchiveRoom.h"

#include "platform/RuntimeError.h"

void CheckSpaceForGames(const Files& disk, const std::string& userDataFolder, const StringTable& strings) {
  if (disk.FreeSpace(userDataFolder) < LeastFreeSpace) {
    throw RuntimeError(Fault::DiskFull, strings.Text(OwnText::KeeperDiskFull));
  }
}
