#include "core/data/UserDatabase.h"

#include "platform/RuntimeError.h"

namespace {

constexpr const char* Title = "Database status";

void TellOfConversion(const UserDatabase& database, const OldDatabaseReport& report, MessageBoxes& boxes) {
  std::string text = "The database of an old installation has been converted: " + database.Path + ", " +
                     std::to_string(report.Rows) + " rows. The old file is kept as " + report.KeptAs + ".";
  if (!report.NotTaken.empty()) {
    text += "\n\nNot taken over:";
    for (const std::string& what : report.NotTaken) {
      text += "\n" + what;
    }
  }
  boxes.Show(text, Title, BoxIcon::Information);
}

std::unique_ptr<Database> Open(const std::string& path, const DatabaseParts& parts) {
  std::unique_ptr<Database> database = parts.Engine.OpenDatabase(path);
  parts.Copies.Guard(*database, path);
  return database;
}

std::string FreshPath(const std::string& path) {
  const std::string extension = ".mdb";
  return path.substr(0, path.size() - extension.size()) + "-new" + extension;
}

}  // namespace

std::unique_ptr<Database> OpenUserDatabase(const UserDatabase& database, const DatabaseParts& parts) {
  std::string reason;
  try {
    if (parts.Old.IsOld(database.Path)) {
      TellOfConversion(database, parts.Old.Convert(database.Path, database.Table, database.DefaultPath),
                       parts.Boxes);
    }
    return Open(database.Path, parts);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::UnrecognizedDatabase) {
      throw;
    }
    reason = error.what();
  }
  const std::string fresh = FreshPath(database.Path);
  const BoxAnswer answer =
      parts.Boxes.Show("The database " + database.Path + " cannot be used. " + reason +
                           "\n\nIt stays as it is. Press OK to go on with a fresh database, " + fresh +
                           ", or Cancel to end the program.",
                       Title, BoxIcon::Exclamation, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Cancel) {
    return nullptr;
  }
  if (!parts.Disk.FileExists(fresh)) {
    parts.Disk.Replace(fresh, parts.Disk.Read(database.DefaultPath));
  }
  return Open(fresh, parts);
}
