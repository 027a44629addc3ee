-- The missions of a new installation. The operator changes, adds and deletes missions in Mission Setup.

PRAGMA user_version = 1;

BEGIN;

-- Short texts are limited to the 255 characters of the former file format; descriptions were memos in some of those
-- files. NUMERIC columns convert a numeric text to a number and leave any other text alone. Texts compare greater than
-- all numbers, so the range checks refuse them, and infinities too.
CREATE TABLE Table1 (
  ID INTEGER PRIMARY KEY AUTOINCREMENT,
  MissionName TEXT NOT NULL DEFAULT '' CHECK (length(MissionName) <= 255),
  MissionDescription TEXT NOT NULL DEFAULT '',
  MissionDescription2 TEXT,
  MissionDescription3 TEXT,
  MissionDescription4 TEXT,
  RespawnPenalty REAL NOT NULL DEFAULT 0 CHECK (typeof(RespawnPenalty) = 'real'),
  HealPenalty REAL NOT NULL DEFAULT 0 CHECK (typeof(HealPenalty) = 'real'),
  GameDuration TEXT NOT NULL DEFAULT '' CHECK (length(GameDuration) <= 255),
  PrimaryObjectiveDescriptionA TEXT NOT NULL DEFAULT '' CHECK (length(PrimaryObjectiveDescriptionA) <= 255),
  SecondaryObjectiveDescriptionA TEXT NOT NULL DEFAULT '' CHECK (length(SecondaryObjectiveDescriptionA) <= 255),
  PrimaryObjectivePointsA NUMERIC NOT NULL DEFAULT 0
    CHECK (PrimaryObjectivePointsA BETWEEN -1e308 AND 1e308),
  SecondaryObjectivePointsA NUMERIC NOT NULL DEFAULT 0
    CHECK (SecondaryObjectivePointsA BETWEEN -1e308 AND 1e308),
  PrimaryObjectiveDescriptionB TEXT NOT NULL DEFAULT '' CHECK (length(PrimaryObjectiveDescriptionB) <= 255),
  SecondaryObjectiveDescriptionB TEXT NOT NULL DEFAULT '' CHECK (length(SecondaryObjectiveDescriptionB) <= 255),
  PrimaryObjectivePointsB NUMERIC NOT NULL DEFAULT 0
    CHECK (PrimaryObjectivePointsB BETWEEN -1e308 AND 1e308),
  SecondaryObjectivePointsB NUMERIC NOT NULL DEFAULT 0
    CHECK (SecondaryObjectivePointsB BETWEEN -1e308 AND 1e308),
  PrimaryObjectiveDescriptionC TEXT NOT NULL DEFAULT '' CHECK (length(PrimaryObjectiveDescriptionC) <= 255),
  SecondaryObjectiveDescriptionC TEXT NOT NULL DEFAULT '' CHECK (length(SecondaryObjectiveDescriptionC) <= 255),
  PrimaryObjectivePointsC NUMERIC NOT NULL DEFAULT 0
    CHECK (PrimaryObjectivePointsC BETWEEN -1e308 AND 1e308),
  SecondaryObjectivePointsC NUMERIC NOT NULL DEFAULT 0
    CHECK (SecondaryObjectivePointsC BETWEEN -1e308 AND 1e308),
  TeamRatio TEXT NOT NULL DEFAULT '' CHECK (length(TeamRatio) <= 255)
);

