// tessarine-pic24f: checks Intel HEX files and loads them into devices with a PIC24F boot loader.

#include <QCoreApplication>
#include <cstdio>
#include <optional>
#include <stdexcept>

#include "core/data/FirstRun.h"
#include "core/line/CommPortSetting.h"
#include "firmware/pic24f/PortNames.h"
#include "firmware/pic24f/tool/DeviceSession.h"
#include "firmware/pic24f/tool/HexCommands.h"
#include "firmware/pic24f/tool/ProgressBar.h"
#include "firmware/pic24f/tool/StopSignals.h"
#include "platform/RuntimeError.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtFolders.h"
#include "platform/qt/QtSerialDevices.h"
#include "platform/qt/QtSerialPort.h"

namespace {

BootFolder FolderOfIni() {
  const QtFolders folders;
  std::string data;
  folders.LocalAppData(data);
  return {data + UserDataSubfolder, folders.Program()};
}

/// Prints what a command found out; returns the exit code.
int Tell(const DeviceSession& session, std::int32_t code, const ToolParts& tool, const ToolOptions& options) {
  PrintCode(code);
  PrintWarnings(session.Warnings(), tool.Strings);
  std::fputs(session.Facts().c_str(), stdout);
  session.TellState(code);
  const bool isGood = options.Command == "identify" ? code > 0 : code == PicCode::Done;
  return isGood ? ToolExit::Good : ToolExit::Failed;
}

int RunDeviceCommand(const ToolParts& tool, const ToolOptions& options) {
  const StopSignals stops;
  QtEventPump events;
  QtSerialPort line;
  const QtSerialDevices devices;
  const BootFolder folder = FolderOfIni();
  const IniReader settings(tool.Disk, folder.ForWriting("tessarine.ini"));
  const CommPortSetting portSetting(settings, devices);
  std::optional<ProgressBar> progress(std::in_place);
  const DeviceSession::Parts parts{
      .Tool = tool,
      .Line = line,
      .Events = events,
      .Folder = folder,
      .DeviceOf = [&](const std::string& port) { return DeviceOfPort(port, portSetting); },
      .StopRequests = [&] { return stops.Count(); },
      .ShowProgress = [&](std::size_t done, std::size_t whole) { progress->Show(done, whole); }};
  DeviceSession session(parts, options);
  std::int32_t code = SerialPicBoot::NoPort;
  try {
    code = session.Run();
  } catch (const RuntimeError& error) {
    Complain(error.what());
  }
  progress.reset();
  return Tell(session, code, tool, options);
}

int Run(const ToolOptions& options) {
  LinuxFiles files;
  const StringTable strings(Language::English);
  const ToolParts tool{files, strings};
  if (options.Command == "check") {
    return RunCheck(tool, options);
  }
  if (options.Command == "import") {
    return RunImport(tool, options);
  }
  if (options.Command == "image") {
    return RunImage(tool, options);
  }
  return RunDeviceCommand(tool, options);
}

}  // namespace

int main(int argc, char** argv) {
  const QCoreApplication application(argc, argv);
  try {
    const ToolOptions options = ParseToolOptions(std::vector<std::string>(argv + 1, argv + argc));
    if (options.Help) {
      std::fputs(ToolUsage().c_str(), stdout);
      return ToolExit::Good;
    }
    return Run(options);
  } catch (const std::invalid_argument& error) {
    Complain(std::string(error.what()) + " (--help tells more)");
    return ToolExit::WrongOptions;
  } catch (const std::exception& error) {
    Complain(error.what());
    return ToolExit::Failed;
  }
}
