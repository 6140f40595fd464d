// No text of the window is cut: in every language, at every size, however narrow the window is.
#include <QFontMetricsF>
#include <QImage>
#include <array>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <regex>
#include <string>
#include <vector>

#include "app/window/AskField.h"
#include "app/window/StatusLine.h"
#include "host/scenario/ScenarioReader.h"
#include "platform/base/Format.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Label.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using platform::ContentSizeCategory;

constexpr std::array kSizes = {ContentSizeCategory::L, ContentSizeCategory::XXXL, ContentSizeCategory::AX1,
                               ContentSizeCategory::AX5};
/// Of the bar in windows 280, 320, 400 and 900 wide.
constexpr std::array kWidths = {256, 296, 376, 420};

const std::string kTexts = KTR_SOURCE_DIR "/resources/localization/";

/// The languages that there are texts of, and the pseudo-languages.
std::vector<std::string> languages() {
    std::vector<std::string> found = {"qps", "qps-plocm"};
    for (const auto& entry : std::filesystem::directory_iterator(kTexts)) {
        std::smatch parts;
        const std::string name = entry.path().filename().string();
        if (std::regex_match(name, parts, std::regex("host_(.+)\\.ts"))) {
            found.push_back(parts[1]);
        }
    }
    return found;
}

/// The keys of the status line's words.
std::vector<std::string> statusKeys() {
    std::ifstream file(kTexts + "host_en.ts");
    const std::string text{std::istreambuf_iterator<char>(file), {}};
    const std::regex key("<source>(STATUS_[A-Z_]+)</source>");
    std::vector<std::string> found;
    for (std::sregex_iterator it(text.begin(), text.end(), key), end; it != end; ++it) {
        found.push_back((*it)[1]);
    }
    return found;
}

/// Whether anything is painted in the outermost pixels: what is cut goes up to them.
bool touchesItsEdge(const QImage& picture) {
    const QRgb ground = picture.pixel(0, 0);
    for (int y = 0; y < picture.height(); ++y) {
        if (picture.pixel(0, y) != ground || picture.pixel(picture.width() - 1, y) != ground) {
            return true;
        }
    }
    for (int x = 0; x < picture.width(); ++x) {
        if (picture.pixel(x, 0) != ground || picture.pixel(x, picture.height() - 1) != ground) {
            return true;
        }
    }
    return false;
}

}  // namespace

class KTRWindowTextsTest : public ::testing::Test {
  protected:
    void open(const std::string& language, ContentSizeCategory size,
              const std::vector<host::Scenario>& scenarios = {}) {
        host = nullptr;
        host::HostOptions options;
        options.language = language;
        options.textSize = size;
        host = testHost(options, scenarios);
        ASSERT_TRUE(host);
    }
    /// The texts below a view that the room of their labels cuts, but for those that are to give way, as names are.
    void collectCut(const platform::View& view, std::vector<std::string>& cut) const {
        for (const auto& child : view.presentedSubviews()) {
            const auto label = std::dynamic_pointer_cast<platform::Label>(child);
            const auto across = platform::LayoutAxis::Horizontal;
            if (label && !label->hidden() && !label->text().empty() &&
                label->contentCompressionResistancePriority(across) > platform::kDefaultHuggingPriority) {
                platform::TextContainer container;
                container.width = label->frame().width;
                container.maximumLines = label->numberOfLines();
                container.lineBreakMode = label->lineBreakMode();
                const auto layout = host->platform()->textEngine->layOut(
                    platform::AttributedString(label->text(), label->font()), container);
                if (layout->isTruncated() || layout->usedSize().height > label->frame().height + 1.0) {
                    cut.push_back(label->text());
                }
            }
            collectCut(*child, cut);
        }
    }
    Qt::LayoutDirection direction() const { return host->rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight; }

    std::unique_ptr<host::Host> host;
};

