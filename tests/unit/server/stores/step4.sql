-- What made a store of version 3 one of version 4, word for word, and something in it.
ALTER TABLE person ADD COLUMN identity BLOB NOT NULL DEFAULT x'';
UPDATE person SET identity = randomblob(16);
ALTER TABLE person ADD COLUMN looks_retention INTEGER NOT NULL DEFAULT 2592000;
ALTER TABLE device ADD COLUMN suspended INTEGER NOT NULL DEFAULT 0;
CREATE TABLE forgotten (hash BLOB NOT NULL PRIMARY KEY, made INTEGER NOT NULL) STRICT, WITHOUT ROWID;
PRAGMA user_version = 4;
UPDATE person SET looks_retention = 86400 WHERE id = 1;
INSERT INTO forgotten VALUES (x'04', 1763750000);
