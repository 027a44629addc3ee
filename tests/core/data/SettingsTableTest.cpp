#include "core/data/SettingsTable.h"

#include <gmock/gmock.h>

#include <set>
#include <string>

#include "core/data/IniReader.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/support/TemporaryFolder.h"

namespace {

using testing::HasSubstr;

/// The table in the manual, in its format.
std::string ManualRows() {
  std::string rows = "| Section | Key | Default | Meaning |\n| --- | --- | --- | --- |\n";
  for (const Setting& setting : AllSettings) {
    const std::string value(setting.Default);
    rows += "| `[" + std::string(setting.Section) + "]` | `" + setting.Key + "` | " +
            (value.empty() ? "none" : "`" + value + "`") + " | " + setting.Meaning + " |\n";
  }
  return rows;
}

TEST(SettingsTable, IsTheListOfTheManual) {
  EXPECT_THAT(ReadFile(TESSARINE_MANUAL), HasSubstr("\n" + ManualRows() + "\n"));
}

TEST(SettingsTable, NamesEachSettingOnce) {
  std::set<std::string> names;
  for (const Setting& setting : AllSettings) {
    EXPECT_TRUE(names.insert(std::string(setting.Section) + "." + setting.Key).second) << setting.Key;
    EXPECT_STRNE(setting.Meaning, "") << setting.Key;
  }
}

TEST(SettingsTable, HasTheDefaultsOfTheFileThatANewInstallationGets) {
  FakeFiles disk;
  disk.Put("/tessarine.ini", ReadFile(TESSARINE_RESOURCES "/tessarine.ini"));
  const IniReader ini(disk, "/tessarine.ini");
  std::set<std::string> inFile;
  std::set<std::string> sections;
  for (const Setting& setting : AllSettings) {
    const std::string value = ini.ReadIni(setting.Section, setting.Key, "absent");
    EXPECT_TRUE(value == setting.Default || value == "absent") << setting.Key << " is " << value;
    if (value != "absent") {
      inFile.insert(setting.Key);
    }
    sections.insert(setting.Section);
  }
  EXPECT_GE(inFile.size(), 7U);
  for (const std::string& section : sections) {
    for (const auto& [key, value] : ini.ReadSection(section)) {
      EXPECT_EQ(inFile.count(key), 1U) << key << " is in the file alone";
    }
  }
}

}  // namespace
