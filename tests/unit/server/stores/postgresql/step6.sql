-- What made a store of version 5 one of version 6 on a server, word for word, and something in it.
ALTER TABLE share ADD COLUMN fences BIGINT NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN events BIGINT NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN holds_events BIGINT NOT NULL DEFAULT 0;
CREATE TABLE fence (
    id BIGINT NOT NULL PRIMARY KEY, watcher BIGINT NOT NULL REFERENCES person ON DELETE CASCADE,
    subject BIGINT NOT NULL REFERENCES person ON DELETE CASCADE, name TEXT COLLATE "C" NOT NULL, label TEXT COLLATE "C" NOT NULL,
    latitude DOUBLE PRECISION NOT NULL, longitude DOUBLE PRECISION NOT NULL, radius DOUBLE PRECISION NOT NULL, arrives BIGINT NOT NULL,
    once BIGINT NOT NULL, made BIGINT NOT NULL, side BIGINT NOT NULL DEFAULT 0,
    candidate BIGINT NOT NULL DEFAULT 0, candidate_since BIGINT NOT NULL DEFAULT 0, last BIGINT,
    doubtful BIGINT);
CREATE INDEX fence_subject ON fence (subject, watcher);
CREATE INDEX fence_watcher ON fence (watcher);
CREATE TABLE outbox (
    device BIGINT NOT NULL REFERENCES device ON DELETE CASCADE, number BIGINT NOT NULL,
    watcher BIGINT NOT NULL REFERENCES person ON DELETE CASCADE,
    subject BIGINT NOT NULL REFERENCES person ON DELETE CASCADE, name TEXT COLLATE "C" NOT NULL, label TEXT COLLATE "C" NOT NULL,
    latitude DOUBLE PRECISION NOT NULL, longitude DOUBLE PRECISION NOT NULL, radius DOUBLE PRECISION NOT NULL, arrives BIGINT NOT NULL,
    time BIGINT NOT NULL, made BIGINT NOT NULL, until BIGINT NOT NULL, post BIGINT NOT NULL DEFAULT 0,
    PRIMARY KEY (device, number));
CREATE INDEX outbox_subject ON outbox (subject, watcher);
CREATE INDEX outbox_watcher ON outbox (watcher);
CREATE INDEX outbox_until ON outbox (until);
UPDATE ktr_store SET version = 6;
UPDATE share SET fences = 1, exactness = 0;
INSERT INTO fence (id, watcher, subject, name, label, latitude, longitude, radius, arrives, once, made)
    VALUES (6, 2, 1, 'work', 'work', 50.25, -3.5, 200.0, 1, 0, 1763750000);
