#include "platform/jet/JetStream.h"

#include <gmock/gmock.h>

#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

std::string Text(const std::string& text) {
  return 'S' + std::string{static_cast<char>(text.size()), 0, 0, 0} + text;
}

/// One other table, then the requested one with columns A and B and two rows.
std::string WholeStream() {
  std::string bytes = "O" + Text("Extras") + std::string("\x03\0\0\0\0\0\0\0", 8);
  bytes += "T" + Text("Members") + std::string("\x02\0\0\0", 4) + Text("A") + Text("B");
  bytes += std::string("RI\xFE\xFF\xFF\xFF\xFF\xFF\xFF\xFF", 10) + Text("Ada");
  bytes += std::string("RN", 2) + std::string("D\0\0\0\0\0\0\xF8\x3F", 9);
  return bytes + "E";
}

class Stream : public testing::Test {
 protected:
  JetStream stream{
      {[this](const std::string& table, std::int64_t count) { others.emplace_back(table, count); },
       [this](const std::vector<std::string>& names) { columns = names; },
       [this](const std::vector<Value>& row, const std::vector<std::size_t>& which) {
         rows.push_back(row);
         unread.push_back(which);
       },
       [this](const std::string& table, std::int64_t read, std::int64_t counted) {
         failure = table + " " + std::to_string(read) + "/" + std::to_string(counted);
       }}};
  std::vector<std::pair<std::string, std::int64_t>> others;
  std::vector<std::string> columns;
  std::vector<std::vector<Value>> rows;
  std::vector<std::vector<std::size_t>> unread;
  std::string failure;
};

TEST_F(Stream, GivesTablesColumnsAndRows) {
  stream.Take(WholeStream());
  EXPECT_TRUE(stream.Ended());
  EXPECT_THAT(others, ElementsAre(std::pair{std::string("Extras"), std::int64_t{3}}));
  EXPECT_THAT(columns, ElementsAre("A", "B"));
  ASSERT_EQ(rows.size(), 2U);
  EXPECT_THAT(rows[0], ElementsAre(Value(std::int64_t{-2}), Value("Ada")));
  EXPECT_THAT(rows[1], ElementsAre(Value(std::monostate()), Value(1.5)));
}

TEST_F(Stream, TakesPiecesOfAnySize) {
  for (const char byte : WholeStream()) {
    EXPECT_FALSE(stream.Ended());
    stream.Take({&byte, 1});
  }
  EXPECT_TRUE(stream.Ended());
  EXPECT_EQ(rows.size(), 2U);
}

TEST_F(Stream, GivesBytes) {
  stream.Take("T" + Text("M") + std::string("\x01\0\0\0", 4) + Text("P") +
              std::string("RB\x02\0\0\0\x00\xFF", 8));
  ASSERT_EQ(rows.size(), 1U);
  EXPECT_EQ(std::get<Blob>(rows[0][0]), (Blob{0, 255}));
  EXPECT_FALSE(stream.Ended());
}

TEST_F(Stream, TellsWhichValuesWereNotReadWhole) {
  stream.Take("T" + Text("M") + std::string("\x02\0\0\0", 4) + Text("P") + Text("Q") + "RN" + "UN" + "R" +
              "U" + Text("cut") + "N" + "RNN");
  EXPECT_THAT(unread, ElementsAre(ElementsAre(1U), ElementsAre(0U), ElementsAre()));
  ASSERT_EQ(rows.size(), 3U);
  EXPECT_THAT(rows[1], ElementsAre(Value("cut"), Value(std::monostate())));
}

TEST_F(Stream, EndsWithATableThatCannotBeRead) {
  stream.Take("F" + Text("Members") + std::string("\x03\0\0\0\0\0\0\0\x28\0\0\0\0\0\0\0", 16));
  EXPECT_TRUE(stream.Ended());
  EXPECT_EQ(failure, "Members 3/40");
}

TEST_F(Stream, RefusesMalformedInput) {
  const std::string table = "T" + Text("M") + std::string("\x01\0\0\0", 4) + Text("P");
  for (const std::string& bytes :
       {std::string("x"), std::string("R"), std::string("E"), table + "O", table + table, table + "Rx",
        table + std::string("RS\xFF\xFF\xFF\xFF", 6), "T" + Text("M") + std::string("\xFF\xFF\0\0", 4),
        table + "RUUN", table + "RU" + "x", WholeStream() + "F",
        "OI" + std::string(8, '\0') + std::string(8, '\0'), WholeStream() + "R"}) {
    JetStream fresh{{[](const std::string&, std::int64_t) {}, [](const std::vector<std::string>&) {},
                     [](const std::vector<Value>&, const std::vector<std::size_t>&) {},
                     [](const std::string&, std::int64_t, std::int64_t) {}}};
    EXPECT_EQ(NumberThrownBy([&] { fresh.Take(bytes); }), 3343) << bytes;
  }
}

}  // namespace
