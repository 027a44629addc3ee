#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "tests/support/TestDatabase.h"

/// A recordset on the first member.
class EditedMembers : public testing::Test {
 protected:
  EditedMembers() {
    file.AddMembers();
    database = file.Open();
    rows = database->OpenRecordset("Members");
  }

  std::string Count() const { return file.Query("SELECT count(*) FROM Members"); }

  TestDatabase file;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};
