-- The empty archive of games of a new installation.

PRAGMA user_version = 1;

BEGIN;

-- A row for each game. Times are local, 'YYYY-MM-DD HH:MM:SS'; DateText is the game's own date as it stands in
-- its file. BestPlayer is the record, 1 to 224, of the player in the first place, 0 without players. The six
-- factors are those of which the figures were made. Deleted is the time of the deletion, NULL for most games.
CREATE TABLE Games (
  GameID INTEGER PRIMARY KEY AUTOINCREMENT,
  Played TEXT NOT NULL,
  DateText TEXT NOT NULL,
  Mission TEXT NOT NULL,
  Source TEXT NOT NULL,
  Pulls INTEGER NOT NULL,
  Players INTEGER NOT NULL,
  Committed INTEGER NOT NULL,
  RedTotal INTEGER NOT NULL,
  BlueTotal INTEGER NOT NULL,
  YellowTotal INTEGER NOT NULL,
  BestPlayer INTEGER NOT NULL,
  DamageFactor REAL NOT NULL,
  DeathFactor REAL NOT NULL,
  HealFactor REAL NOT NULL,
  AmmoFactor REAL NOT NULL,
  AccuracyFactor REAL NOT NULL,
  FriendlyFireFactor REAL NOT NULL,
  InputsHash TEXT NOT NULL,
  Deleted TEXT
);

-- Deleted follows in the index so that counting a month's games reads nothing else.
CREATE INDEX GamesByPlayed ON Games (Played, Deleted);
CREATE INDEX GamesByMission ON Games (Mission, Played);

-- A row for each player of a game; PlayerIndex is the record, 1 to 224. MemberID is 0 for a guest. Accuracy is
-- a fraction, NULL where there is none. GuestName is the name that the operator gave a player for this game, NULL
-- for most; archives of old lack the column until the first such name. The rows of a game lie side by side.
CREATE TABLE GamePlayers (
  GameID INTEGER NOT NULL,
  PlayerIndex INTEGER NOT NULL,
  MemberID INTEGER NOT NULL,
  DallasID TEXT NOT NULL,
  Place INTEGER NOT NULL,
  Soldiering INTEGER NOT NULL,
  Accuracy REAL,
  DamageDealt INTEGER NOT NULL,
  DamageTaken INTEGER NOT NULL,
  Shots INTEGER NOT NULL,
  Wia INTEGER NOT NULL,
  Kia INTEGER NOT NULL,
  AmmoAdds INTEGER NOT NULL,
  Committed INTEGER NOT NULL,
  GuestName TEXT,
  PRIMARY KEY (GameID, PlayerIndex)
) WITHOUT ROWID;

CREATE INDEX GamePlayersByMember ON GamePlayers (MemberID, GameID);
CREATE INDEX GamePlayersByGun ON GamePlayers (PlayerIndex, GameID);

-- The game files, as the sqlite3 tool keeps archives: 'sqlite3 games.mdb -A -x' unpacks them.
CREATE TABLE sqlar (
  name TEXT PRIMARY KEY,
  mode INT,
  mtime INT,
  sz INT,
  data BLOB
);

-- Which game a file holds: State 0 is the game's last state, 1 its first one, 2 the one after that.
CREATE TABLE GameFiles (
  GameID INTEGER NOT NULL,
  State INTEGER NOT NULL,
  Name TEXT NOT NULL,
  InputsHash TEXT NOT NULL,
  PRIMARY KEY (GameID, State)
) WITHOUT ROWID;

CREATE INDEX GameFilesByHash ON GameFiles (InputsHash);

-- What tells the members whose numbers stand in games. Digest is keyed with ArchiveKey; empty for a number that
-- no member had.
CREATE TABLE KnownMembers (
  MemberID INTEGER PRIMARY KEY,
  DallasID TEXT NOT NULL,
  Digest TEXT NOT NULL
);

CREATE TABLE ArchiveKey (
  KeyID INTEGER PRIMARY KEY,
  Secret TEXT NOT NULL
);

COMMIT;
