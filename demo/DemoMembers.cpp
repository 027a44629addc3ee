#include "demo/DemoMembers.h"

#include <utility>

namespace {

// Skins, hair and eyes.
constexpr QRgb Fair = 0xFFF4CFB0;
constexpr QRgb Rosy = 0xFFF2C3A0;
constexpr QRgb Golden = 0xFFF3D2AC;
constexpr QRgb Tan = 0xFFCB9468;
constexpr QRgb Brown = 0xFF94613F;
constexpr QRgb Deep = 0xFF6B432B;
constexpr QRgb Black = 0xFF17141A;
constexpr QRgb Chestnut = 0xFF5A3825;
constexpr QRgb Copper = 0xFFB4582A;
constexpr QRgb Straw = 0xFFD8B060;
constexpr QRgb Grey = 0xFF8C8C92;
constexpr QRgb DarkEyes = 0xFF3A2416;
constexpr QRgb BlueEyes = 0xFF4A7AB0;
constexpr QRgb GreenEyes = 0xFF3D6B4A;

std::vector<DemoMember> MakeFirstHalf() {
  return {
      {{"Maya", "Lindqvist", "Comet", "Night Owls", "1994-03-18 00:00:00", "14 Mill Lane", "Harrowgate Bay",
        "4120", "maya@example.org", "555 0114"},
       {Fair, Chestnut, Hair::Long, 0xFF2F8F83, 0xFF6A8FB5, GreenEyes, Mouth::Laughing, Beard::None,
        Glasses::None, true},
       "2022-09-03 18:20:00",
       7,
       61,
       7420,
       7391,
       0.347},
      {{"晓雯", "林", "流星", "Night Owls", "1998-11-02 00:00:00", "3 Quay Street", "Harrowgate Bay", "4121",
        "xiaowen@example.org", "555 0127"},
       {Golden, Black, Hair::Bob, 0xFFB34A6A, 0xFF8A7AB0, DarkEyes, Mouth::Smiling, Beard::None,
        Glasses::Round},
       "2023-04-22 15:45:00",
       7,
       48,
       7015,
       7002,
       0.352},
      {{"Tomas", "Okafor", "Badger", "Ironworks", "1989-06-30 00:00:00", "22 Foundry Road", "Harrowgate Bay",
        "4118", "tomas@example.org", "555 0133"},
       {Brown, Black, Hair::Short, 0xFFD0693A, 0xFF7A9A6A, DarkEyes, Mouth::Laughing, Beard::Full},
       "2021-05-15 19:10:00",
       1,
       94,
       6630,
       6588,
       0.318},
      {{"Siobhan", "O'Connell", "Ember", "", "2001-01-25 00:00:00", "7 Chapel Hill", "Wrenfield", "4207",
        "siobhan@example.org", "555 0146"},
       {Rosy, Copper, Hair::Curly, 0xFF4A6AB0, 0xFFB59A6A, BlueEyes, Mouth::Laughing, Beard::None,
        Glasses::None, true},
       "2024-02-10 14:00:00",
       14,
       23,
       6105,
       6077,
       0.291},
      {{"Priya", "Raman", "", "Ironworks", "1992-08-09 00:00:00", "51 Station Street", "Harrowgate Bay",
        "4119", "priya@example.org", "555 0152"},
       {Tan, Black, Hair::Bun, 0xFF8A4AB0, 0xFF6AA5A0, DarkEyes, Mouth::Laughing, Beard::None,
        Glasses::Square},
       "2022-12-17 17:30:00",
       7,
       39,
       5840,
       5821,
       0.305},
      {{"浩然", "陈", "小龙", "Night Owls", "2000-02-14 00:00:00", "9 Lantern Court", "Harrowgate Bay",
        "4121", "haoran@example.org", "555 0168"},
       {Golden, Black, Hair::Spiky, 0xFFD0A03A, 0xFF5A7AA5, DarkEyes, Mouth::Laughing},
       "2023-10-28 16:25:00",
       1,
       35,
       5610,
       5583,
       0.276},
  };
}

std::vector<DemoMember> MakeSecondHalf() {
  return {
      {{"Jonas", "Whitlock", "Sarge", "", "1985-12-05 00:00:00", "2 Orchard Close", "Wrenfield", "4205",
        "jonas@example.org", "555 0171"},
       {Fair, Straw, Hair::SideParting, 0xFF3A5A3A, 0xFF8FA0B0, BlueEyes, Mouth::Smiling, Beard::Stubble},
       "2020-08-29 18:00:00",
       21,
       112,
       5275,
       5240,
       0.268},
      {{"Amara", "Diallo", "Skylark", "Ironworks", "1996-05-21 00:00:00", "30 Harbour View", "Harrowgate Bay",
        "4120", "amara@example.org", "555 0185"},
       {Deep, Black, Hair::Ponytail, 0xFF3A90C0, 0xFFB58A7A, DarkEyes, Mouth::Laughing},
       "2023-06-11 15:15:00",
       7,
       44,
       5020,
       4996,
       0.312},
      {{"Walter", "Brandt", "Granite", "", "1968-07-12 00:00:00", "18 Mill Lane", "Harrowgate Bay", "4120",
        "walter@example.org", "555 0190"},
       {Rosy, Grey, Hair::Shaved, 0xFF707A8A, 0xFF7A8A70, GreenEyes, Mouth::Laughing, Beard::Full,
        Glasses::Square},
       "2020-08-29 18:05:00",
       1,
       127,
       4480,
       4431,
       0.243},
      {{"Lucía", "Serrano", "Chispa", "Night Owls", "1999-09-27 00:00:00", "5 Bell Square", "Wrenfield",
        "4206", "lucia@example.org", "555 0203"},
       {Tan, Chestnut, Hair::Curly, 0xFFC0485A, 0xFF6FA0A8, GreenEyes, Mouth::Smiling},
       "2024-09-14 17:50:00",
       14,
       17,
       4235,
       4210,
       0.259},
      {{"雨晨", "赵", "夜莺", "", "2003-04-08 00:00:00", "12 Lantern Court", "Harrowgate Bay", "4121",
        "yuchen@example.org", "555 0214"},
       {Golden, Black, Hair::Long, 0xFF5A8AD0, 0xFFA88AA0, DarkEyes, Mouth::Smiling},
       "2025-03-01 16:05:00",
       7,
       12,
       3980,
       3957,
       0.231},
      {{"Ben", "Castellan", "Moth", "Ironworks", "1997-10-16 00:00:00", "44 Foundry Road", "Harrowgate Bay",
        "4118", "ben@example.org", "555 0229"},
       {Fair, Chestnut, Hair::SideParting, 0xFF8A5A3A, 0xFF7F93B8, BlueEyes, Mouth::Laughing, Beard::None,
        Glasses::Round},
       "2025-11-08 18:40:00",
       1,
       8,
       3510,
       3478,
       0.214},
  };
}

std::vector<DemoMember> MakeMembers() {
  std::vector<DemoMember> members = MakeFirstHalf();
  for (DemoMember& member : MakeSecondHalf()) {
    members.push_back(std::move(member));
  }
  return members;
}

}  // namespace

std::string DemoMember::FullName() const {
  return Details.FirstName + " " + Details.LastName;
}

std::string DemoMember::ShownName() const {
  return Details.NickName.empty() ? FullName() : Details.NickName;
}

const std::vector<DemoMember>& DemoMembers() {
  static const std::vector<DemoMember> members = MakeMembers();
  return members;
}
