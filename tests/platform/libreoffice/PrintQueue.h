#pragma once

#include <sys/wait.h>
#include <unistd.h>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/support/TemporaryFolder.h"

/// A private CUPS server for the test. Its one printer, the default, stores each job as a file.
class PrintQueue {
 public:
  enum class Takes { Jobs, Nothing };

  explicit PrintQueue(Takes takes = Takes::Jobs) {
    std::filesystem::permissions(folder_.Path(), std::filesystem::perms(0777));
    for (const char* name : {"spool", "cache", "state", "printed", "programs", "programs/backend"}) {
      std::filesystem::create_directory(folder_ / name);
    }
    std::filesystem::permissions(folder_ / "printed", std::filesystem::perms(0777));
    std::filesystem::create_directory_symlink("/usr/lib/cups/daemon", folder_ / "programs/daemon");
    WriteBackend();
    WriteSettings(takes);
    server_ = fork();
    if (server_ == 0) {
      execl("/usr/sbin/cupsd", "cupsd", "-f", "-c", (folder_ / "cupsd.conf").c_str(), "-s",
            (folder_ / "cups-files.conf").c_str(), nullptr);
      _exit(EXIT_FAILURE);
    }
    isUp_ = WaitUntil([&] { return std::filesystem::exists(Socket()); });
    setenv("CUPS_SERVER", Socket().c_str(), 1);
  }
  ~PrintQueue() {
    unsetenv("CUPS_SERVER");
    kill(server_, SIGTERM);
    waitpid(server_, nullptr, 0);
  }
  PrintQueue(const PrintQueue&) = delete;
  PrintQueue& operator=(const PrintQueue&) = delete;

  bool IsUp() const { return isUp_; }

  /// The contents of the completed jobs' files.
  std::vector<std::string> Printed() const {
    std::vector<std::string> files;
    for (const auto& entry : std::filesystem::directory_iterator(folder_ / "printed")) {
      if (entry.path().extension() == ".job") {
        files.push_back(entry.path());
      }
    }
    return files;
  }

 private:
  std::string Socket() const { return folder_ / "socket"; }

  void WriteBackend() const {
    const std::string backend = folder_ / "programs/backend/keep";
    WriteFile(backend,
              "#!/bin/sh\n"
              "[ $# -gt 0 ] || { echo 'direct keep \"Unknown\" \"Keeps jobs as files\"'; exit 0; }\n"
              "kept=\"${DEVICE_URI#keep:}/$1\"\n"
              "cat \"$6\" > \"$kept.part\" && mv \"$kept.part\" \"$kept.job\"\n");
    std::filesystem::permissions(backend, std::filesystem::perms(0755));
  }

  void WriteSettings(Takes takes) const {
    WriteFile(folder_ / "cupsd.conf",
              "Listen " + Socket() +
                  "\nWebInterface No\nBrowsing No\nDefaultAuthType None\n"
                  "<Location />\nOrder allow,deny\nAllow all\n</Location>\n"
                  "<Policy default>\n<Limit All>\nOrder deny,allow\n</Limit>\n</Policy>\n");
    WriteFile(folder_ / "cups-files.conf",
              "ServerRoot " + folder_.Path() + "\nServerBin " + (folder_ / "programs") + "\nRequestRoot " +
                  (folder_ / "spool") + "\nTempDir " + (folder_ / "spool") + "\nCacheDir " +
                  (folder_ / "cache") + "\nStateDir " + (folder_ / "state") + "\nAccessLog " +
                  (folder_ / "access") + "\nErrorLog " + (folder_ / "errors") + "\nPageLog " +
                  (folder_ / "pages") + "\nUser nobody\nGroup nogroup\n");
    WriteFile(folder_ / "printers.conf",
              "<DefaultPrinter Venue>\nInfo Venue\nDeviceURI keep:" + (folder_ / "printed") +
                  "\nState Idle\nAccepting " + (takes == Takes::Jobs ? "Yes" : "No") +
                  "\nShared No\n</DefaultPrinter>\n");
  }

  TemporaryFolder folder_;
  pid_t server_ = 0;
  bool isUp_ = false;
};
