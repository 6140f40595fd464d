#include "linux/contacts/VCardReader.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <mutex>
#include <string_view>
#include <system_error>
#include <utility>

#include <QBuffer>
#include <QByteArray>
#include <QImage>
#include <QImageReader>

#include "linux/device/LoadableModule.h"
#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kModuleFile = "libktr-contacts.so";
/// Pictures up to this are their own thumbnails; bytes.
constexpr std::size_t kLargestThumbnail = std::size_t{512} << 10;
/// The longer side of a thumbnail that had to be made; pixels.
constexpr int kThumbnailSide = 512;

struct Module {
    VCardModuleEntry read = nullptr;
    std::string error;
};

const Module& module() {
    static const Module loaded = [] {
        Module made;
        made.read =
            reinterpret_cast<VCardModuleEntry>(LoadableModule::entry(kModuleFile, kVCardModuleEntry, made.error));
        return made;
    }();
    return loaded;
}

struct Line {
    std::string_view text;  ///< without its end
    std::size_t end = 0;    ///< where the next one begins
};

Line lineAt(std::string_view text, std::size_t begin) {
    const auto end = text.find_first_of("\r\n", begin);
    if (end == std::string_view::npos) {
        return {text.substr(begin), text.size()};
    }
    const bool both = text[end] == '\r' && end + 1 < text.size() && text[end + 1] == '\n';
    return {text.substr(begin, end - begin), end + (both ? 2 : 1)};
}

std::string_view trimmed(std::string_view text) {
    const auto begin = text.find_first_not_of(" \t");
    return begin == std::string_view::npos ? std::string_view()
                                           : text.substr(begin, text.find_last_not_of(" \t") - begin + 1);
}

/// Whether a line is this one, whatever the case. A folded line (which begins with a blank) never is.
bool isLine(std::string_view line, std::string_view wanted) {
    return !line.empty() && line.front() != ' ' && line.front() != '\t' &&
           platform::asciiLowercased(trimmed(line)) == wanted;
}

/// A picture too large to be kept for each row is made smaller; one that cannot be read gives none.
std::optional<platform::Bytes> thumbnailOf(const platform::Bytes& image) {
    if (image.size() <= kLargestThumbnail) {
        return image;
    }
    QByteArray data =
        QByteArray::fromRawData(reinterpret_cast<const char*>(image.data()), static_cast<qsizetype>(image.size()));
    QBuffer source(&data);
    source.open(QIODevice::ReadOnly);
    QImageReader reader(&source);
    reader.setAutoTransform(true);
    if (const QSize size = reader.size(); size.width() > kThumbnailSide || size.height() > kThumbnailSide) {
        reader.setScaledSize(size.scaled(kThumbnailSide, kThumbnailSide, Qt::KeepAspectRatio));
    }
    QImage picture = reader.read();
    if (picture.isNull()) {
        return std::nullopt;
    }
    if (picture.width() > kThumbnailSide || picture.height() > kThumbnailSide) {
        picture = picture.scaled(kThumbnailSide, kThumbnailSide, Qt::KeepAspectRatio, Qt::SmoothTransformation);
    }
    QByteArray out;
    QBuffer target(&out);
    target.open(QIODevice::WriteOnly);
    if (!picture.save(&target, picture.hasAlphaChannel() ? "PNG" : "JPG", picture.hasAlphaChannel() ? -1 : 88)) {
        return std::nullopt;
    }
    return platform::Bytes(out.begin(), out.end());
}

}  // namespace

VCardReader::Result VCardReader::read(const std::filesystem::path& path) const {
    Result result;
    std::error_code failed;
    if (!std::filesystem::exists(path, failed)) {
        result.error = path.string() + ": no such file or folder";
        return result;
    }
    if (!module().read) {
        result.error = "contacts cannot be read: " + module().error;
        return result;
    }
    if (!std::filesystem::is_directory(path, failed)) {
        readFile(path, result);
        if (result.contacts.empty() && !result.problems.empty() && result.problems.front().line == 0) {
            result.error = path.string() + ": " + result.problems.front().message;
            result.problems.clear();
        }
        return result;
    }
    std::vector<std::filesystem::path> files;
    for (std::filesystem::directory_iterator entry(path, failed), end; !failed && entry != end;
         entry.increment(failed)) {
        std::error_code ignored;
        if (platform::asciiLowercased(entry->path().extension().string()) == ".vcf" && !entry->is_directory(ignored)) {
            files.push_back(entry->path());
        }
    }
    if (failed) {
        result.error = path.string() + ": " + failed.message();
        return result;
    }
    std::sort(files.begin(), files.end());
    for (const auto& file : files) {
        readFile(file, result);
    }
    return result;
}

VCardReader::Result VCardReader::readText(const std::string& text, const std::filesystem::path& file) const {
    Result result;
    if (!module().read) {
        result.error = "contacts cannot be read: " + module().error;
        return result;
    }
    readCards(text, file, result);
    return result;
}

void VCardReader::readFile(const std::filesystem::path& file, Result& result) const {
    std::error_code failed;
    const auto size = std::filesystem::file_size(file, failed);
    if (!failed && size > kLargestFile) {
        result.problems.push_back({file, 0, "the file is larger than 256 MiB"});
        return;
    }
    std::ifstream stream(file, std::ios::binary);
    if (failed || !stream) {
        result.problems.push_back({file, 0, failed ? failed.message() : "the file cannot be opened"});
        return;
    }
    readCards(std::string(std::istreambuf_iterator<char>(stream), {}), file, result);
}

void VCardReader::readCards(const std::string& text, const std::filesystem::path& file, Result& result) const {
    const auto problem = [&](std::size_t line, const char* message) {
        result.problems.push_back({file, line, message});
    };
    constexpr std::string_view kByteOrderMark = "\xef\xbb\xbf";
    std::size_t at =
        std::string_view(text).substr(0, kByteOrderMark.size()) == kByteOrderMark ? kByteOrderMark.size() : 0;
    std::size_t number = 0;    // of the line under way
    std::size_t cardLine = 0;  // 0: outside a card
    std::size_t cardBegin = 0;
    bool strayTold = false;
    while (at < text.size()) {
        const Line line = lineAt(text, at);
        ++number;
        if (isLine(line.text, "begin:vcard")) {
            if (cardLine != 0) {
                problem(cardLine, "the card has no END:VCARD");
            }
            cardLine = number;
            cardBegin = at;
        } else if (cardLine == 0 && !trimmed(line.text).empty() && !strayTold) {
            strayTold = true;
            problem(number, "text outside a card");
        } else if (cardLine != 0 && isLine(line.text, "end:vcard")) {
            auto contact = std::make_shared<platform::Contact>();
            if (line.end - cardBegin > kLargestCard) {
                problem(cardLine, "the card is larger than 16 MiB");
            } else if (!module().read(platform::sanitizedUtf8(text.substr(cardBegin, line.end - cardBegin)),
                                      *contact)) {
                problem(cardLine, "the card holds neither a name nor an address nor a number");
            } else {
                if (contact->imageData) {
                    contact->thumbnailImageData = thumbnailOf(*contact->imageData);
                }
                result.contacts.push_back(std::move(contact));
            }
            cardLine = 0;
            strayTold = false;
        }
        at = line.end;
    }
    if (cardLine != 0) {
        problem(cardLine, "the card has no END:VCARD");
    }
}

}  // namespace ktr::linux_
