#include "firmware/pic24f/tool/HexCommands.h"

#include <cstdio>

#include "firmware/hex/HexCheck.h"
#include "firmware/hex/HexImage.h"
#include "platform/RuntimeError.h"

namespace {

/// There is nobody to press a button: the text goes to the standard error.
class PrintedBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string& /*title*/, BoxIcon /*icon*/,
                 BoxButtons /*buttons*/) override {
    Complain(text);
    return BoxAnswer::Ok;
  }
};

/// For boxes that say less than the command itself.
class SilentBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& /*text*/, const std::string& /*title*/, BoxIcon /*icon*/,
                 BoxButtons /*buttons*/) override {
    return BoxAnswer::Ok;
  }
};

std::string MeaningOf(std::int16_t code) {
  switch (code) {
    case HexCode::Empty:
      return "the file is empty";
    case HexCode::WrongChecksum:
      return "a record's checksum is wrong";
    case HexCode::NoRecord:
      return "a line is no record";
    case HexCode::NoEnd:
      return "there is no end record";
    default:
      return "the file or one of its records cannot be read";
  }
}

/// Makes a folder with all that it lies in. Throws as Files::CreateFolder.
void MakeFolder(Files& files, const std::string& path) {
  if (path.empty() || files.FolderExists(path)) {
    return;
  }
  const std::size_t separator = path.find_last_not_of('/');
  const std::string name = path.substr(0, separator + 1);
  const std::size_t parent = name.rfind('/');
  if (parent != std::string::npos) {
    MakeFolder(files, name.substr(0, parent));
  }
  files.CreateFolder(name);
}

ImportedHex ImportIntoFolder(const ToolParts& parts, const ToolOptions& options) {
  try {
    MakeFolder(parts.Disk, options.Out);
  } catch (const RuntimeError& error) {
    Complain(error.what());
    return {HexCode::Failure, {}};
  }
  const std::string folder = options.Out + "/";
  return ImportHex(parts, options.File,
                   {folder + "progmem.img", folder + "eedata.img", folder + "config.img"});
}

}  // namespace

void PrintCode(std::int32_t code) {
  std::printf("code %d\n", code);
  std::fflush(stdout);
}

void PrintWarnings(const std::vector<LostStretch>& warnings, const StringTable& strings) {
  for (const LostStretch& stretch : warnings) {
    std::printf("warning %s %u %s\n", AddressText(stretch).c_str(), stretch.Count,
                LossText(stretch.Reason, strings).c_str());
  }
  std::fflush(stdout);
}

void Complain(const std::string& text) {
  std::fprintf(stderr, "tessarine-pic24f: %s\n", text.c_str());
}

ImportedHex ImportHex(const ToolParts& parts, const std::string& file, const ImagePaths& images) {
  SilentBoxes boxes;
  try {
    const std::int16_t code = ImportHexFile(parts.Disk, boxes, file, images);
    if (code < 0) {
      DeleteImages(parts.Disk, images);
      Complain(file + ": " + MeaningOf(code));
      return {code, {}};
    }
    return {code, CompareImages(parts.Disk, file, images)};
  } catch (const RuntimeError& error) {
    Complain(file + ": " + error.what());
    return {HexCode::Failure, {}};
  }
}

int RunCheck(const ToolParts& parts, const ToolOptions& options) {
  const std::int16_t code = CheckHexFile(parts.Disk, options.File);
  PrintCode(code);
  if (code != HexCode::Good) {
    Complain(options.File + ": " + MeaningOf(code));
    return ToolExit::Failed;
  }
  return ToolExit::Good;
}

int RunImport(const ToolParts& parts, const ToolOptions& options) {
  const ImportedHex imported = ImportIntoFolder(parts, options);
  PrintCode(imported.Code);
  PrintWarnings(imported.Warnings, parts.Strings);
  if (imported.Code != HexCode::Good) {
    return ToolExit::Failed;
  }
  return imported.Warnings.empty() ? ToolExit::Good : ToolExit::Warned;
}

int RunImage(const ToolParts& parts, const ToolOptions& options) {
  PrintedBoxes boxes;
  FirmwareImage image;
  if (!LoadHexImage(parts.Disk.Read(options.File), image, boxes)) {
    return ToolExit::Failed;
  }
  parts.Disk.Replace(options.Out, std::string(image.ImageBuffer.begin(), image.ImageBuffer.end() - 1));
  std::printf("pages %d\nrows %d\n", image.PageCount, image.RowCount);
  return ToolExit::Good;
}
