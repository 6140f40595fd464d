#include "server/page/Html.h"

#include "platform/base/Utf8.h"

namespace ktr::server {

std::string Html::escaped(std::string_view text) {
    std::string out;
    for (const char letter : platform::sanitizedUtf8(text)) {
        switch (letter) {
            case '&':
                out += "&amp;";
                break;
            case '<':
                out += "&lt;";
                break;
            case '>':
                out += "&gt;";
                break;
            case '"':
                out += "&quot;";
                break;
            case '\'':
                out += "&#39;";
                break;
            default: {
                const auto byte = static_cast<unsigned char>(letter);
                out += byte < 0x20 || byte == 0x7F ? ' ' : letter;
            }
        }
    }
    return out;
}

void Html::begin(const char* tag, const Attributes& attributes) {
    out_ += '<';
    out_ += tag;
    for (const auto& [name, value] : attributes) {
        out_ += ' ';
        out_ += name;
        if (!value.empty()) {
            out_ += "=\"" + escaped(value) + '"';
        }
    }
    out_ += '>';
}

Html& Html::open(const char* tag, const Attributes& attributes) {
    begin(tag, attributes);
    open_.push_back(tag);
    return *this;
}

Html& Html::close() {
    out_ += "</";
    out_ += open_.back();
    out_ += '>';
    open_.pop_back();
    return *this;
}

Html& Html::text(std::string_view text) {
    out_ += escaped(text);
    return *this;
}

Html& Html::leaf(const char* tag, const Attributes& attributes, std::string_view content) {
    return open(tag, attributes).text(content).close();
}

Html& Html::single(const char* tag, const Attributes& attributes) {
    begin(tag, attributes);
    return *this;
}

Html& Html::markup(std::string_view trusted) {
    out_ += trusted;
    return *this;
}

std::string Html::take() {
    while (!open_.empty()) {
        close();
    }
    return std::exchange(out_, {});
}

}  // namespace ktr::server
