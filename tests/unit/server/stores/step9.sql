-- What made a store of version 8 one of version 9, word for word, and something in it.
CREATE TABLE ask (
    asker INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, handle TEXT NOT NULL, time INTEGER NOT NULL,
    answered INTEGER NOT NULL DEFAULT 0, PRIMARY KEY (asker, handle)) STRICT, WITHOUT ROWID;
CREATE INDEX ask_handle ON ask (handle);
PRAGMA user_version = 9;
INSERT INTO person (id, name, retention, made, identity) VALUES (3, 'mara', 172800, 1763750000, x'09');
INSERT INTO ask (asker, handle, time) VALUES (3, 'ann@x.example', 1763750000);
