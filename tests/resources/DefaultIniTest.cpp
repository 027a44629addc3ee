#include <gtest/gtest.h>

#include <map>
#include <sstream>
#include <string>

#include "tests/resources/DefaultFile.h"

namespace {

TEST(DefaultIni, StatesTheDefaultsAndNothingElse) {
  std::istringstream lines(DefaultFileBytes("tessarine.ini"));
  std::map<std::string, std::string> values;
  std::string section;
  std::string line;
  while (std::getline(lines, line)) {
    if (line.empty() || line.front() == ';') {
      continue;
    }
    const std::size_t equals = line.find('=');
    if (line.front() == '[') {
      section = line;
    } else {
      ASSERT_NE(equals, std::string::npos) << line;
      values[section + line.substr(0, equals)] = line.substr(equals + 1);
    }
  }
  EXPECT_EQ(section, "[ports]");
  const std::map<std::string, std::string> defaults = {{"[comm]commport", "1"},
                                                       {"[soldiering_calc]total_damage", "1"},
                                                       {"[soldiering_calc]respawns", "-1"},
                                                       {"[soldiering_calc]heals", "-1"},
                                                       {"[soldiering_calc]ammo_adds", "-1"},
                                                       {"[soldiering_calc]accuracy", "1"},
                                                       {"[soldiering_calc]friendly_fire_factor", "-1"}};
  EXPECT_EQ(values, defaults);
}

TEST(DefaultIni, ShowsHowAPortIsNamed) {
  EXPECT_NE(DefaultFileBytes("tessarine.ini").find(";   com1=/dev/serial/by-id/"), std::string::npos);
}

}  // namespace
