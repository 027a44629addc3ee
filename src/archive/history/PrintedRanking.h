#pragma once

#include <string>

#include "platform/Files.h"

/// Where the page of a ranking lies that a browser is given to print.
std::string PrintedRanking(const std::string& userDataFolder);

/// Deletes that page, which may hold names, if there is one. Throws RuntimeError as Files::Delete does.
void DeletePrintedRanking(Files& disk, const std::string& userDataFolder);
