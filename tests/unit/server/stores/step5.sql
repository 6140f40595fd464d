-- What made a store of version 4 one of version 5, word for word, and something in it.
CREATE TABLE face (
    person INTEGER NOT NULL PRIMARY KEY REFERENCES person ON DELETE CASCADE, picture BLOB NOT NULL,
    hash BLOB NOT NULL) STRICT, WITHOUT ROWID;
CREATE TABLE card (
    device INTEGER NOT NULL REFERENCES device ON DELETE CASCADE,
    owner INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, hash BLOB NOT NULL, sent INTEGER NOT NULL,
    post INTEGER NOT NULL, PRIMARY KEY (device, owner)) STRICT, WITHOUT ROWID;
CREATE INDEX card_owner ON card (owner);
PRAGMA user_version = 5;
INSERT INTO face VALUES (1, x'ffd8', x'05');
INSERT INTO card VALUES (1, 1, x'05', 1763750000, 0);
