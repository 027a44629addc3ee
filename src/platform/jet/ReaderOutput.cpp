#include "platform/jet/ReaderOutput.h"

#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>

void ReaderOutput::Number(std::uint64_t number, std::size_t bytes) {
  std::string& room = Room();
  for (std::size_t i = 0; i < bytes; ++i) {
    room += static_cast<char>(number >> (8 * i));
  }
}

void ReaderOutput::Integer(std::int64_t value) {
  Tag('I');
  Number(static_cast<std::uint64_t>(value), sizeof value);
}

void ReaderOutput::Real(double value) {
  Tag('D');
  std::uint64_t bits = 0;
  std::memcpy(&bits, &value, sizeof bits);
  Number(bits, sizeof bits);
}

void ReaderOutput::Bytes(char tag, std::string_view bytes) {
  Tag(tag);
  Number(bytes.size(), 4);
  waiting_ += bytes;
}

std::string& ReaderOutput::Room() {
  constexpr std::size_t most = std::size_t{1} << 17U;
  if (waiting_.size() >= most) {
    Flush();
  }
  return waiting_;
}

void ReaderOutput::Flush() {
  std::string_view rest = waiting_;
  while (!rest.empty()) {
    const ssize_t written = write(STDOUT_FILENO, rest.data(), rest.size());
    if (written < 0 && errno != EINTR) {
      std::_Exit(1);
    }
    rest.remove_prefix(written < 0 ? 0 : static_cast<std::size_t>(written));
  }
  waiting_.clear();
}
