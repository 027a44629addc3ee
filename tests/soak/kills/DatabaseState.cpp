#include "tests/soak/kills/DatabaseState.h"

#include <sqlite3.h>

#include <array>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <map>
#include <memory>
#include <stdexcept>

namespace {

/// Ten are kept. Each of several processes in a row can be killed between the making of its copy and the
/// deletion of the oldest; the first one that lives on deletes what is too much.
constexpr int MostDeathsInARow = 5;
constexpr int MostCopies = 10 + MostDeathsInARow;

using Connection = std::unique_ptr<sqlite3, decltype(&sqlite3_close)>;

Connection Open(const std::filesystem::path& database) {
  sqlite3* handle = nullptr;
  const int result = sqlite3_open_v2(database.c_str(), &handle, SQLITE_OPEN_READWRITE, nullptr);
  Connection connection(handle, &sqlite3_close);
  if (result != SQLITE_OK) {
    throw std::runtime_error(database.string() + ": " + sqlite3_errmsg(handle));
  }
  return connection;
}

std::string Rows(sqlite3* connection, const std::string& query) {
  std::string rows;
  const auto add = [](void* all, int /*columns*/, char** texts, char** /*names*/) {
    static_cast<std::string*>(all)->append(texts[0] == nullptr ? "NULL" : texts[0]).append("\n");
    return 0;
  };
  if (sqlite3_exec(connection, query.c_str(), add, &rows, nullptr) != SQLITE_OK) {
    throw std::runtime_error(std::string(sqlite3_errmsg(connection)) + " in " + query);
  }
  return rows;
}

void DigestFunction(sqlite3_context* context, int /*count*/, sqlite3_value** values) {
  const auto* bytes = static_cast<const char*>(sqlite3_value_blob(values[0]));
  const auto size = static_cast<std::size_t>(sqlite3_value_bytes(values[0]));
  const std::string digest = DigestOf(bytes == nullptr ? std::string_view() : std::string_view(bytes, size));
  sqlite3_result_text(context, digest.data(), static_cast<int>(digest.size()), SQLITE_TRANSIENT);
}

}  // namespace

std::string RowsOf(const std::filesystem::path& database, const std::string& query) {
  const Connection connection = Open(database);
  sqlite3_create_function(connection.get(), "digest", 1, SQLITE_UTF8, nullptr, &DigestFunction, nullptr,
                          nullptr);
  if (const std::string found = Rows(connection.get(), "PRAGMA integrity_check"); found != "ok\n") {
    throw std::runtime_error(database.string() + " is damaged: " + found);
  }
  return Rows(connection.get(), query);
}

void ChangeDatabase(const std::filesystem::path& database, const std::string& sql) {
  Rows(Open(database).get(), sql);
}

void CheckBackups(const std::filesystem::path& folder) {
  if (!std::filesystem::exists(folder / "backups")) {
    return;
  }
  std::map<std::string, int> copies;
  for (const auto& entry : std::filesystem::directory_iterator(folder / "backups")) {
    const std::string name = entry.path().filename();
    if (entry.path().extension() == ".mdb") {
      RowsOf(entry.path(), "SELECT ''");
      if (++copies[name.substr(0, name.find('-'))] > MostCopies) {
        throw std::runtime_error("too many backup copies in " + folder.string());
      }
    }
  }
}

std::string DigestOf(std::string_view bytes) {
  std::uint64_t digest = 14695981039346656037U;
  for (const char byte : bytes) {
    digest = (digest ^ static_cast<unsigned char>(byte)) * 1099511628211U;
  }
  std::array<char, 17> text{};
  std::snprintf(text.data(), text.size(), "%016llx", static_cast<unsigned long long>(digest));
  return text.data();
}

std::string BytesOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), {}};
}
