#include "linux/contacts/VCardReader.h"

#include <algorithm>
#include <system_error>
#include <utility>
#include <variant>

#include <QBuffer>
#include <QByteArray>
#include <QImage>

#include "documents/ComputingTime.h"
#include "documents/FileReader.h"
#include "linux/device/LoadableModule.h"
#include "linux/paint/ImageDecoder.h"
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

/// A picture as a file again.
std::optional<platform::Bytes> encoded(const QImage& picture) {
    QByteArray out;
    QBuffer target(&out);
    target.open(QIODevice::WriteOnly);
    if (!picture.save(&target, picture.hasAlphaChannel() ? "PNG" : "JPG", picture.hasAlphaChannel() ? -1 : 88)) {
        return std::nullopt;
    }
    return platform::Bytes(out.begin(), out.end());
}

}  // namespace

/// One reading, of a text or of many files.
class VCardReader::Reading {
  public:
    Result result;

    void readFile(const std::filesystem::path& file) {
        const auto read = documents::FileReader::read(file, {kLargestFile, {}});
        if (const auto* error = std::get_if<documents::FileReader::Error>(&read)) {
            problem({file, 0, error->reason});
            return;
        }
        const auto& text = std::get<std::string>(read);
        bytesRead_ += text.size();
        if (bytesRead_ > kMostBytes) {
            problem({file, 0, "the contacts are larger than 512 MiB in all"});
            return;
        }
        readCards(text, file);
    }

    void readCards(const std::string& text, const std::filesystem::path& file) {
        const VCardText found = VCardText::of(text);
        std::vector<Problem> problems;
        for (const auto& known : found.problems) {
            problems.push_back({file, known.line, known.message});
        }
        for (const VCardText::Card& card : found.cards) {
            if (result.contacts.size() == kMostContacts) {
                problems.push_back({file, card.line, "there are more than 100000 contacts"});
                break;
            }
            auto contact = std::make_shared<platform::Contact>();
            if (!module().read(platform::sanitizedUtf8(VCardText::essential(card.text)), *contact)) {
                problems.push_back({file, card.line, "the card holds neither a name nor an address nor a number"});
                continue;
            }
            if (contact->imageData) {
                contact->thumbnailImageData = thumbnailOf(*contact->imageData);
            }
            result.contacts.push_back(std::move(contact));
        }
        std::stable_sort(problems.begin(), problems.end(),
                         [](const Problem& a, const Problem& b) { return a.line < b.line; });
        for (auto& one : problems) {
            problem(std::move(one));
        }
    }

  private:
    void problem(Problem one) {
        if (result.problems.size() < VCardText::kMostProblems) {
            result.problems.push_back(std::move(one));
        }
    }

    /// A picture too large to be kept for each row is made smaller; one that cannot be read gives none.
    std::optional<platform::Bytes> thumbnailOf(const platform::Bytes& image) {
        if (image.size() <= kLargestThumbnail) {
            return image;
        }
        const auto before = documents::computingTime();
        const auto decoded = ImageDecoder::decode(
            image, kThumbnailSide, std::min<std::chrono::nanoseconds>(timeLeft_, ImageDecoder::kMostTime));
        auto thumbnail = decoded ? encoded(decoded->pixels) : std::nullopt;
        timeLeft_ -= documents::computingTime() - before;
        return thumbnail;
    }

    std::chrono::nanoseconds timeLeft_ = kThumbnailTime;
    std::uintmax_t bytesRead_ = 0;
};

bool VCardReader::isCardFile(const std::filesystem::path& file) {
    return platform::asciiLowercased(file.extension().string()) == ".vcf";
}

VCardReader::Result VCardReader::read(const std::filesystem::path& path) const {
    Reading reading;
    Result& result = reading.result;
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
        reading.readFile(path);
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
        if (isCardFile(entry->path()) && !entry->is_directory(ignored)) {
            files.push_back(entry->path());
        }
    }
    if (failed) {
        result.error = path.string() + ": " + failed.message();
        return result;
    }
    std::sort(files.begin(), files.end());
    for (const auto& file : files) {
        reading.readFile(file);
    }
    return result;
}

VCardReader::Result VCardReader::readText(const std::string& text, const std::filesystem::path& file) const {
    Reading reading;
    if (!module().read) {
        reading.result.error = "contacts cannot be read: " + module().error;
    } else {
        reading.readCards(text, file);
    }
    return std::move(reading.result);
}

}  // namespace ktr::linux_
