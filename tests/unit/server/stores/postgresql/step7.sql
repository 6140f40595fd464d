-- What made a store of version 6 one of version 7 on a server, word for word, and something in it.
ALTER TABLE person ADD COLUMN heard_late BIGINT NOT NULL DEFAULT 0;
ALTER TABLE device DROP COLUMN cards_sent;
UPDATE ktr_store SET version = 7;
UPDATE person SET heard_late = 1763750000 WHERE id = 1;
