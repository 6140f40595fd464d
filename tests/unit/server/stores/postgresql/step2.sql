-- What made a store of version 1 one of version 2 on a server, word for word, and something in it.
CREATE TABLE sign_in (
    link BYTEA NOT NULL PRIMARY KEY, person BIGINT NOT NULL REFERENCES person ON DELETE CASCADE,
    until BIGINT NOT NULL);
CREATE INDEX sign_in_person ON sign_in (person);
CREATE TABLE browser (
    id BIGINT NOT NULL PRIMARY KEY, session BYTEA NOT NULL UNIQUE,
    person BIGINT NOT NULL REFERENCES person ON DELETE CASCADE, made BIGINT NOT NULL,
    until BIGINT NOT NULL);
CREATE INDEX browser_person ON browser (person);
UPDATE ktr_store SET version = 2;
INSERT INTO browser VALUES (7, '\x07', 1, 1763750000, 1766342000);