-- One mission per row. The first line of a description or objective is its tool tip, so it must make sense by itself.
WITH Mission(Name, Description, Duration, Ratio, Respawn, Heal,
             PrimaryA, PrimaryPointsA, SecondaryA, SecondaryPointsA,
             PrimaryB, PrimaryPointsB, SecondaryB, SecondaryPointsB,
             PrimaryC, PrimaryPointsC, SecondaryC, SecondaryPointsC) AS (VALUES
  ('First Muster',
   'The game for newcomers: two teams, no penalties.
Everybody starts at the fence of the team and may respawn there as often as needed. Whoever has learnt to aim, to heal and to reload when the horn sounds has won something already.',
   '10 minutes', '1 : 1', 0, 0,
   'Reach the old well in the middle and have two players standing at it when the final horn sounds.', 50,
   'Bring every player of the team back to the fence once for ammunition.', 20,
   'Reach the old well in the middle and have two players standing at it when the final horn sounds.', 50,
   'Bring every player of the team back to the fence once for ammunition.', 20,
   '', 0, '', 0),

  ('Signal Fires',
   'Three lamps on three hills: light your own and keep it burning.
Each lamp shows the colour of the team that touched it last. The marshal notes the colours every five minutes and at the end.',
   '25 minutes', 'three equal teams', 5, 2,
   'Hold at least two of the three lamps at the final horn.
Any hill counts, your own included.', 120,
   'Never lose the lamp on your own hill.', 60,
   'Hold at least two of the three lamps at the final horn.
Any hill counts, your own included.', 120,
   'Never lose the lamp on your own hill.', 60,
   'Hold at least two of the three lamps at the final horn.
Any hill counts, your own included.', 120,
   'Never lose the lamp on your own hill.', 60),

  ('The Night Courier',
   'Team A brings one courier across the field, team B wants him stopped.
The courier carries the sealed tube and no gun. When he is hit he sits down and counts to thirty, then walks on. Only his bodyguards may carry the tube while he sits, and never for more than twenty paces. Team B does not know which gate he will take until the first horn. A tube that is laid down may be picked up by either side. It counts where it lies when the game ends.',
   '20 minutes', '2 bodyguards per hunter', 15, 2.5,
   'Deliver the sealed tube at the far gate.', 200,
   'Let the courier sit down no more than three times.
The marshal who walks with him counts.', 75,
   'Hold the sealed tube at the final horn.', 200,
   'Make the courier sit down at least six times.
The marshal who walks with him counts.', 75,
   '', 0, '', 0),

  ('Bridge at Dawn',
   'Two teams, one bridge.
The bridge belongs to the team that was last alone on it for a full minute. Nobody respawns within sight of it.',
   '30 minutes', '1 : 1', 10, 1,
   'Own the bridge at the final horn.', 150,
   'Own the bridge for ten minutes in all.', 80,
   'Own the bridge at the final horn.', 150,
   'Own the bridge for ten minutes in all.', 80,
   '', 0, '', 0),

  ('Lantern Keep',
   'Siege: a small garrison holds the keep against a large army.
The attackers respawn at the tents, the defenders not at all, but their medic can heal inside the walls. The keep has fallen when the lantern on its roof has gone out.',
   '40 minutes', '5 attackers per 2 defenders', 8, 4,
   'Put out the lantern on the roof.', 250,
   'Break into the yard within the first fifteen minutes.', 100,
   'Keep the lantern burning until the final horn.', 300,
   'Lose fewer than half of the garrison.', 120,
   '', 0, '', 0),

  ('Harvest Thieves',
   'Sacks of grain have to get from the barn to the mill.
Team A carries, one sack for each carrier, and may not shoot while carrying. Team B lies in wait between barn and mill and brings every captured sack to the quarry. A carrier who is hit drops the sack where he stands, goes back to the barn and is healed there by the miller, who may not leave his post. A dropped sack belongs to whoever picks it up first. What still lies in the open at the final horn counts for nobody.',
   '35 minutes', '3 carriers per 2 thieves', 12, 3,
   'Bring at least nine sacks to the mill.', 180,
   'Lose no sack in the first ten minutes.', 60,
   'Bring at least five sacks to the quarry.', 180,
   'Keep the quarry free of enemies to the end.', 60,
   '', 0, '', 0),

  ('Three Crowns',
   'Every team has a crown and wants the other two.
Crowns are worn in plain sight. A wearer who is hit hands the crown to the player who hit him.',
   '30 minutes', 'three equal teams', 5, 1.5,
   'Wear two or more crowns at the final horn.', 160,
   'Bring your own crown home after it was taken.', 70,
   'Wear two or more crowns at the final horn.', 160,
   'Bring your own crown home after it was taken.', 70,
   'Wear two or more crowns at the final horn.', 160,
   'Bring your own crown home after it was taken.', 70),

  ('Field Hospital',
   'Medics decide this one: heals cost nothing, respawns cost a lot.
Each team has two medics who carry the white bands. A player without health waits where he fell until a medic comes, or gives up and respawns.',
   '25 minutes', '1 : 1', 25, 0,
   'Finish with both medics on their feet.', 100,
   'Carry the stretcher once around the field.', 90,
   'Finish with both medics on their feet.', 100,
   'Carry the stretcher once around the field.', 90,
   '', 0, '', 0),

  ('The Silent Reactor',
   'Start the reactor, or see to it that it stays silent.
Four levers are hidden in the halls. All four must point upwards at the same time for two minutes. Team C are the engineers: they have no quarrel with anybody and sell their help.',
   '45 minutes', '4 starters per 4 guards per 1 engineer', 10, 2,
   'Start the reactor.', 220,
   'Find all four levers within fifteen minutes.', 80,
   'Keep the reactor silent until the final horn.', 220,
   'Take the starters'' plan of the halls.', 80,
   'Repair each of the four levers once.', 140,
   'Be hit by nobody for ten minutes on end.', 110),

  ('Long Shot',
   'Few rounds, long lanes: every shot has to count.
No ammunition is handed out after the start. Whoever runs dry keeps walking and spots for the others.',
   '15 minutes', '1 : 1', 20, 5,
   'Have more players with ammunition left at the final horn.', 90,
   'Spend the whole game without hitting a comrade.', 50,
   'Have more players with ammunition left at the final horn.', 90,
   'Spend the whole game without hitting a comrade.', 50,
   '', 0, '', 0),

  ('Grey Tide',
   'The tide rises: whoever is hit changes sides.
Team B starts with two players and takes in everybody who falls. Team A has to last, and has to reach the boat house before the tide does.',
   '20 minutes', '2 players in team B, all others in team A', 0, 2,
   'Have at least one player in the boat house at the final horn.', 200,
   'Still be ten players after ten minutes.', 90,
   'Leave no player of team A on the field.', 150,
   'Take the boat house before the final horn.', 60,
   '', 0, '', 0),

  ('Last Light',
   'No respawns and no healing: the last team standing wins.
Played in three rounds. The teams change ends after each, and whoever has fallen waits at the fence and keeps quiet.',
   '3 rounds of 8 minutes', 'two or three equal teams', 50, 10,
   'Win two of the three rounds.', 150,
   'Win a round without losing anybody.', 100,
   'Win two of the three rounds.', 150,
   'Win a round without losing anybody.', 100,
   'Win two of the three rounds.', 150,
   'Win a round without losing anybody.', 100)
),
-- Lines end in CR LF, where the tool tips are cut.
Lines AS (
  SELECT *, replace(Description, char(10), char(13, 10)) AS Text FROM Mission
)
INSERT INTO Table1 (
  MissionName, MissionDescription, MissionDescription2,
  RespawnPenalty, HealPenalty, GameDuration,
  PrimaryObjectiveDescriptionA, SecondaryObjectiveDescriptionA, PrimaryObjectivePointsA, SecondaryObjectivePointsA,
  PrimaryObjectiveDescriptionB, SecondaryObjectiveDescriptionB, PrimaryObjectivePointsB, SecondaryObjectivePointsB,
  PrimaryObjectiveDescriptionC, SecondaryObjectiveDescriptionC, PrimaryObjectivePointsC, SecondaryObjectivePointsC,
  TeamRatio)
SELECT
  Name, substr(Text, 1, 254), nullif(substr(Text, 255), ''),
  Respawn, Heal, Duration,
  replace(PrimaryA, char(10), char(13, 10)), replace(SecondaryA, char(10), char(13, 10)),
  PrimaryPointsA, SecondaryPointsA,
  replace(PrimaryB, char(10), char(13, 10)), replace(SecondaryB, char(10), char(13, 10)),
  PrimaryPointsB, SecondaryPointsB,
  replace(PrimaryC, char(10), char(13, 10)), replace(SecondaryC, char(10), char(13, 10)),
  PrimaryPointsC, SecondaryPointsC,
  Ratio
FROM Lines;

COMMIT;
