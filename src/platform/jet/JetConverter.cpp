#include "platform/jet/JetConverter.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string_view>

#include "platform/RuntimeError.h"
#include "platform/jet/ChildProgram.h"
#include "platform/jet/JetStream.h"
#include "platform/jet/TableImport.h"

namespace {

/// A file that is deleted at the end unless it has been renamed.
class NewFile {
 public:
  NewFile(std::string path, const std::string& source) : path_(std::move(path)) {
    std::filesystem::copy_file(source, path_, std::filesystem::copy_options::overwrite_existing);
    std::filesystem::permissions(path_, std::filesystem::perms::owner_write,
                                 std::filesystem::perm_options::add);
  }
  ~NewFile() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
    std::filesystem::remove(path_ + "-journal", ignored);
  }
  NewFile(const NewFile&) = delete;
  NewFile& operator=(const NewFile&) = delete;

  const std::string& Path() const { return path_; }

 private:
  std::string path_;
};

void SyncFolderOf(const std::string& path) {
  const std::string folder = std::filesystem::path(path).parent_path();
  const int descriptor = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (descriptor >= 0) {
    fsync(descriptor);
    close(descriptor);
  }
}

/// Gives the old file a second, unused name, so that it exists under one of the two at every instant.
std::string KeepOld(const std::string& path) {
  for (int number = 1;; ++number) {
    std::string kept = path + ".jet" + (number == 1 ? "" : std::to_string(number));
    std::error_code error;
    if (std::filesystem::exists(kept)) {
      if (std::filesystem::equivalent(kept, path, error)) {
        return kept;  // left by an interrupted conversion
      }
      continue;
    }
    std::filesystem::create_hard_link(path, kept, error);
    if (error) {
      std::filesystem::copy_file(path, kept);
    }
    return kept;
  }
}

}  // namespace

bool JetConverter::IsOld(const std::string& path) const {
  std::array<char, 20> start{};
  std::ifstream file(path, std::ios::binary);
  if (!file.read(start.data(), start.size())) {
    return false;
  }
  const std::string_view mark(start.data() + 4, 15);
  return std::string_view(start.data(), 4) == std::string_view("\0\1\0\0", 4) &&
         (mark == "Standard Jet DB" || mark == "Standard ACE DB");
}

OldDatabaseReport JetConverter::Convert(const std::string& path, const std::string& table,
                                        const std::string& emptyDatabase) {
  try {
    constexpr std::uintmax_t smallestPage = 2048;
    if (std::filesystem::file_size(path) % smallestPage != 0) {
      throw RuntimeError(Fault::UnrecognizedDatabase, "It is cut short.");
    }
    const NewFile newFile(path + ".new", emptyDatabase);
    OldDatabaseReport report = ReadInto(newFile.Path(), path, table);
    report.KeptAs = KeepOld(path);
    SyncFolderOf(path);
    std::filesystem::rename(newFile.Path(), path);
    SyncFolderOf(path);
    return report;
  } catch (const std::filesystem::filesystem_error& error) {
    throw RuntimeError(Fault::UnrecognizedDatabase, error.code().message() + ".");
  } catch (const RuntimeError& error) {
    throw RuntimeError(Fault::UnrecognizedDatabase, error.what());
  }
}

OldDatabaseReport JetConverter::ReadInto(const std::string& newFile, const std::string& path,
                                         const std::string& table) const {
  TableImport import(newFile, table);
  OldDatabaseReport report;
  JetStream stream({[&report](const std::string& other, std::int64_t rows) {
                      report.NotTaken.push_back({NotTakenOver::Table, other, rows});
                    },
                    [&import](const std::vector<std::string>& columns) { import.SetColumns(columns); },
                    [&import](const std::vector<Value>& row) { import.AddRow(row); }});
  const ChildEnd end = RunChild(reader_, {path, table}, silence_, [&](std::string_view bytes) {
    stream.Take(bytes);
    onRows_(import.Rows());
  });
  if (end.TimedOut) {
    throw RuntimeError(Fault::UnrecognizedDatabase, "It is damaged: reading it did not come to an end.");
  }
  if (!end.Succeeded || !stream.Ended()) {
    throw RuntimeError(Fault::UnrecognizedDatabase, "It is damaged. " + end.Error);
  }
  import.Finish();
  report.Rows = import.Rows();
  for (const std::string& column : import.UnknownColumns()) {
    report.NotTaken.push_back({NotTakenOver::Column, column});
  }
  for (const std::string& column : import.ZeroedColumns()) {
    report.NotTaken.push_back({NotTakenOver::TextsOfColumn, column});
  }
  return report;
}

std::string JetReaderPath() {
  return std::filesystem::read_symlink("/proc/self/exe").parent_path() / "tessarine-jet-reader";
}
