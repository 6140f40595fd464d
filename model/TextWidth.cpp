#include "model/TextWidth.h"

#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"
#include "platform/text/TextEngine.h"

namespace ktr {

namespace {

constexpr std::size_t kDropped = 4;

double widthOf(const std::string& text, const platform::Font& font) {
    return platform::Platform::installed()
        ->textEngine->layOut(platform::AttributedString(text, font), platform::TextContainer{})
        ->usedSize()
        .width;
}

/// Takes the last characters (code points) off the text.
void dropLast(std::string& text, std::size_t count) {
    for (; count > 0 && !text.empty(); --count) {
        while (text.size() > 1 && (static_cast<unsigned char>(text.back()) & 0xC0) == 0x80) {
            text.pop_back();
        }
        text.pop_back();
    }
}

}  // namespace

std::string stringConstrainedToWidth(const std::string& text, double width, const platform::Font& font) {
    std::string shortened = text;
    while (widthOf(shortened, font) > width && platform::utf8Length(shortened) >= kDropped) {
        dropLast(shortened, kDropped);
        shortened += "...";
    }
    // The shortened text is dropped: whoever calls this gets the whole one back, as ever.
    return text;
}

}  // namespace ktr
