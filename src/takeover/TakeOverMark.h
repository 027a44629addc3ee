#pragma once

#include <functional>
#include <string>
#include <vector>

#include "platform/Files.h"

/// The folder, inside the data folder, where everything is made that takes the place of files there.
std::string TakeOverFolder(const std::string& dataFolder);

/// Called often in the middle of what takes long and must not be stopped; may process events. Empty for
/// nothing.
using Breathe = std::function<void()>;

/// Declares files in that folder complete, by name: from now on each takes the place of the file of its name
/// in the data folder, at once or at the program's next start. Durable on return. Throws RuntimeError as
/// Files::Replace does; HasTakeOverMark then tells whether the mark stands.
void MarkTakeOver(Files& disk, const std::string& dataFolder, const std::vector<std::string>& names,
                  const Breathe& breathe = {});

bool HasTakeOverMark(const Files& disk, const std::string& dataFolder);

/// Finishes what was marked, file by file; to be called before any file of the data folder is opened or made.
/// Returns false if there was nothing to finish. A failure leaves the mark, and the next call begins anew.
/// Throws RuntimeError 321 if a marked file is not as it was, with nothing changed by this call; otherwise as
/// the operations on files do.
bool FinishTakeOver(Files& disk, const std::string& dataFolder, const Breathe& breathe = {});

/// False if it is certain that no marked file is in its place yet, so that all data is as it was before.
bool HasBegunToExchange(const Files& disk, const std::string& dataFolder);

/// Takes the mark back, also where the disk has no room left. Throws RuntimeError if the mark may still
/// stand.
void WithdrawTakeOver(Files& disk, const std::string& dataFolder);

/// Deletes what was made without ever being marked. What cannot be deleted stays.
void ForgetTakeOver(Files& disk, const std::string& dataFolder);
