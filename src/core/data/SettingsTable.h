#pragma once

#include <array>

/// One value of tessarine.ini.
struct Setting {
  const char* Section;
  const char* Key;
  const char* Default;  ///< used if the file has none; empty if there is no default
  const char* Meaning;  ///< as in the manual
};

/// Every setting of the program, each named here and nowhere else. A new one gets a section that no other
/// program or earlier version wrote, a line in AllSettings, and a row in the manual, which a test compares.
namespace Keys {

inline constexpr Setting CommPort = {"comm", "commport", "1",
                                     "Number of the serial port with the base unit or the radio modem."};

inline constexpr Setting FirmwarePath = {"Paths", "firmware_path", "Select a File",
                                         "The last firmware file."};

inline constexpr Setting TotalDamage = {"soldiering_calc", "total_damage", "1",
                                        "Soldiering points for each point of damage."};
inline constexpr Setting Respawns = {"soldiering_calc", "respawns", "-1",
                                     "Soldiering points for each death."};
inline constexpr Setting Heals = {"soldiering_calc", "heals", "-1", "Soldiering points for each heal."};
inline constexpr Setting AmmoAdds = {"soldiering_calc", "ammo_adds", "-1",
                                     "Soldiering points for each ammunition refill."};
inline constexpr Setting Accuracy = {"soldiering_calc", "accuracy", "1",
                                     "Soldiering points for each percent of accuracy."};
inline constexpr Setting FriendlyFire = {"soldiering_calc", "friendly_fire_factor", "-1",
                                         "Factor applied to damage done to one's own team."};

inline constexpr Setting ReaderPort = {
    "onewire", "port", "",
    "Number of the serial port with the reader of membership buttons; without it, port 1 with an adapter of "
    "type 5."};
inline constexpr Setting ReaderType = {
    "onewire", "type", "5", "Type of the reader's adapter; 5 is a serial adapter with a DS2480B chip."};

inline constexpr Setting LastSoundFolder = {"Media Player", "1", "",
                                            "Folder of the sound file that was chosen last."};

/// One key for each port number n.
inline constexpr Setting PortDevice = {
    "ports", "com<n>", "", "Device for port number n; without it, the machine's n-th serial port."};

inline constexpr Setting OutcomeSign = {
    "outcome", "sign", "1",
    "1 for a large sign when a box was programmed or a button charged, or was not; 0 for none."};
inline constexpr Setting OutcomeSound = {"outcome", "sound", "1", "The same for a sound."};

inline constexpr Setting AudienceScreen = {
    "audience", "screen", "", "Name of the screen with the audience board; without it, the second one."};
inline constexpr Setting AudienceDistance = {
    "audience", "distance", "5", "Metres from that screen to those who read it from farthest away."};
inline constexpr Setting AudienceDiagonal = {"audience", "diagonal", "0",
                                             "Its diagonal in inches; 0 for what the screen says of itself."};
inline constexpr Setting AudienceSeconds = {"audience", "seconds", "8",
                                            "Seconds that each page of the board stays."};
inline constexpr Setting AudienceVenue = {"audience", "venue", "", "Name of the venue on the board."};
inline constexpr Setting AudiencePicture = {"audience", "picture", "", "File with its picture."};
inline constexpr Setting AudienceFollow = {
    "audience", "follow", "1", "1: the board shows each game once its scores are in; 0: by command alone."};

inline constexpr Setting YearsToKeepGames = {
    "archive", "keep_years", "",
    "Years for which past games are kept; without it, for good. The program asks before it deletes the first "
    "ones."};
inline constexpr Setting ResultsOn = {"results", "on", "0", "1: results are on a page for phones."};
inline constexpr Setting ResultsAddress = {"results", "address", "",
                                           "Address at which it is; without it, that of the default route."};
inline constexpr Setting ResultsPort = {"results", "port", "8080",
                                        "Port, 1024 to 65535; where it is taken, the next free one."};
inline constexpr Setting ResultsNames = {
    "results", "names", "board",
    "Nicknames and guest names: board: on the audience board; all: also on the page; none: guns only."};
inline constexpr Setting ResultsGames = {"results", "games", "10",
                                         "How many of the evening's last games it shows, 1 to 30."};
inline constexpr Setting ResultsWithBoard = {
    "results", "with_board", "0", "1: a new game appears once the audience board shows it; 0: at once."};
inline constexpr Setting ResultsRanking = {"results", "ranking", "0",
                                           "1: the month's ranking is on the page, if names are."};

}  // namespace Keys

/// In the order of the manual.
inline constexpr std::array AllSettings = {Keys::CommPort,
                                           Keys::FirmwarePath,
                                           Keys::TotalDamage,
                                           Keys::Respawns,
                                           Keys::Heals,
                                           Keys::AmmoAdds,
                                           Keys::Accuracy,
                                           Keys::FriendlyFire,
                                           Keys::ReaderPort,
                                           Keys::ReaderType,
                                           Keys::LastSoundFolder,
                                           Keys::PortDevice,
                                           Keys::OutcomeSign,
                                           Keys::OutcomeSound,
                                           Keys::AudienceScreen,
                                           Keys::AudienceDistance,
                                           Keys::AudienceDiagonal,
                                           Keys::AudienceSeconds,
                                           Keys::AudienceVenue,
                                           Keys::AudiencePicture,
                                           Keys::AudienceFollow,
                                           Keys::YearsToKeepGames,
                                           Keys::ResultsOn,
                                           Keys::ResultsAddress,
                                           Keys::ResultsPort,
                                           Keys::ResultsNames,
                                           Keys::ResultsGames,
                                           Keys::ResultsWithBoard,
                                           Keys::ResultsRanking};
