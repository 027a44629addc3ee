#include "archive/history/PrintedRanking.h"

std::string PrintedRanking(const std::string& userDataFolder) {
  return userDataFolder + "/ranking.html";
}

void DeletePrintedRanking(Files& disk, const std::string& userDataFolder) {
  if (const std::string path = PrintedRanking(userDataFolder); disk.FileExists(path)) {
    disk.Delete(path);
  }
}
