#include "server/store/Migrations.h"

#include <array>

namespace ktr::server {

namespace {

constexpr std::array kSteps = {
    // 1: people with their handles, phones and readers; fixes; grants; who looked; the latest time seen.
    R"(
CREATE TABLE person (
    id {integer} NOT NULL PRIMARY KEY, name {text} NOT NULL UNIQUE, hidden {integer} NOT NULL DEFAULT 0,
    shown_since {integer} NOT NULL DEFAULT 0, retention {integer} NOT NULL, made {integer} NOT NULL) {strict};
CREATE TABLE handle (
    text {text} NOT NULL PRIMARY KEY, shown {text} NOT NULL, place {integer} NOT NULL,
    person {integer} NOT NULL REFERENCES person ON DELETE CASCADE) {strict by key};
CREATE INDEX handle_person ON handle (person, place);
CREATE TABLE device (
    id {integer} NOT NULL PRIMARY KEY, person {integer} NOT NULL REFERENCES person ON DELETE CASCADE,
    kind {integer} NOT NULL, secret {bytes} NOT NULL UNIQUE, key {text} NOT NULL DEFAULT '', heard {integer},
    revoked {integer}, made {integer} NOT NULL, cards_sent {bytes} NOT NULL DEFAULT {no bytes}) {strict};
CREATE INDEX device_person ON device (person);
CREATE TABLE fix (
    person {integer} NOT NULL REFERENCES person ON DELETE CASCADE, time {integer} NOT NULL, heard {integer} NOT NULL,
    latitude {real} NOT NULL, longitude {real} NOT NULL, accuracy {real}, PRIMARY KEY (person, time)) {strict by key};
CREATE TABLE share (
    viewer {integer} NOT NULL REFERENCES person ON DELETE CASCADE,
    owner {integer} NOT NULL REFERENCES person ON DELETE CASCADE, exactness {integer} NOT NULL,
    since {integer} NOT NULL, until {integer}, PRIMARY KEY (viewer, owner)) {strict by key};
CREATE INDEX share_owner ON share (owner);
CREATE TABLE viewed (
    owner {integer} NOT NULL REFERENCES person ON DELETE CASCADE, hour {integer} NOT NULL,
    viewer {integer} NOT NULL REFERENCES person ON DELETE CASCADE, asked {integer} NOT NULL,
    PRIMARY KEY (owner, hour, viewer)) {strict by key};
CREATE TABLE clock (id {integer} NOT NULL PRIMARY KEY CHECK (id = 1), latest {integer} NOT NULL) {strict};
INSERT INTO clock VALUES (1, 0);
)",
    // 2: links that sign in, browsers that are signed in.
    R"(
CREATE TABLE sign_in (
    link {bytes} NOT NULL PRIMARY KEY, person {integer} NOT NULL REFERENCES person ON DELETE CASCADE,
    until {integer} NOT NULL) {strict by key};
CREATE INDEX sign_in_person ON sign_in (person);
CREATE TABLE browser (
    id {integer} NOT NULL PRIMARY KEY, session {bytes} NOT NULL UNIQUE,
    person {integer} NOT NULL REFERENCES person ON DELETE CASCADE, made {integer} NOT NULL,
    until {integer} NOT NULL) {strict};
CREATE INDEX browser_person ON browser (person);
)",
    // 3: named places; grants that end on arrival, may be said aloud, are confirmed; zones; wishes to share by device.
    R"(
ALTER TABLE person ADD COLUMN zone {text} NOT NULL DEFAULT '';
ALTER TABLE device ADD COLUMN shared {integer} NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN asked_to_share {integer} NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN arrival {integer} NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN aloud {integer} NOT NULL DEFAULT 0;
ALTER TABLE share ADD COLUMN confirmed {integer};
CREATE TABLE place (
    id {integer} NOT NULL PRIMARY KEY, owner {integer} NOT NULL REFERENCES person ON DELETE CASCADE,
    name {text} NOT NULL, label {text} NOT NULL, latitude {real} NOT NULL, longitude {real} NOT NULL,
    radius {real} NOT NULL, said {integer} NOT NULL, UNIQUE (owner, name)) {strict};
)",
    // 4: what tells somebody who was forgotten from everybody else; readers that wait for their person's word; how long
    // looks are kept.
    R"(
ALTER TABLE person ADD COLUMN identity {bytes} NOT NULL DEFAULT {no bytes};
UPDATE person SET identity = {random bytes};
ALTER TABLE person ADD COLUMN looks_retention {integer} NOT NULL DEFAULT 2592000;
ALTER TABLE device ADD COLUMN suspended {integer} NOT NULL DEFAULT 0;
CREATE TABLE forgotten (hash {bytes} NOT NULL PRIMARY KEY, made {integer} NOT NULL) {strict by key};
)",
    // 5: faces; which card each phone was told last of each friend.
    R"(
CREATE TABLE face (
    person {integer} NOT NULL PRIMARY KEY REFERENCES person ON DELETE CASCADE, picture {bytes} NOT NULL,
    hash {bytes} NOT NULL) {strict by key};
