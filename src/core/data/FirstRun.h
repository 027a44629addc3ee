#pragma once

#include <string>

#include "platform/Files.h"
#include "platform/Folders.h"
#include "platform/MessageBoxes.h"

/// Path of the user's data folder inside the application data folder.
inline constexpr const char* UserDataSubfolder = "/Orvalin/Tessarine";

/// Finds or creates the user's data folder and copies missing default files into it, with a box for each
/// except the ini file. Returns the folder, without a trailing separator. Throws RuntimeError if the folder
/// or a copy cannot be created.
std::string PrepareUserDataFolder(const Folders& folders, Files& files, MessageBoxes& boxes);
