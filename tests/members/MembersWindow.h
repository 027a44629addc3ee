#pragma once

#include <memory>

#include "tests/members/MembersSteps.h"
#include "tests/support/DataSite.h"

/// The window of the members by itself.
class MembersWindow : public MembersSteps<DataSite> {
 protected:
  void Execute() override { ShowMembers(venue, *database); }

  static void ShowMembers(DataSite& site, Database& members) {
    Members({members, site.Boxes, site.Dialog, site.Disk, site.Time, site.Strings, site.ButtonSwipe}, nullptr)
        .exec();
  }

  std::unique_ptr<Database> database = venue.Databases.OpenDatabase(venue.DataFile("members.mdb"));
};
