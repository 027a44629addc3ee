#pragma once

#include <memory>
#include <string>

#include "platform/Database.h"

class SqliteConnection;
struct sqlite3;

/// See Database::CopyInSteps. Without `keepOn` it is one step, which no other program's change interrupts.
/// The copy keeps no log of its own beside it, whatever the file does.
bool CopyWhole(SqliteConnection& connection, const std::string& path, const KeepOn& keepOn);

/// Flushes what SQLite has handed to the system of that database's file: all but what is in its own memory.
/// False if the disk fails.
bool FlushFile(sqlite3* database);

/// See Database::BeginCopy.
std::unique_ptr<StepwiseCopy> BeginWholeCopy(SqliteConnection& connection, const std::string& path);

/// See Database::RewriteTo.
bool RewriteWhole(SqliteConnection& connection, const std::string& path, const KeepOn& keepOn);

/// See Database::CheckWhole.
bool CheckWhole(SqliteConnection& connection, const KeepOn& keepOn);
