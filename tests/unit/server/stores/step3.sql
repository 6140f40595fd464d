-- What made a store of version 2 one of version 3, word for word, and something in it.
ALTER TABLE person ADD COLUMN zone TEXT NOT NULL DEFAULT '';
ALTER TABLE device ADD COLUMN shared INTEGER NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN asked_to_share INTEGER NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN arrival INTEGER NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN aloud INTEGER NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN confirmed INTEGER;
CREATE TABLE place (
    id INTEGER NOT NULL PRIMARY KEY, owner INTEGER NOT NULL REFERENCES person ON DELETE CASCADE,
    name TEXT NOT NULL, label TEXT NOT NULL, latitude REAL NOT NULL, longitude REAL NOT NULL,
    radius REAL NOT NULL, said INTEGER NOT NULL, UNIQUE (owner, name)) STRICT;
PRAGMA user_version = 3;
UPDATE person SET zone = 'Europe/Berlin' WHERE id = 1;
INSERT INTO place VALUES (3, 1, 'work', 'work', 50.25, -3.5, 200.0, 1);
UPDATE share SET arrival = 3, aloud = 1, confirmed = 1763740000;
