#include "linux/paint/TextKey.h"

#include <cmath>
#include <cstring>
#include <limits>
#include <type_traits>

namespace ktr::linux_ {

using platform::AttributedString;
using platform::TextContainer;

namespace {

constexpr unsigned char kEndless = 1;
constexpr unsigned char kOneLine = 2;
constexpr unsigned char kRightToLeft = 4;
/// Padding, hyphenation or exclusions follow.
constexpr unsigned char kUnusual = 8;

constexpr unsigned char kColored = 1;
constexpr unsigned char kStyled = 2;

class Writer {
  public:
    explicit Writer(QByteArray& bytes) : bytes_(bytes) {}

    template <class T>
    void put(const T& value) {
        static_assert(std::is_trivially_copyable_v<T>);
        bytes_.append(reinterpret_cast<const char*>(&value), sizeof value);
    }
    void put(const std::string& text) {
        put(static_cast<std::uint32_t>(text.size()));
        bytes_.append(text.data(), static_cast<qsizetype>(text.size()));
    }

  private:
    QByteArray& bytes_;
};

/// Reads what a Writer wrote, in the same order.
class Reader {
  public:
    explicit Reader(const QByteArray& bytes) : at_(bytes.constData()), end_(at_ + bytes.size()) {}

    bool isAtEnd() const { return at_ == end_; }
    template <class T>
    T get() {
        T value;
        std::memcpy(&value, at_, sizeof value);
        at_ += sizeof value;
        return value;
    }
    std::string getText() {
        const auto size = get<std::uint32_t>();
        at_ += size;
        return {at_ - size, size};
    }

  private:
    const char* at_;
    const char* end_;
};

void putContainer(Writer& writer, const TextContainer& container) {
    const bool isEndless = std::isinf(container.width);
    const bool isUnusual =
        !container.exclusionPaths.empty() || container.lineFragmentPadding != 0.0 || container.hyphenationFactor != 0.0;
    writer.put(static_cast<unsigned char>((isEndless ? kEndless : 0) | (container.maximumLines == 1 ? kOneLine : 0) |
                                          (container.rightToLeft ? kRightToLeft : 0) | (isUnusual ? kUnusual : 0)));
    writer.put(static_cast<unsigned char>(container.lineBreakMode));
    writer.put(static_cast<unsigned char>(container.alignment));
    if (!isEndless) {
        writer.put(container.width);
    }
    if (container.maximumLines != 1) {
        writer.put(container.maximumLines);
    }
    if (isUnusual) {
        writer.put(container.lineFragmentPadding);
        writer.put(container.hyphenationFactor);
        writer.put(static_cast<std::uint32_t>(container.exclusionPaths.size()));
        for (const platform::Rect& path : container.exclusionPaths) {
            writer.put(path);
        }
    }
}

TextContainer readContainer(Reader& reader) {
    TextContainer container;
    const auto flags = reader.get<unsigned char>();
    container.rightToLeft = (flags & kRightToLeft) != 0;
    container.lineBreakMode = static_cast<platform::LineBreakMode>(reader.get<unsigned char>());
    container.alignment = static_cast<platform::TextAlignment>(reader.get<unsigned char>());
    container.width = (flags & kEndless) != 0 ? std::numeric_limits<double>::infinity() : reader.get<double>();
    container.maximumLines = (flags & kOneLine) != 0 ? 1 : reader.get<int>();
    if ((flags & kUnusual) != 0) {
        container.lineFragmentPadding = reader.get<double>();
        container.hyphenationFactor = reader.get<double>();
        for (auto left = reader.get<std::uint32_t>(); left > 0; --left) {
            container.exclusionPaths.push_back(reader.get<platform::Rect>());
        }
    }
    return container;
}

void putRun(Writer& writer, const AttributedString::Run& run) {
    const bool isStyled = !(run.paragraph == platform::ParagraphStyle());
    writer.put(static_cast<unsigned char>((run.color ? kColored : 0) | (isStyled ? kStyled : 0)));
    writer.put(static_cast<unsigned char>(run.font.face));
    writer.put(static_cast<unsigned char>(run.font.weight));
    writer.put(run.font.size);
    if (run.color) {
        for (const double part : {run.color->red, run.color->green, run.color->blue, run.color->alpha}) {
            writer.put(part);
        }
        writer.put(static_cast<unsigned char>(run.color->role));
    }
    if (isStyled) {
        writer.put(static_cast<unsigned char>(run.paragraph.alignment));
        writer.put(static_cast<unsigned char>(run.paragraph.lineBreakMode));
        writer.put(static_cast<unsigned char>(run.paragraph.writingDirection));
    }
    writer.put(run.text);
}

AttributedString::Run readRun(Reader& reader) {
    AttributedString::Run run;
    const auto flags = reader.get<unsigned char>();
    run.font.face = static_cast<platform::FontFace>(reader.get<unsigned char>());
    run.font.weight = static_cast<platform::FontWeight>(reader.get<unsigned char>());
    run.font.size = reader.get<double>();
    if ((flags & kColored) != 0) {
        platform::Color color;
        for (double* part : {&color.red, &color.green, &color.blue, &color.alpha}) {
            *part = reader.get<double>();
        }
        color.role = static_cast<platform::ColorRole>(reader.get<unsigned char>());
        run.color = color;
    }
    if ((flags & kStyled) != 0) {
        run.paragraph.alignment = static_cast<platform::TextAlignment>(reader.get<unsigned char>());
        run.paragraph.lineBreakMode = static_cast<platform::LineBreakMode>(reader.get<unsigned char>());
        run.paragraph.writingDirection = static_cast<platform::WritingDirection>(reader.get<unsigned char>());
    }
    run.text = reader.getText();
    return run;
}

}  // namespace

TextKey::TextKey(const AttributedString& text, const TextContainer& container) {
    constexpr qsizetype kMostOfOneRun = 24;
    qsizetype size = kMostOfOneRun;
    for (const auto& run : text.runs()) {
        size += static_cast<qsizetype>(run.text.size());
    }
    bytes_.reserve(size);
    Writer writer(bytes_);
    putContainer(writer, container);
    for (const auto& run : text.runs()) {
        putRun(writer, run);
    }
}

TextContainer TextKey::container() const {
    Reader reader(bytes_);
    return readContainer(reader);
}

AttributedString TextKey::text() const {
    Reader reader(bytes_);
    readContainer(reader);
    AttributedString text;
    while (!reader.isAtEnd()) {
        text.append(readRun(reader));
    }
    return text;
}

}  // namespace ktr::linux_
