-- What made a store of version 7 one of version 8, word for word, and something in it.
CREATE TABLE fix_wish (
    handle TEXT NOT NULL, viewer INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, since INTEGER NOT NULL,
    told INTEGER NOT NULL DEFAULT 0, PRIMARY KEY (handle, viewer)) STRICT, WITHOUT ROWID;
CREATE INDEX fix_wish_viewer ON fix_wish (viewer);
CREATE INDEX fix_wish_since ON fix_wish (since);
PRAGMA user_version = 8;
INSERT INTO fix_wish (handle, viewer, since) VALUES ('ann@x.example', 2, 1763750000);
