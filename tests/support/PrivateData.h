#pragma once

#include <sys/types.h>

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <fstream>
#include <string>
#include <vector>

/// A member of whom everything is known, nickname Molefinger, as a row of the table.
inline const std::string PrivateMember =
    "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName, Birthdate, Address, "
    "City, PostalCode, EmailName, PhoneNumber) VALUES (918273645, 'AA0000000000D5E7', 'Zebulonia', "
    "'Quarkenstein', 'Molefinger', '1987-03-29', 'Hidden Lane 77', 'Gremblinge', '94817', "
    "'zq@mail.invalid', '0555 918273')";

/// What nobody in the hall may learn of the member.
inline const std::vector<std::string> Private{
    "Zebulonia", "Quarkenstein",    "1987-03-29",  "Hidden Lane 77",   "Gremblinge",
    "94817",     "zq@mail.invalid", "0555 918273", "AA0000000000D5E7", "918273645"};

/// All memory that the process can read of its own, as one text for a search.
class ProcessMemory {
 public:
  explicit ProcessMemory(pid_t process) {
    std::ifstream memory("/proc/" + std::to_string(process) + "/mem", std::ios::binary);
    std::ifstream maps("/proc/" + std::to_string(process) + "/maps");
    for (std::string line; std::getline(maps, line);) {
      std::uint64_t from = 0;
      std::uint64_t to = 0;
      const char* end = line.data() + line.size();
      const auto first = std::from_chars(line.data(), end, from, 16);
      std::from_chars(first.ptr + 1, end, to, 16);
      // Terabytes are a sanitizer's own, which says of each byte of the others whether it may be used.
      constexpr std::uint64_t mostBytes = std::uint64_t{1} << 30U;
      if (line.find(" r") != std::string::npos && line.find("[v") == std::string::npos &&
          to - from <= mostBytes) {
        std::string& part = parts_.emplace_back(to - from, '\0');
        memory.clear();
        memory.seekg(static_cast<std::streamoff>(from));
        memory.read(part.data(), static_cast<std::streamsize>(part.size()));
        part.resize(static_cast<std::size_t>(memory.gcount()));
      }
    }
  }

  bool Holds(const std::string& text) const {
    return std::ranges::any_of(parts_,
                               [&text](const std::string& part) { return part.find(text) != part.npos; });
  }

 private:
  std::vector<std::string> parts_;
};
