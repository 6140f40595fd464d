-- What made a store of version 8 one of version 9 on a server, word for word, and something in it.
CREATE TABLE ask (
    asker BIGINT NOT NULL REFERENCES person ON DELETE CASCADE, handle TEXT COLLATE "C" NOT NULL, time BIGINT NOT NULL,
    answered BIGINT NOT NULL DEFAULT 0, PRIMARY KEY (asker, handle));
CREATE INDEX ask_handle ON ask (handle);
UPDATE ktr_store SET version = 9;
INSERT INTO person (id, name, retention, made, identity) VALUES (3, 'mara', 172800, 1763750000, '\x09');
INSERT INTO ask (asker, handle, time) VALUES (3, 'ann@x.example', 1763750000);
