#pragma once

#include <string>

#include "platform/Files.h"
#include "platform/Folders.h"
#include "platform/MessageBoxes.h"

/// Path of the user's data folder inside the application data folder.
inline constexpr const char* UserDataSubfolder = "/Orvalin/Tessarine";

/// Finds the user's data folder, makes it when absent, and puts the default copies there that are missing,
/// telling the operator of each but the ini file. Returns the folder, without a separator at its end. Throws
/// RuntimeError when the folder or a copy cannot be made.
std::string PrepareUserDataFolder(const Folders& folders, Files& files, MessageBoxes& boxes);
