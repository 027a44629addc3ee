#include "core/data/UserDatabase.h"

#include "core/data/OldConversion.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

std::unique_ptr<Database> Open(const std::string& path, const DatabaseParts& parts) {
  std::unique_ptr<Database> database = parts.Engine.OpenDatabase(path);
  parts.Copies.Guard(*database, path);
  return database;
}

}  // namespace

std::string FreshPath(const UserDatabase& database) {
  const std::string extension = ".mdb";
  return database.Path.substr(0, database.Path.size() - extension.size()) + "-new" + extension;
}

std::unique_ptr<Database> OpenUserDatabase(const UserDatabase& database, const DatabaseParts& parts) {
  std::string reason;
  try {
    if (parts.Old.IsOld(database.Path)) {
      ConvertOldDatabase(database, parts);
    }
    return Open(database.Path, parts);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::UnrecognizedDatabase) {
      throw;
    }
    reason = error.what();
  }
  const std::string fresh = FreshPath(database);
  const BoxAnswer answer =
      parts.Boxes.Show(Filled(parts.Strings.Text(OwnText::DatabaseUnusable), {database.Path, reason, fresh}),
                       DatabaseBoxTitle, BoxIcon::Exclamation, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Cancel) {
    return nullptr;
  }
  if (!parts.Disk.FileExists(fresh)) {
    parts.Disk.Replace(fresh, parts.Disk.Read(database.DefaultPath));
  }
  return Open(fresh, parts);
}
