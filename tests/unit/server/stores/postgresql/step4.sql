-- What made a store of version 3 one of version 4 on a server, word for word, and something in it.
ALTER TABLE person ADD COLUMN identity BYTEA NOT NULL DEFAULT '';
UPDATE person SET identity = uuid_send(gen_random_uuid());
ALTER TABLE person ADD COLUMN looks_retention BIGINT NOT NULL DEFAULT 2592000;
ALTER TABLE device ADD COLUMN suspended BIGINT NOT NULL DEFAULT 0;
CREATE TABLE forgotten (hash BYTEA NOT NULL PRIMARY KEY, made BIGINT NOT NULL);
UPDATE ktr_store SET version = 4;
UPDATE person SET looks_retention = 86400 WHERE id = 1;
INSERT INTO forgotten VALUES ('\x04', 1763750000);
