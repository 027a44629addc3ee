#include <fstream>

#include "core/data/Photo.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

constexpr int Members = 7;

int MemberOf(int number) {
  return 1 + number % Members;
}

/// Up to nearly the size that asks back.
std::string PhotoOf(int number) {
  std::string bytes(static_cast<std::size_t>(1 + number * 7919 % 99'999), '\0');
  for (std::size_t i = 0; i < bytes.size(); ++i) {
    bytes[i] = static_cast<char>(i * 31 + static_cast<std::size_t>(number));
  }
  return bytes;
}

std::string RowOf(int member, const std::string& nickName, const std::string& photo) {
  return std::to_string(member) + ": " + nickName + ", " + std::to_string(photo.size()) + " " +
         DigestOf(photo) + "\n";
}

/// Each step gives a member another name and photograph, in one edit.
class PhotoWork : public Work {
 public:
  explicit PhotoWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "photographs"; }
  int Share() const override { return 20; }

  void Prepare(const std::filesystem::path& folder) override {
    PutDefaultDatabases(sources_, folder);
    for (int id = 1; id <= Members; ++id) {
      ChangeDatabase(folder / "members.mdb", "INSERT INTO Members (ContactID, FirstName, NickName) VALUES (" +
                                                 std::to_string(id) + ", 'Ann', 'new')");
    }
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder);
    Recordset& rows = desk.Games.RsMembers();
    const std::string file = folder / "photo.jpg";
    for (int number = first;; ++number) {
      desk.Disk.Write(file, PhotoOf(number));
      if (!rows.WalkTo("ContactID", std::int64_t{MemberOf(number)})) {
        throw std::runtime_error("a member is gone");
      }
      rows.Edit();
      rows.SetField("NickName", std::to_string(number));
      StorePhoto(file, rows, "Photograph", "PhotographLength", desk.Disk, desk.Boxes);
      rows.Update();
      report(number);
    }
  }

  std::string StateAfter(int steps) override {
    std::string rows;
    for (int member = 1; member <= Members; ++member) {
      int latest = steps;
      while (latest > 0 && MemberOf(latest) != member) {
        --latest;
      }
      rows += latest > 0 ? RowOf(member, std::to_string(latest), PhotoOf(latest)) : RowOf(member, "new", "");
    }
    return rows;
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    CheckBackups(folder);
    return RowsOf(folder / "members.mdb",
                  "SELECT ContactID || ': ' || NickName || ', ' || PhotographLength || ' ' || "
                  "digest(substr(Photograph, 1, PhotographLength)) FROM Members ORDER BY ContactID");
  }

 private:
  WorkSources sources_;
};

}  // namespace

std::unique_ptr<Work> MakePhotoWork(const WorkSources& sources) {
  return std::make_unique<PhotoWork>(sources);
}
