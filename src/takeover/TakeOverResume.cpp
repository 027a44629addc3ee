#include "takeover/TakeOverResume.h"

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

/// True for a failure that the next start would meet again.
bool StaysForGood(const RuntimeError& error) {
  return error.Number() == Fault::InvalidFileFormat || error.Number() == Fault::FileNotFound;
}

}  // namespace

ResumedTakeOver ResumeTakeOver(Files& disk, const std::string& dataFolder, MessageBoxes& boxes,
                               const StringTable& strings, const Breathe& breathe) {
  if (!disk.FolderExists(dataFolder)) {
    return {};
  }
  const std::string copies = dataFolder + "/backups";
  disk.DeleteUnfinished(dataFolder);
  disk.DeleteUnfinished(copies);
  try {
    if (!FinishTakeOver(disk, dataFolder, breathe)) {
      ForgetTakeOver(disk, dataFolder);
    }
    return {};
  } catch (const RuntimeError& error) {
    if (StaysForGood(error) && !HasBegunToExchange(disk, dataFolder)) {
      WithdrawTakeOver(disk, dataFolder);
      return {true, Filled(strings.Text(OwnText::TakeOverWithdrawn), {error.what()})};
    }
    const BoxAnswer answer =
        boxes.Show(Filled(strings.Text(OwnText::TakeOverBroken), {error.what(), copies}),
                   strings.Text(OwnText::TakeOverTitle), BoxIcon::Exclamation, BoxButtons::OkCancel);
    if (answer != BoxAnswer::Ok) {
      return {false, {}};
    }
  }
  WithdrawTakeOver(disk, dataFolder);
  return {};
}
