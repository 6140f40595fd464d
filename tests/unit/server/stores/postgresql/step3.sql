-- What made a store of version 2 one of version 3 on a server, word for word, and something in it.
ALTER TABLE person ADD COLUMN zone TEXT COLLATE "C" NOT NULL DEFAULT '';
ALTER TABLE device ADD COLUMN shared BIGINT NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN asked_to_share BIGINT NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN arrival BIGINT NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN aloud BIGINT NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN confirmed BIGINT;
CREATE TABLE place (
    id BIGINT NOT NULL PRIMARY KEY, owner BIGINT NOT NULL REFERENCES person ON DELETE CASCADE,
    name TEXT COLLATE "C" NOT NULL, label TEXT COLLATE "C" NOT NULL, latitude DOUBLE PRECISION NOT NULL, longitude DOUBLE PRECISION NOT NULL,
    radius DOUBLE PRECISION NOT NULL, said BIGINT NOT NULL, UNIQUE (owner, name));
UPDATE ktr_store SET version = 3;
UPDATE person SET zone = 'Europe/Berlin' WHERE id = 1;
INSERT INTO place VALUES (3, 1, 'work', 'work', 50.25, -3.5, 200.0, 1);
UPDATE share SET arrival = 3, aloud = 1, confirmed = 1763740000;
