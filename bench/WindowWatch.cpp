#include "bench/WindowWatch.h"

#include <poll.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>
#include <stdexcept>

namespace {

/// The default data of the program, with its results page on at this computer alone. Returns the folder for
/// XDG_DATA_HOME.
std::string MakeDataWithPage(const std::string& programFolder, const std::string& folder) {
  const std::filesystem::path from = programFolder;
  const std::filesystem::path data = folder + "/data/Orvalin/Tessarine";
  std::filesystem::create_directories(data);
  std::filesystem::copy_file(from / "scenarios_default.mdb", data / "scenarios.mdb");
  std::filesystem::copy_file(from / "members_default.mdb", data / "members.mdb");
  std::filesystem::copy_file(from / "score_card_default.doc", data / "score_card.doc");
  std::filesystem::copy_file(from / "tessarine.ini", data / "tessarine.ini");
  std::ofstream(data / "tessarine.ini", std::ios::app)
      << "\n[results]\non=1\naddress=127.0.0.1\nport=18700\n";
  return folder + "/data";
}

}  // namespace

WindowWatch::WindowWatch(const std::string& program, const std::string& folder) {
  const std::string data = MakeDataWithPage(std::filesystem::path(program).parent_path().string(), folder);
  setenv("XDG_DATA_HOME", data.c_str(), 1);
  process_ = std::make_unique<ChildProcess>(
      std::vector<std::string>{program},
      StandardStreams{.Input = orders_.ReadEnd.Number(), .Output = answers_.WriteEnd.Number()});
  orders_.ReadEnd.Close();
  answers_.WriteEnd.Close();
  try {
    port_ = static_cast<std::uint16_t>(NextNumber());
  } catch (const std::runtime_error&) {
    port_ = 0;
  }
}

double WindowWatch::LongestDelay(const std::function<void()>& work) {
  Ask();
  work();
  return Ask();
}

double WindowWatch::Ask() {
  if (write(orders_.WriteEnd.Number(), "?", 1) != 1) {
    throw std::runtime_error("the window is gone");
  }
  return NextNumber();
}

double WindowWatch::NextNumber() {
  constexpr int patience = 30'000;  // milliseconds
  std::string line;
  for (char next = 0; next != '\n'; line.push_back(next)) {
    pollfd wait{.fd = answers_.ReadEnd.Number(), .events = POLLIN, .revents = 0};
    if (poll(&wait, 1, patience) != 1 || read(answers_.ReadEnd.Number(), &next, 1) != 1) {
      throw std::runtime_error("the window is gone");
    }
  }
  return std::stod(line);
}
