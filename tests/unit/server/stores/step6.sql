-- What made a store of version 5 one of version 6, word for word, and something in it.
ALTER TABLE share ADD COLUMN fences INTEGER NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN events INTEGER NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN holds_events INTEGER NOT NULL DEFAULT 0;
CREATE TABLE fence (
    id INTEGER NOT NULL PRIMARY KEY, watcher INTEGER NOT NULL REFERENCES person ON DELETE CASCADE,
    subject INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, name TEXT NOT NULL, label TEXT NOT NULL,
    latitude REAL NOT NULL, longitude REAL NOT NULL, radius REAL NOT NULL, arrives INTEGER NOT NULL,
    once INTEGER NOT NULL, made INTEGER NOT NULL, side INTEGER NOT NULL DEFAULT 0,
    candidate INTEGER NOT NULL DEFAULT 0, candidate_since INTEGER NOT NULL DEFAULT 0, last INTEGER,
    doubtful INTEGER) STRICT;
CREATE INDEX fence_subject ON fence (subject, watcher);
CREATE INDEX fence_watcher ON fence (watcher);
CREATE TABLE outbox (
    device INTEGER NOT NULL REFERENCES device ON DELETE CASCADE, number INTEGER NOT NULL,
    watcher INTEGER NOT NULL REFERENCES person ON DELETE CASCADE,
    subject INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, name TEXT NOT NULL, label TEXT NOT NULL,
    latitude REAL NOT NULL, longitude REAL NOT NULL, radius REAL NOT NULL, arrives INTEGER NOT NULL,
    time INTEGER NOT NULL, made INTEGER NOT NULL, until INTEGER NOT NULL, post INTEGER NOT NULL DEFAULT 0,
    PRIMARY KEY (device, number)) STRICT, WITHOUT ROWID;
CREATE INDEX outbox_subject ON outbox (subject, watcher);
CREATE INDEX outbox_watcher ON outbox (watcher);
CREATE INDEX outbox_until ON outbox (until);
PRAGMA user_version = 6;
UPDATE share SET fences = 1, exactness = 0;
INSERT INTO fence (id, watcher, subject, name, label, latitude, longitude, radius, arrives, once, made)
    VALUES (6, 2, 1, 'work', 'work', 50.25, -3.5, 200.0, 1, 0, 1763750000);
