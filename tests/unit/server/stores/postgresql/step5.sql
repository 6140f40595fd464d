-- What made a store of version 4 one of version 5 on a server, word for word, and something in it.
CREATE TABLE face (
    person BIGINT NOT NULL PRIMARY KEY REFERENCES person ON DELETE CASCADE, picture BYTEA NOT NULL,
    hash BYTEA NOT NULL);
CREATE TABLE card (
    device BIGINT NOT NULL REFERENCES device ON DELETE CASCADE,
    owner BIGINT NOT NULL REFERENCES person ON DELETE CASCADE, hash BYTEA NOT NULL, sent BIGINT NOT NULL,
    post BIGINT NOT NULL, PRIMARY KEY (device, owner));
CREATE INDEX card_owner ON card (owner);
UPDATE ktr_store SET version = 5;
INSERT INTO face VALUES (1, '\xffd8', '\x05');
INSERT INTO card VALUES (1, 1, '\x05', 1763750000, 0);
