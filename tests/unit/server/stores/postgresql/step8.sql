-- What made a store of version 7 one of version 8 on a server, word for word, and something in it.
CREATE TABLE fix_wish (
    handle TEXT COLLATE "C" NOT NULL, viewer BIGINT NOT NULL REFERENCES person ON DELETE CASCADE, since BIGINT NOT NULL,
    told BIGINT NOT NULL DEFAULT 0, PRIMARY KEY (handle, viewer));
CREATE INDEX fix_wish_viewer ON fix_wish (viewer);
CREATE INDEX fix_wish_since ON fix_wish (since);
UPDATE ktr_store SET version = 8;
INSERT INTO fix_wish (handle, viewer, since) VALUES ('ann@x.example', 2, 1763750000);
