#include "takeover/TakeOverMark.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <sstream>
#include <string_view>

#include "platform/RuntimeError.h"

namespace {

constexpr const char* MarkName = "/.takeover-ready";
constexpr std::string_view FirstLine = "Files to take over";
constexpr std::string_view LastLine = "end";
constexpr std::size_t PieceBytes = std::size_t{1} << 20U;

/// No mark gives anything else away.
constexpr std::array<std::string_view, 6> TakenNames = {"members.mdb",     "scenarios.mdb",
                                                        "members-new.mdb", "scenarios-new.mdb",
                                                        "score_card.doc",  "tessarine.ini"};

/// A file as it was when it was marked.
struct MarkedFile {
  std::string Name;
  std::uint64_t Bytes = 0;
  std::uint64_t Digest = 0;

  bool operator==(const MarkedFile&) const = default;
};

void ReadInPieces(const Files& disk, const std::string& path, const Breathe& breathe,
                  const std::function<void(std::string_view)>& take) {
  std::uint64_t offset = 0;
  for (std::string piece; !(piece = disk.ReadPart(path, offset, PieceBytes)).empty();
       offset += piece.size()) {
    take(piece);
    if (breathe) {
      breathe();
    }
  }
}

MarkedFile MarkedAs(const Files& disk, const std::string& folder, const std::string& name,
                    const Breathe& breathe) {
  constexpr std::uint64_t start = 14695981039346656037U;  // FNV-1a
  constexpr std::uint64_t prime = 1099511628211U;
  MarkedFile file{name, 0, start};
  ReadInPieces(disk, folder + "/" + name, breathe, [&file](std::string_view piece) {
    file.Bytes += piece.size();
    for (const char byte : piece) {
      file.Digest = (file.Digest ^ static_cast<unsigned char>(byte)) * prime;
    }
  });
  return file;
}

[[noreturn]] void RefuseMark(const std::string& path) {
  throw RuntimeError(Fault::InvalidFileFormat, "Invalid file format: " + path);
}

std::vector<MarkedFile> ReadMark(const Files& disk, const std::string& path) {
  std::istringstream lines(disk.Read(path));
  std::vector<MarkedFile> files;
  std::string line;
  std::getline(lines, line);
  if (line != FirstLine) {
    RefuseMark(path);
  }
  while (std::getline(lines, line) && line != LastLine) {
    MarkedFile file;
    std::istringstream parts(line);
    if (!(parts >> file.Name >> file.Bytes >> file.Digest) ||
        std::find(TakenNames.begin(), TakenNames.end(), file.Name) == TakenNames.end()) {
      RefuseMark(path);
    }
    files.push_back(file);
  }
  if (line != LastLine) {
    RefuseMark(path);
  }
  return files;
}

std::string MarkOf(const std::vector<MarkedFile>& files) {
  std::ostringstream mark;
  mark << FirstLine << '\n';
  for (const MarkedFile& file : files) {
    mark << file.Name << ' ' << file.Bytes << ' ' << file.Digest << '\n';
  }
  mark << LastLine << '\n';
  return mark.str();
}

void DeleteIfThere(Files& disk, const std::string& path) {
  if (disk.FileExists(path)) {
    disk.Delete(path);
  }
}

/// Puts a copy of the file in its place, so that doing it again does no harm.
void TakeItsPlace(Files& disk, const std::string& path, const std::string& target, const Breathe& breathe) {
  const std::unique_ptr<NewFile> file = disk.BeginReplace(target, FileReaders::AsBefore);
  ReadInPieces(disk, path, breathe, [&file](std::string_view piece) { file->Write(piece); });
  if (target.ends_with(".mdb")) {
    // A journal of the old file must not be played back into the new one.
    for (const char* ending : {"-journal", "-wal", "-shm"}) {
      DeleteIfThere(disk, target + ending);
    }
  }
  file->Finish();
}

}  // namespace

std::string TakeOverFolder(const std::string& dataFolder) {
  return dataFolder + "/.takeover";
}

void MarkTakeOver(Files& disk, const std::string& dataFolder, const std::vector<std::string>& names,
                  const Breathe& breathe) {
  const std::string folder = TakeOverFolder(dataFolder);
  std::vector<MarkedFile> files;
  files.reserve(names.size());
  for (const std::string& name : names) {
    files.push_back(MarkedAs(disk, folder, name, breathe));
  }
  // Written beside the files and then moved, so that both folders are durable before the mark counts.
  disk.Replace(folder + MarkName, MarkOf(files));
  disk.Rename(folder + MarkName, dataFolder + MarkName);
}

bool HasTakeOverMark(const Files& disk, const std::string& dataFolder) {
  return disk.FileExists(dataFolder + MarkName);
}

bool FinishTakeOver(Files& disk, const std::string& dataFolder, const Breathe& breathe) {
  if (!HasTakeOverMark(disk, dataFolder)) {
    return false;
  }
  const std::string folder = TakeOverFolder(dataFolder);
  const std::vector<MarkedFile> files = ReadMark(disk, dataFolder + MarkName);
  for (const MarkedFile& file : files) {
    if (MarkedAs(disk, folder, file.Name, breathe) != file) {
      RefuseMark(folder + "/" + file.Name);
    }
  }
  for (const MarkedFile& file : files) {
    TakeItsPlace(disk, folder + "/" + file.Name, dataFolder + "/" + file.Name, breathe);
  }
  WithdrawTakeOver(disk, dataFolder);
  return true;
}

bool HasBegunToExchange(const Files& disk, const std::string& dataFolder) {
  try {
    const std::vector<MarkedFile> files = ReadMark(disk, dataFolder + MarkName);
    return std::any_of(files.begin(), files.end(), [&](const MarkedFile& file) {
      return disk.FileExists(dataFolder + "/" + file.Name) &&
             disk.FileLen(dataFolder + "/" + file.Name) == file.Bytes &&
             MarkedAs(disk, dataFolder, file.Name, {}) == file;
    });
  } catch (const RuntimeError&) {
    return true;
  }
}

void WithdrawTakeOver(Files& disk, const std::string& dataFolder) {
  // A deletion is not durable, and a mark that came back would miss its files.
  try {
    disk.Replace(dataFolder + MarkName, MarkOf({}));
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::DiskFull) {
      throw;
    }
    ForgetTakeOver(disk, dataFolder);  // one that came back would find nothing to exchange
  }
  disk.Delete(dataFolder + MarkName);
  ForgetTakeOver(disk, dataFolder);
}

void ForgetTakeOver(Files& disk, const std::string& dataFolder) {
  const std::string folder = TakeOverFolder(dataFolder);
  for (const std::string& name : disk.FileNames(folder)) {
    try {
      disk.Delete(std::string(folder).append("/").append(name));
    } catch (const RuntimeError&) {  // the next one that is made takes its place
    }
  }
}
