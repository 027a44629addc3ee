#pragma once

#include <cstddef>
#include <cstring>
#include <string>

/// The number at `at` in the bytes of a file, in this machine's order.
template <typename T>
T NumberAt(const std::string& bytes, std::size_t at) {
  T number{};
  std::memcpy(&number, bytes.data() + at, sizeof number);
  return number;
}

template <typename T>
void PutNumber(std::string& bytes, std::size_t at, T number) {
  std::memcpy(bytes.data() + at, &number, sizeof number);
}
