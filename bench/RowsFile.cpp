#include "bench/RowsFile.h"

#include <simdjson.h>

#include <cstdio>

namespace ktr::bench {

namespace {

std::string textOf(const simdjson::dom::element& object, const char* key) {
    return std::string(std::string_view(object[key]));
}

RowTexts textsOf(const simdjson::dom::element& object) {
    return {textOf(object, "name"), textOf(object, "locality"), textOf(object, "distance"), textOf(object, "age")};
}

RowsFile parsed(const std::string& path) {
    simdjson::dom::parser parser;
    const simdjson::dom::element root = parser.load(path);
    RowsFile file;
    file.width = double(root["width"]);
    file.scale = double(root["scale"]);
    for (const simdjson::dom::element friend_ : simdjson::dom::array(root["friends"])) {
        RowData row;
        row.now = textsOf(friend_);
        row.next = textsOf(friend_["next"]);
        row.initials = textOf(friend_, "initials");
        row.color = textOf(friend_, "color");
        file.friends.push_back(std::move(row));
    }
    return file;
}

}  // namespace

std::optional<RowsFile> readRowsFile(const std::string& path) {
    try {
        return parsed(path);
    } catch (const simdjson::simdjson_error& error) {
        std::fprintf(stderr, "%s: not a rows file: %s\n", path.c_str(), error.what());
        return std::nullopt;
    }
}

}  // namespace ktr::bench