CREATE TABLE card (
    device {integer} NOT NULL REFERENCES device ON DELETE CASCADE,
    owner {integer} NOT NULL REFERENCES person ON DELETE CASCADE, hash {bytes} NOT NULL, sent {integer} NOT NULL,
    post {integer} NOT NULL, PRIMARY KEY (device, owner)) {strict by key};
CREATE INDEX card_owner ON card (owner);
)",
    // 6: fences, with whose leave; what is to be told to which device, in the order of its own count. A fence remembers
    // times of fixes alone: where they were goes with the fixes. `post`: of the phone's post that was told of it last.
    R"(
ALTER TABLE share ADD COLUMN fences {integer} NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN events {integer} NOT NULL DEFAULT 0;
ALTER TABLE device ADD COLUMN holds_events {integer} NOT NULL DEFAULT 0;
CREATE TABLE fence (
    id {integer} NOT NULL PRIMARY KEY, watcher {integer} NOT NULL REFERENCES person ON DELETE CASCADE,
    subject {integer} NOT NULL REFERENCES person ON DELETE CASCADE, name {text} NOT NULL, label {text} NOT NULL,
    latitude {real} NOT NULL, longitude {real} NOT NULL, radius {real} NOT NULL, arrives {integer} NOT NULL,
    once {integer} NOT NULL, made {integer} NOT NULL, side {integer} NOT NULL DEFAULT 0,
    candidate {integer} NOT NULL DEFAULT 0, candidate_since {integer} NOT NULL DEFAULT 0, last {integer},
    doubtful {integer}) {strict};
CREATE INDEX fence_subject ON fence (subject, watcher);
CREATE INDEX fence_watcher ON fence (watcher);
CREATE TABLE outbox (
    device {integer} NOT NULL REFERENCES device ON DELETE CASCADE, number {integer} NOT NULL,
    watcher {integer} NOT NULL REFERENCES person ON DELETE CASCADE,
    subject {integer} NOT NULL REFERENCES person ON DELETE CASCADE, name {text} NOT NULL, label {text} NOT NULL,
    latitude {real} NOT NULL, longitude {real} NOT NULL, radius {real} NOT NULL, arrives {integer} NOT NULL,
    time {integer} NOT NULL, made {integer} NOT NULL, until {integer} NOT NULL, post {integer} NOT NULL DEFAULT 0,
    PRIMARY KEY (device, number)) {strict by key};
CREATE INDEX outbox_subject ON outbox (subject, watcher);
CREATE INDEX outbox_watcher ON outbox (watcher);
CREATE INDEX outbox_until ON outbox (until);
)",
    // 7: when a fix was last heard that belongs to an earlier slot; what is read no more goes.
    R"(
ALTER TABLE person ADD COLUMN heard_late {integer} NOT NULL DEFAULT 0;
ALTER TABLE device DROP COLUMN cards_sent;
)",
    // 8: who wants a newer fix of whom; by handle, since it is the same of somebody whom nobody knows. `told`: when a
    // phone
    // was told last.
    R"(
CREATE TABLE fix_wish (
    handle {text} NOT NULL, viewer {integer} NOT NULL REFERENCES person ON DELETE CASCADE, since {integer} NOT NULL,
    told {integer} NOT NULL DEFAULT 0, PRIMARY KEY (handle, viewer)) {strict by key};
CREATE INDEX fix_wish_viewer ON fix_wish (viewer);
CREATE INDEX fix_wish_since ON fix_wish (since);
)",
    // 9: who asked whom to share, by the handle that they used: kept alike whether or not anybody has it.
    R"(
CREATE TABLE ask (
    asker {integer} NOT NULL REFERENCES person ON DELETE CASCADE, handle {text} NOT NULL, time {integer} NOT NULL,
    answered {integer} NOT NULL DEFAULT 0, PRIMARY KEY (asker, handle)) {strict by key};
CREATE INDEX ask_handle ON ask (handle);
)",
};

}  // namespace

int Migrations::latest() {
    return static_cast<int>(kSteps.size());
}

std::string Migrations::run(Database& database, bool make) {
    const auto refusal = [&](const std::optional<int>& schema) -> std::string {
        if (!schema) {
            return database.complaint();
        }
        return *schema > latest()      ? "was written by a newer program: use that one"
               : *schema == 0 && !make ? "is empty"
                                       : "";
    };
    database.clear();
    auto schema = database.schema();
    if (std::string refused = refusal(schema); !refused.empty() || *schema == latest()) {
        return refused;
    }
    if (!database.begin()) {
        return database.complaint();
    }
    database.lockSchema();
    // Another process may have been here first.
    schema = database.schema();
    std::string complaint = refusal(schema);
    for (int step = schema.value_or(latest()); complaint.empty() && step < latest(); ++step) {
        database.execute(kSteps[static_cast<std::size_t>(step)]);
        database.setSchema(step + 1);
        complaint = database.complaint();
    }
    if (complaint.empty() && !database.commit()) {
        complaint = database.complaint();
    }
    if (!complaint.empty()) {
        database.rollback();
    }
    return complaint;
}

}  // namespace ktr::server
