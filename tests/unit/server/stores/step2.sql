-- What made a store of version 1 one of version 2, word for word, and something in it.
CREATE TABLE sign_in (
    link BLOB NOT NULL PRIMARY KEY, person INTEGER NOT NULL REFERENCES person ON DELETE CASCADE,
    until INTEGER NOT NULL) STRICT, WITHOUT ROWID;
CREATE INDEX sign_in_person ON sign_in (person);
CREATE TABLE browser (
    id INTEGER NOT NULL PRIMARY KEY, session BLOB NOT NULL UNIQUE,
    person INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, made INTEGER NOT NULL,
    until INTEGER NOT NULL) STRICT;
CREATE INDEX browser_person ON browser (person);
PRAGMA user_version = 2;
INSERT INTO browser VALUES (7, x'07', 1, 1763750000, 1766342000);
