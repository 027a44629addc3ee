#include "bench/PageServerPeer.h"

#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <thread>

#include "bench/PageLoad.h"

namespace {

std::string ConfigurationIn(const std::string& folder) {
  std::string text = geteuid() == 0 ? "user root;\n" : "";
  text += "daemon off;\nmaster_process off;\nerror_log stderr crit;\npid " + folder + "/pid;\n";
  text +=
      "events { worker_connections 1024; }\nhttp {\n  access_log off;\n  sendfile on;\n  tcp_nopush on;\n";
  text += "  keepalive_requests 100000000;\n  default_type text/html;\n";
  for (const char* kind : {"client_body", "proxy", "fastcgi", "uwsgi", "scgi"}) {
    text.append("  ")
        .append(kind)
        .append("_temp_path ")
        .append(folder)
        .append("/")
        .append(kind)
        .append(";\n");
  }
  text += "  server { listen 127.0.0.1:" + std::to_string(PageServerPeer::Port) + "; root " + folder +
          "/pages; index index.html; }\n}\n";
  return text;
}

}  // namespace

PageServerPeer::PageServerPeer(const std::string& program, const std::string& folder,
                               const std::string& body) {
  std::filesystem::create_directories(folder + "/pages");
  std::ofstream(folder + "/pages/index.html", std::ios::binary) << body;
  std::ofstream(folder + "/conf") << ConfigurationIn(folder);
  process_.emplace(std::vector<std::string>{program, "-p", folder, "-c", folder + "/conf", "-e", "stderr"},
                   StandardStreams{});
}

bool PageServerPeer::Answers() {
  using namespace std::chrono_literals;
  for (int tries = 0; tries < 100; ++tries) {
    try {
      const PageConnection tried(Port);
      return true;
    } catch (const std::runtime_error&) {
      std::this_thread::sleep_for(50ms);
    }
  }
  return false;
}

std::string FindPageServerPeer() {
  if (const char* named = std::getenv("TESSARINE_NGINX"); named != nullptr && *named != '\0') {
    return named;
  }
  for (const char* path : {"/usr/sbin/nginx", "/usr/local/sbin/nginx", "/usr/bin/nginx"}) {
    if (access(path, X_OK) == 0) {
      return path;
    }
  }
  return {};
}
