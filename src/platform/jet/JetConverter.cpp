#include "platform/jet/JetConverter.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string_view>
#include <vector>

#include "platform/RuntimeError.h"
#include "platform/jet/ChildProgram.h"
#include "platform/jet/InterimRows.h"
#include "platform/jet/JetStream.h"
#include "platform/jet/KeptFile.h"
#include "platform/jet/TableImport.h"
#include "platform/linux/Descriptor.h"
#include "platform/linux/FileError.h"

namespace {

/// A copy of a file that is deleted at the end unless it has taken the place of another.
class ConvertedFile {
 public:
  ConvertedFile(Files& disk, std::string path, const std::string& source)
      : disk_(disk), path_(std::move(path)) {
    Remove();  // a crash may have left one
    try {
      disk.Write(path_, disk.Read(source));
    } catch (const RuntimeError&) {
      Remove();
      throw;
    }
  }
  ~ConvertedFile() { Remove(); }
  ConvertedFile(const ConvertedFile&) = delete;
  ConvertedFile& operator=(const ConvertedFile&) = delete;

  const std::string& Path() const { return path_; }

  void MakeDurable() const {
    const Descriptor file(open(path_.c_str(), O_RDONLY | O_CLOEXEC));
    if (file.Number() < 0 || fsync(file.Number()) != 0) {
      throw FileError(errno, path_);
    }
  }

 private:
  void Remove() noexcept {
    for (const char* ending : {"", "-journal"}) {
      try {
        if (disk_.FileExists(path_ + ending)) {
          disk_.Delete(path_ + ending);
        }
      } catch (const RuntimeError&) {  // the next conversion writes over it
      }
    }
  }

  Files& disk_;
  std::string path_;
};

std::vector<NotTakenOver> LeftOut(const TableImport& import, const std::vector<NotTakenOver>& otherTables) {
  std::vector<NotTakenOver> left = import.UnreadValues();
  for (const std::string& column : import.MissingColumns()) {
    left.push_back({NotTakenOver::MissingColumn, column});
  }
  for (const std::string& column : import.UnknownColumns()) {
    left.push_back({NotTakenOver::Column, column});
  }
  for (const std::string& column : import.ZeroedColumns()) {
    left.push_back({NotTakenOver::TextsOfColumn, column});
  }
  left.insert(left.end(), otherTables.begin(), otherTables.end());
  return left;
}

void RequireValues(const std::vector<NotTakenOver>& left, ConversionSteps& steps) {
  std::vector<NotTakenOver> values;
  for (const NotTakenOver& what : left) {
    if (what.What == NotTakenOver::OneValue) {
      values.push_back(what);
    }
  }
  if (!values.empty() && !steps.GoOnWithout(values)) {
    throw OldDatabaseRefused(std::move(values));
  }
}

[[noreturn]] void RefuseTable(const std::string& table, std::int64_t read, std::int64_t counted) {
  if (table.empty()) {
    throw OldDatabaseRefused();
  }
  throw OldDatabaseRefused({{NotTakenOver::TableRows, table, read, counted}});
}

/// Nothing if it is damaged or no database of ours; it then stays where it is.
std::unique_ptr<InterimRows> ReadInterim(const std::string& newFile, const OldDatabase& old,
                                         std::chrono::milliseconds lockWait) {
  // A single failed read can look like damage, and its rows are not offered a second time.
  constexpr int tries = 2;
  for (int count = 0; count < tries; ++count) {
    try {
      return std::make_unique<InterimRows>(newFile, old, lockWait);
    } catch (const RuntimeError& error) {
      if (error.Number() != Fault::UnrecognizedDatabase && error.Number() != Fault::DatabaseError) {
        throw;
      }
    }
  }
  return nullptr;
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

OldDatabaseReport JetConverter::Convert(const OldDatabase& old, ConversionSteps& steps) {
  try {
    return MakeAndReplace(old, steps);
  } catch (const OldDatabaseRefused&) {
    throw;
  } catch (const RuntimeError& error) {
    throw OldDatabaseRefused(error.what());
  }
}

OldDatabaseReport JetConverter::MakeAndReplace(const OldDatabase& old, ConversionSteps& steps) {
  constexpr std::uint64_t smallestPage = 2048;
  if (disk_.FileLen(old.Path) % smallestPage != 0) {
    throw OldDatabaseRefused();
  }
  const ConvertedFile newFile(disk_, old.Path + ".new", old.EmptyPath);
  OldDatabaseReport report = ReadInto(newFile.Path(), old, steps);
  RequireValues(report.NotTaken, steps);
  const bool joined = Join(newFile.Path(), old, steps);
  newFile.MakeDurable();
  KeptFile kept(disk_, old.Path);
  report.KeptAs = kept.Path();
  steps.BeforeReplacing(report);
  kept.Keep();
  try {
    disk_.Rename(newFile.Path(), old.Path);
  } catch (const RuntimeError&) {
    // Not if it only could not be made durable: both files are whole, whatever a power failure then leaves.
    if (disk_.FileExists(newFile.Path())) {
      kept.TakeBack();
      throw;
    }
  }
  if (joined) {
    try {
      disk_.Rename(old.InterimPath, UnusedName(disk_, old.InterimPath + ".joined"));
    } catch (const RuntimeError&) {  // its rows are in the new file, and it is not asked for again
    }
  }
  return report;
}

bool JetConverter::Join(const std::string& newFile, const OldDatabase& old, ConversionSteps& steps) const {
  if (!disk_.FileExists(old.InterimPath)) {
    return false;
  }
  const std::unique_ptr<InterimRows> rows = ReadInterim(newFile, old, lockWait_);
  if (!rows || rows->Count() == 0 || !steps.AddInterimRows(rows->Count())) {
    return false;
  }
  rows->Join();
  return true;
}

OldDatabaseReport JetConverter::ReadInto(const std::string& newFile, const OldDatabase& old,
                                         ConversionSteps& steps) const {
  TableImport import(newFile, old.Table, lockWait_);
  std::vector<NotTakenOver> otherTables;
  JetStream stream({.OtherTable =
                        [&](const std::string& other, std::int64_t rows) {
                          otherTables.push_back({NotTakenOver::Table, other, rows});
                        },
                    .Table = [&](const std::vector<std::string>& columns) { import.SetColumns(columns); },
                    .Row = [&](const std::vector<Value>& row,
                               const std::vector<std::size_t>& unread) { import.AddRow(row, unread); },
                    .Unreadable = RefuseTable});
  const auto tell = [&] {
    onProgress_(import.Rows());
    if (!steps.KeepOn()) {
      throw OldDatabaseStopped();
    }
  };
  const ChildEnd end = RunChild(reader_.Path(), {old.Path, old.Table}, silence_,
                                {.OnOutput =
                                     [&](std::string_view bytes) {
                                       stream.Take(bytes);
                                       tell();
                                     },
                                 .OnWait = tell});
  // What the reader wrote to standard error comes from the library, in its own words.
  if (!end.Succeeded || !stream.Ended()) {
    throw OldDatabaseRefused();
  }
  import.Finish();
  return {.Rows = import.Rows(), .NotTaken = LeftOut(import, otherTables), .KeptAs = {}};
}

std::string JetReaderPath() {
  constexpr const char* name = "tessarine-jet-reader";
  const std::filesystem::path folder = std::filesystem::read_symlink("/proc/self/exe").parent_path();
  const std::filesystem::path beside = folder / name;
  return exists(beside) ? beside : (folder / TESSARINE_MODULE_PATH / name).lexically_normal();
}