TEST_F(KTRWindowTextsTest, StatusLine_TakesTheLinesThatItsWordsNeed) {
    const auto keys = statusKeys();
    ASSERT_GE(keys.size(), 14U);
    for (const std::string& language : languages()) {
        for (const auto size : kSizes) {
            open(language, size);
            StatusLine line;
            line.setLayoutDirection(direction());
            line.refreshFont();
            for (const std::string& key : keys) {
                const std::string words = platform::formatted(host->text(key), {std::string("59")});
                ASSERT_NE(words, key) << language;
                line.setStatus({host::LiveStatus::Mark::None, words});
                for (const int width : kWidths) {
                    line.place({0, 0, width, line.heightForWidth(width)});
                    EXPECT_TRUE(line.isPlaced());
                    EXPECT_FALSE(touchesItsEdge(line.grab().toImage()))
                        << language << ", " << width << " wide, size " << static_cast<int>(size) << ": " << words;
                }
            }
        }
    }
}

TEST_F(KTRWindowTextsTest, StatusLineWithLittleToSay_IsOneLine) {
    open("en-GB", ContentSizeCategory::L);
    StatusLine line;
    line.refreshFont();
    const int nothing = line.heightForWidth(376);
    line.setStatus({host::LiveStatus::Mark::Live, "Live"});
    EXPECT_EQ(line.heightForWidth(376), nothing);
    EXPECT_GT(nothing, 10);
}

TEST_F(KTRWindowTextsTest, Hint_IsSmallEnoughToStandWhole) {
    for (const std::string& language : languages()) {
        for (const auto size : kSizes) {
            open(language, size);
            for (const int width : kWidths) {
                AskField field({host->text("ASK_FIELD"), host->text("ASK_SEND")}, nullptr);
                field.setLayoutDirection(direction());
                field.resize(width + 2 * AskField::kAround, AskField::shapeHeight() + 2 * AskField::kAround);
                field.grab();
                auto& edit = field.edit();
                const QFont font = edit.hintFont();
                EXPECT_LE(QFontMetricsF(font).horizontalAdvance(edit.placeholderText()), edit.width())
                    << language << ", " << width << " wide, size " << static_cast<int>(size);
                EXPECT_GE(font.pixelSize(), 9) << language << " is not read any more at " << width;
                EXPECT_LE(font.pixelSize(), edit.font().pixelSize());
            }
        }
    }
}

TEST_F(KTRWindowTextsTest, HintThatFits_IsAsLargeAsWhatIsTyped) {
    open("en-GB", ContentSizeCategory::L);
    AskField field({host->text("ASK_FIELD"), host->text("ASK_SEND")}, nullptr);
    field.resize(376, 60);
    field.grab();
    EXPECT_EQ(field.edit().hintFont(), field.edit().font());
}

TEST_F(KTRWindowTextsTest, Conversation_CutsNoTextOfItsOwn) {
    int asked = 0;
    for (const auto& entry : std::filesystem::directory_iterator(KTR_SOURCE_DIR "/resources/scenarios")) {
        const std::string name = entry.path().filename().string();
        // Places longer than any row, and a fence's sentence, which has one line however long its place is.
        if (!name.ends_with(".json") || name == "long-names.json" || name.starts_with("fence-")) {
            continue;
        }
        auto read = host::ScenarioReader({0.0}).readFile(entry.path());
        ASSERT_TRUE(std::holds_alternative<host::Scenario>(read));
        const auto& scenario = std::get<host::Scenario>(read);
        for (const char* language : {"qps", "qps-plocm", "el", "hi"}) {
            for (const double width : {320.0, 400.0}) {
                open(language, ContentSizeCategory::L, {scenario});
                host->settle(width);
                std::vector<std::string> cut;
                collectCut(*host->window(), cut);
                for (const std::string& text : cut) {
                    ADD_FAILURE() << name << " in " << language << ", " << width << " wide: " << text;
                }
                ++asked;
            }
        }
    }
    EXPECT_GT(asked, 150);
}

}  // namespace ktr::app
