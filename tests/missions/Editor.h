#pragma once

#include <memory>

#include "tests/missions/EditorSteps.h"
#include "tests/support/DataSite.h"

/// The mission editor by itself.
class Editor : public EditorSteps<DataSite> {
 protected:
  void Execute() override { Scenarios(*database, *rows, venue.Boxes, venue.Strings, nullptr).exec(); }

  std::unique_ptr<Database> database = venue.Databases.OpenDatabase(venue.DataFile("scenarios.mdb"));
  std::unique_ptr<Recordset> rows = database->OpenRecordset("Table1");
};
