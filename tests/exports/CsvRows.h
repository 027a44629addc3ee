#pragma once

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

#include "exports/Csv.h"

/// What CsvRecords has for a cell without a value.
inline const std::string NoValue = "(none)";

/// A row's cells by the headers of their columns.
using CsvRecord = std::map<std::string, std::string>;

/// The rows of a table below its headers.
inline std::vector<CsvRecord> CsvRecords(const std::string& bytes) {
  CsvReader reader(bytes);
  std::vector<std::string> headers;
  std::vector<CsvRecord> records;
  while (reader.Next()) {
    if (headers.empty()) {
      for (const CsvCell& cell : reader.Row()) {
        headers.emplace_back(cell.Text);
      }
      continue;
    }
    EXPECT_EQ(reader.Row().size(), headers.size()) << "line " << reader.Line();
    CsvRecord& record = records.emplace_back();
    for (std::size_t i = 0; i < headers.size() && i < reader.Row().size(); ++i) {
      const CsvCell& cell = reader.Row()[i];
      record[headers[i]] = cell.IsNull() ? NoValue : std::string(cell.Text);
    }
  }
  EXPECT_FALSE(reader.Fault());
  return records;
}
