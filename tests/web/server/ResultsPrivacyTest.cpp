#include <gmock/gmock.h>

#include <charconv>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "tests/support/ScoredGame.h"
#include "tests/web/Games.h"
#include "tests/web/server/ResultsProgram.h"
#include "web/ResultsPages.h"

namespace {

using testing::HasSubstr;
using testing::Not;

/// What nobody in the hall may learn of the member.
const std::vector<std::string> Private{
    "Zebulonia", "Quarkenstein",    "1987-03-29",  "Hidden Lane 77",   "Gremblinge",
    "94817",     "zq@mail.invalid", "0555 918273", "AA0000000000D5E7", "918273645"};

/// All memory that the process can read of its own, as one text for a search.
class Memory {
 public:
  explicit Memory(const ResultsProgram& program) {
    std::ifstream memory("/proc/" + std::to_string(program.Process()) + "/mem", std::ios::binary);
    std::istringstream maps(program.About("maps"));
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

/// A game with a member of whom everything is known, and the pages made of it.
class MembersData : public testing::Test {
 protected:
  void SetUp() override {
    ExecuteSql(
        scored.MembersFile(),
        "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName, Birthdate, Address, "
        "City, PostalCode, EmailName, PhoneNumber) VALUES (918273645, 'AA0000000000D5E7', 'Zebulonia', "
        "'Quarkenstein', 'Molefinger', '1987-03-29', 'Hidden Lane 77', 'Gremblinge', '94817', "
        "'zq@mail.invalid', '0555 918273')");
    Player& player = scored.Activate(Red0);
    player.DallasID = "AA0000000000D5E7";
    player.ShotCount = 10;
    player.PrimaryDamage = 5;
    scored.Activate(Blue7).HitByPlayer(Red0) = 15;
    scored.CalculateScores();
    ASSERT_EQ(player.MemberIndex, 918273645);
  }

  /// Pages of the game, with names or without.
  ResultsPages PagesWith(bool shown) {
    const ShownNames names{.Shown = shown,
                           .OfMembers = [this](std::int32_t id) { return scored.Members->NickNameOf(id); },
                           .OfGuests = nullptr,
                           .Hidden = nullptr};
    ResultsPages pages(Language::English);
    pages.Put(PublicGameOf(scored.game, 1, "20:15", names), std::chrono::hours(0));
    return pages;
  }

  ScoredGame scored;
};

TEST_F(MembersData, IsOnNoPage) {
  for (const bool shown : {false, true}) {
    const ResultsPages pages = PagesWith(shown);
    for (const auto& [path, body] : pages.Pages()) {
      for (const std::string& text : Private) {
        EXPECT_THAT(body, Not(HasSubstr(text))) << path;
      }
    }
    EXPECT_EQ(pages.Pages().at("/").find("Molefinger") != std::string::npos, shown);
  }
}

TEST_F(MembersData, IsNotInTheMemoryOfTheProgramThatServesThePages) {
  ResultsProgram program(18'500);
  ResultsPages pages = PagesWith(true);
  for (const PageFrame& frame : pages.TakeAll()) {
    program.Write(EncodeFrame(frame));
  }
  program.Settle();
  ASSERT_THAT(program.Get("/en/g/1/1"), HasSubstr("Molefinger"));
  const Memory memory(program);
  EXPECT_TRUE(memory.Holds("Molefinger"));
  for (const std::string& text : Private) {
    EXPECT_FALSE(memory.Holds(text)) << text;
  }
}

}  // namespace
