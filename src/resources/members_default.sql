-- The empty members table of a new installation.

PRAGMA user_version = 1;

BEGIN;

-- Names and contact details compare case-insensitively, DallasID exactly. Dates are local times
-- 'YYYY-MM-DD HH:MM:SS'. Photograph is last, so that reading the other columns never touches its pages.
CREATE TABLE Members (
  ContactID INTEGER PRIMARY KEY AUTOINCREMENT,
  DallasID TEXT,
  FirstName TEXT COLLATE NOCASE,
  LastName TEXT COLLATE NOCASE,
  NickName TEXT COLLATE NOCASE,
  Clan TEXT COLLATE NOCASE,
  Birthdate TEXT,
  Address TEXT COLLATE NOCASE,
  City TEXT COLLATE NOCASE,
  PostalCode TEXT COLLATE NOCASE,
  EmailName TEXT COLLATE NOCASE,
  PhoneNumber TEXT COLLATE NOCASE,
  DateJoined TEXT,
  LastPlayedDate TEXT,
  TotalGamesPlayed INTEGER NOT NULL DEFAULT 0,
  TotalDamage REAL NOT NULL DEFAULT 0,
  TotalSoldiering REAL NOT NULL DEFAULT 0,
  AverageDamage REAL NOT NULL DEFAULT 0,
  AverageSoldiering REAL NOT NULL DEFAULT 0,
  TotalPrimaryAccuracy REAL NOT NULL DEFAULT 0,
  PriZeroAccuracyCount INTEGER NOT NULL DEFAULT 0,
  AveragePrimAccuracy REAL NOT NULL DEFAULT 0,
  AverageSecAccuracy REAL NOT NULL DEFAULT 0,
  PhotographLength INTEGER DEFAULT 0,
  Photograph BLOB
);

CREATE INDEX MembersByDallasID ON Members (DallasID);
CREATE INDEX MembersByFirstName ON Members (FirstName);
CREATE INDEX MembersByLastName ON Members (LastName);
CREATE INDEX MembersByNickName ON Members (NickName);

COMMIT;
