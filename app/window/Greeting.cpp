#include "app/window/Greeting.h"

#include <QEvent>
#include <algorithm>

#include "host/conversation/Measures.h"
#include "host/conversation/WideColumns.h"
#include "platform/base/Bundle.h"
#include "platform/base/Platform.h"

namespace ktr::app {

namespace {

constexpr int kIconSide = 40;
constexpr int kTextInset = 27;
constexpr int kGutter = 12;
constexpr int kIconToTitle = 16;
constexpr int kTitleToLine = 4;
constexpr int kToQuestions = 44;
constexpr int kLowToQuestions = 16;
constexpr int kBetweenQuestions = 10;
constexpr int kLeastTop = 60;
constexpr double kMiddle = 0.45;  ///< of the height, where the block's own middle stands
constexpr int kLow = 420;         ///< no icon and no line below it
constexpr int kVeryLow = 300;     ///< two questions at most
constexpr int kNoon = 12;
constexpr int kEvening = 18;

}  // namespace

Greeting::Greeting(const host::Host& host, QWidget* parent)
    : Block(parent),
      host_(host),
      icon_(new Picture(kIconSide, this)),
      title_(new Words(BlockStyle::Title, Words::Tone::Ink, this)),
      line_(new Words(BlockStyle::Body, Words::Tone::Soft, this)),
      flow_(new Flow(kBetweenQuestions, this)) {
    line_->setBalanced(true);
    flow_->setAtEnd(true);
}

QString Greeting::text(const char* key) const {
    return QString::fromStdString(host_.text(key));
}

void Greeting::setHour(int hour) {
    hour_ = hour;
    title_->setText(text(hour < kNoon      ? "GREETING_MORNING"
                         : hour < kEvening ? "GREETING_AFTERNOON"
                                           : "GREETING_EVENING"));
}

void Greeting::refreshed() {
    icon_->setImage(std::dynamic_pointer_cast<const linux_::QtImage>(
        host_.platform()->images->imageNamed("appIcon_dyn", platform::kSnippetsBundle)));
    setHour(hour_);
    line_->setText(text("GREETING_LINE"));
    flow_->clear();
    questions_.clear();
    for (const char* key : {"SUGGEST_FRIENDS", "SUGGEST_NEAR", "SUGGEST_HIDE"}) {
        auto* question = new UnaskedQuestion(text(key));
        question->setPressed([this, words = question->question().toStdString()] {
            if (asked_) {
                asked_(words);
            }
        });
        questions_.push_back(question);
        flow_->add(question);
    }
    place();
}

void Greeting::resizeEvent(QResizeEvent*) {
    place();
}

bool Greeting::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        return true;
    }
    return Block::event(event);
}

void Greeting::place() {
    const bool isWide = width() >= host::measures::kWideFrom;
    const auto columns = host::WideColumns::of(width());
    const int start = isWide ? static_cast<int>(columns.cardStart) : kGutter;
    const int across = isWide ? static_cast<int>(columns.cardWidth) : width() - 2 * kGutter;
    const int textStart = start + kTextInset - kGutter;
    const int textAcross = across - 2 * (kTextInset - kGutter);
    const int title = title_->shapeHeight(textAcross);
    const int line = line_->shapeHeight(textAcross);
    const bool isLowWindow = window()->height() < kLow;
    const int toQuestions = isLowWindow ? kLowToQuestions : kToQuestions;
    const auto heightOf = [&](bool isWhole, std::size_t questions) {
        int all = (isWhole ? kIconSide + kIconToTitle + kTitleToLine + line : 0) + title + toQuestions;
        for (std::size_t i = 0; i < questions; ++i) {
            all += (i > 0 ? kBetweenQuestions : 0) + questions_[i]->shapeHeight(across);
        }
        return all;
    };
    std::size_t shown = window()->height() < kVeryLow ? std::min<std::size_t>(questions_.size(), 2) : questions_.size();
    const bool isLow = isLowWindow || heightOf(true, shown) > height();
    // Nothing is cut by the field: there are fewer questions then.
    while (shown > 1 && heightOf(!isLow, shown) > height()) {
        --shown;
    }
    icon_->setVisible(!isLow);
    line_->setVisible(!isLow);
    for (std::size_t i = 0; i < questions_.size(); ++i) {
        questions_[i]->setVisible(i < shown);
    }
    const int questions = flow_->shapeHeight(across);
    const int all = heightOf(!isLow, shown);
    const int middle = static_cast<int>(height() * kMiddle) - all / 2;
    // Where it does not fit in the middle it ends at the lower edge, or begins at the upper one.
    int y = std::max(std::min(std::max(middle, isLow ? 0 : kLeastTop), height() - all), 0);
    const auto put = [&](Block& block, int x, int wide, int high) {
        block.placeShape(mirrored(QRectF(x, y, wide, high)).toRect());
        y += high;
    };
    if (!isLow) {
        put(*icon_, textStart, kIconSide, kIconSide);
        y += kIconToTitle;
    }
    put(*title_, textStart, textAcross, title);
    if (!isLow) {
        y += kTitleToLine;
        put(*line_, textStart, textAcross, line);
    }
    y += toQuestions;
    put(*flow_, start, across, questions);
}

}  // namespace ktr::app
