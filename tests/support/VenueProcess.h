#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

#include "sim/line/FileDescriptor.h"

namespace sim {

/// The program tessarine-venue as a child process; it is killed if the object ends before it does.
class VenueProcess {
 public:
  explicit VenueProcess(const std::vector<std::string>& arguments);
  ~VenueProcess();
  VenueProcess(const VenueProcess&) = delete;
  VenueProcess& operator=(const VenueProcess&) = delete;

  /// The device of the line "TITLE: DEVICE"; fails the running test if another line or none comes.
  std::string ReadDevice(const std::string& title = "base unit");
  /// The next line of the output, without its end.
  std::string ReadLine();
  void WriteInput(const std::string& text);
  void Signal(int signal);
  void CloseInput() { input_.Close(); }
  bool IsRunning();
  /// The exit status, or -1 if the program did not exit by itself within the limit.
  int WaitForExit();
  /// The rest of both outputs, after the exit.
  std::string RestOfOutput();
  std::string RestOfErrors();

 private:
  pid_t process_ = -1;
  FileDescriptor handle_;
  FileDescriptor input_;
  FileDescriptor output_;
  FileDescriptor errors_;
};

}  // namespace sim
